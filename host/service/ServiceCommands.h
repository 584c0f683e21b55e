#pragma once
#include "cli/Commands.h"

// The commands of the hot-folder service: serve, stop, status, remove, retry.
int RunServeCommand(const Arguments& args);
int RunStopCommand(const Arguments& args);
int RunStatusCommand(const Arguments& args);
int RunRemoveCommand(const Arguments& args);
int RunRetryCommand(const Arguments& args);
