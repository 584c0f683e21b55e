// hotfolder: the reference host of the hot-folder filter modules.
#include <cstdio>
#include <cstring>
#include <string>

#include <wx/init.h>

#include "cli/Commands.h"
#include "cli/ConsoleText.h"
#include "posix/NativePath.h"
#include "service/ServiceCommands.h"

namespace
{
struct Command
{
    const char* name;
    // argc and argv are the process's own, for commands that set up the
    // GUI toolkit themselves; args are the words after the command's name.
    int (*run)(int argc, char** argv, const Arguments& args);
    const char* description; // one line of the usage text
    bool needsGuiToolkit;    // otherwise main sets up the toolkit's base
};

// In the order of the usage text.
const Command kCommands[] = {
    {"info", [](int, char**, const Arguments& a) { return RunInfoCommand(a); },
     "describe the filter module and its status codes", false},
    {"init", [](int, char**, const Arguments& a) { return RunInitCommand(a); },
     "make a folder a hot folder", false},
    {"settings", RunSettingsCommand, "show or change a hot folder's filter settings", true},
    {"run", [](int, char**, const Arguments& a) { return RunRunCommand(a); },
     "process the files waiting in a hot folder (--watch: keep going)", false},
    {"convert", [](int, char**, const Arguments& a) { return RunConvertCommand(a); },
     "put one file through the filter", false},
    {"server-from-ppd", [](int, char**, const Arguments& a) { return RunServerFromPpdCommand(a); },
     "write the server description of a printer from its PPD file", false},
    {"printers", [](int, char**, const Arguments& a) { return RunPrintersCommand(a); },
     "list the CUPS printers and the hot folders bound to them", false},
    // The hot-folder service.
    {"serve", [](int, char**, const Arguments& a) { return RunServeCommand(a); },
     "serve every listed hot folder (the hot-folder service)", false},
    {"stop", [](int, char**, const Arguments& a) { return RunStopCommand(a); },
     "ask the hot-folder service to end", false},
    {"status", [](int, char**, const Arguments& a) { return RunStatusCommand(a); },
     "tell what the hot-folder service and each listed folder are doing", false},
    {"remove", [](int, char**, const Arguments& a) { return RunRemoveCommand(a); },
     "take a folder off the hot-folder list", false},
    {"retry", [](int, char**, const Arguments& a) { return RunRetryCommand(a); },
     "put failed originals back into their hot folder", false},
};

const char kUsageHead[] = "usage: hotfolder <command> [options]\n"
                          "\n"
                          "commands:\n";
const char kUsageTail[] =
    "\n"
    "'hotfolder <command> --help' describes each command.\n"
    "Every command takes --module PATH to name the filter module; otherwise\n"
    "$HOTFOLDER_MODULE, otherwise ../lib/hotfolder/filters/EPS.so next to this\n"
    "program.\n";

// Names are padded to a column; a longer name has its description on the
// next line, in that column.
std::string UsageText()
{
    const size_t column = 12;
    std::string text = kUsageHead;
    for (const Command& command : kCommands)
    {
        std::string line = std::string("  ") + command.name;
        if (line.size() + 2 > column)
            line += "\n" + std::string(column, ' ');
        else
            line.resize(column, ' ');
        text += line + command.description + "\n";
    }
    return text + kUsageTail;
}

const Command* FindCommand(const std::string& name)
{
    for (const Command& command : kCommands)
        if (name == command.name)
            return &command;
    return nullptr;
}
} // namespace

int main(int argc, char** argv)
{
    if (argc < 2 || !std::strcmp(argv[1], "--help") || !std::strcmp(argv[1], "-h"))
    {
        std::fputs(UsageText().c_str(), argc < 2 ? stderr : stdout);
        return argc < 2 ? kExitUsage : kExitSuccess;
    }
    const Command* command = FindCommand(argv[1]);
    if (!command)
    {
        PrintError(
            wxString::Format("unknown command \"%s\"; try hotfolder --help", FromUtf8(argv[1])));
        return kExitUsage;
    }
    const Arguments args(argv + 2, argv + argc);
    if (command->needsGuiToolkit)
    {
        posix::KeepFileNameBytes();
        return command->run(argc, argv, args);
    }

    wxInitializer initializer(argc, argv);
    if (!initializer.IsOk())
    {
        PrintError("cannot initialise wxWidgets");
        return kExitSetupFailed;
    }
    posix::KeepFileNameBytes();
    return command->run(argc, argv, args);
}
