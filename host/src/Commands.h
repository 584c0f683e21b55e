#pragma once
#include <string>
#include <vector>

// Exit statuses of every sub-command.
enum ExitStatus
{
    kExitSuccess = 0,     // everything asked for was done
    kExitJobsFailed = 1,  // the run went through, but some job failed
    kExitUsage = 2,       // bad command line
    kExitSetupFailed = 3, // the module, the folder or its configuration is unusable
};

using Arguments = std::vector<std::string>;

int RunInfoCommand(const Arguments& args);
int RunConvertCommand(const Arguments& args);
int RunInitCommand(const Arguments& args);
int RunSettingsCommand(int argc, char** argv, const Arguments& args);
int RunRunCommand(const Arguments& args);

struct OptionSpec;
class ParsedArgs;
class HotFolder;
class ServerDescription;

// Parses a sub-command's arguments, handling --help. False when the command
// must stop at once; exitStatus then says how.
bool ParseCommandLine(const Arguments& args, std::vector<OptionSpec> specs, const char* usage,
                      size_t minPositionals, size_t maxPositionals, ParsedArgs& parsed,
                      int& exitStatus);

// Opens the hot folder named on the command line and its stored server
// description, if it has one. False after printing the reason.
bool OpenFolderAndServer(const std::string& folderArgument, HotFolder& folder,
                         ServerDescription& server);
