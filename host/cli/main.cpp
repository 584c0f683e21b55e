// hotfolder: the reference host of the hot-folder filter modules.
#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

#include <wx/init.h>

#include "cli/Commands.h"
#include "cli/ConsoleText.h"
#include "service/ServiceCommands.h"
#ifdef HF_WITH_PRINTING
#include "ServerFromPpdCommand.h"
#endif

static const char kUsage[] =
    "usage: hotfolder <command> [options]\n"
    "\n"
    "commands:\n"
    "  info      describe the filter module and its status codes\n"
    "  init      make a folder a hot folder\n"
    "  settings  show or change a hot folder's filter settings\n"
    "  run       process the files waiting in a hot folder (--watch: keep going)\n"
    "  convert   put one file through the filter\n"
    "  server-from-ppd\n"
    "            write the server description of a printer from its PPD file\n"
    "  serve     serve every listed hot folder (the hot-folder service)\n"
    "  stop      ask the hot-folder service to end\n"
    "  status    tell what the hot-folder service and each listed folder are doing\n"
    "  remove    take a folder off the hot-folder list\n"
    "\n"
    "'hotfolder <command> --help' describes each command.\n"
    "Every command takes --module PATH to name the filter module; otherwise\n"
    "$HOTFOLDER_MODULE, otherwise ../lib/hotfolder/filters/EPS.so next to this\n"
    "program.\n";

int main(int argc, char** argv)
{
    if (argc < 2 || !std::strcmp(argv[1], "--help") || !std::strcmp(argv[1], "-h"))
    {
        std::fputs(kUsage, argc < 2 ? stderr : stdout);
        return argc < 2 ? kExitUsage : kExitSuccess;
    }
    const std::string command = argv[1];
    Arguments args(argv + 2, argv + argc);

    // The settings window needs the GUI toolkit and sets it up itself.
    if (command == "settings")
        return RunSettingsCommand(argc, argv, args);

    wxInitializer initializer(argc, argv);
    if (!initializer.IsOk())
    {
        PrintError("cannot initialise wxWidgets");
        return kExitSetupFailed;
    }
    if (command == "info")
        return RunInfoCommand(args);
    if (command == "init")
        return RunInitCommand(args);
    if (command == "run")
        return RunRunCommand(args);
    if (command == "convert")
        return RunConvertCommand(args);
    // The hot-folder service.
    if (command == "serve")
        return RunServeCommand(args);
    if (command == "stop")
        return RunStopCommand(args);
    if (command == "status")
        return RunStatusCommand(args);
    if (command == "remove")
        return RunRemoveCommand(args);
    if (command == "server-from-ppd")
    {
#ifdef HF_WITH_PRINTING
        return RunServerFromPpdCommand(std::vector<std::string>(argv + 2, argv + argc));
#else
        PrintError("server-from-ppd is not available in this build (it needs CUPS)");
        return kExitSetupFailed;
#endif
    }
    PrintError(wxString::Format("unknown command \"%s\"; try hotfolder --help", FromUtf8(command)));
    return kExitUsage;
}
