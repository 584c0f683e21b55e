#include <cstdio>

#include <wx/filename.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "folder/HotFolder.h"
#include "folder/ServerDescription.h"

bool ParseCommandLine(const Arguments& args, std::vector<OptionSpec> specs, const char* usage,
                      size_t minPositionals, size_t maxPositionals, ParsedArgs& parsed,
                      int& exitStatus)
{
    specs.push_back({"--help", false, false, "-h"});
    specs.push_back({"--module", true, false, ""});
    std::string error;
    if (!ParseArgs(args, specs, parsed, error))
    {
        PrintError(FromUtf8(error));
        std::fputs(usage, stderr);
        exitStatus = kExitUsage;
        return false;
    }
    if (parsed.Has("--help"))
    {
        std::fputs(usage, stdout);
        exitStatus = kExitSuccess;
        return false;
    }
    if (parsed.positionals.size() < minPositionals || parsed.positionals.size() > maxPositionals)
    {
        PrintError(parsed.positionals.size() < minPositionals ? "missing argument"
                                                              : "too many arguments");
        std::fputs(usage, stderr);
        exitStatus = kExitUsage;
        return false;
    }
    return true;
}

bool OpenFolderAndServer(const std::string& folderArgument, HotFolder& folder,
                         ServerDescription& server)
{
    wxString error;
    if (!folder.Open(FromUtf8(folderArgument), error))
    {
        PrintError(error);
        return false;
    }
    if (wxFileName::FileExists(folder.GetServerDescriptionFile()) &&
        !server.Load(folder.GetServerDescriptionFile(), error))
    {
        PrintError(error);
        return false;
    }
    return true;
}
