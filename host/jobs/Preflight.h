#pragma once
// The preflight a folder can switch on ("Status" of its PreflightSettings):
// every output is run through Ghostscript's bbox device before delivery, as
// the folder's owner and within limits of time and memory. An output that
// Ghostscript cannot run to its end, or with a page that has no marks, is
// not delivered.
#include <string>

#include "posix/LimitedChild.h"

// The limits of one Ghostscript run.
posix::ChildLimits PreflightLimits();

// The Ghostscript program: the one HOTFOLDER_GHOSTSCRIPT names (a path, or a
// name looked up in PATH), else gs in PATH (the system's default path when
// PATH is unset). "" when there is none, with what was looked for in missing.
std::string FindGhostscript(std::string& missing);

// Why output must not be delivered, in words for the failure log; "" when
// Ghostscript runs it to the end and draws something on every page.
std::string PreflightProblem(const std::string& output);

// The verdict on one run of Ghostscript's bbox device over an output.
std::string JudgeGhostscriptRun(const posix::ChildRun& run, const posix::ChildLimits& limits);
