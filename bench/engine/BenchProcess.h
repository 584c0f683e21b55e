#pragma once
// Starting helper programs for side-by-side timings: argument vectors only,
// standard output optionally sent to a file.
#include <string>
#include <vector>

// Runs args[0] from PATH and waits; the exit code, or -1 when it could not
// run. stdoutPath "" leaves standard output alone.
int RunAndWait(const std::vector<std::string>& args, const std::string& stdoutPath = "");

bool ProgramInPath(const std::string& name);
