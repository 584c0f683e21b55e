#pragma once
#include <string>
#include <vector>

#include "cli/Commands.h"

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
