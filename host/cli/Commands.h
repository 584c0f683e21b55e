#pragma once
#include <string>
#include <vector>

#include "cli/ExitStatus.h"

// The sub-commands' entry points: each takes the arguments after its name
// and returns an ExitStatus.
using Arguments = std::vector<std::string>;

int RunInfoCommand(const Arguments& args);
int RunConvertCommand(const Arguments& args);
int RunInitCommand(const Arguments& args);
int RunSettingsCommand(int argc, char** argv, const Arguments& args);
int RunRunCommand(const Arguments& args);
int RunServerFromPpdCommand(const Arguments& args);
int RunPrintersCommand(const Arguments& args);
