#pragma once
// One limited run of Ghostscript for a preview: the program found, the
// environment made safe, the child limited, and the outcome in words.
#include <string>
#include <vector>

#include <wx/string.h>

#include "posix/LimitedChild.h"

// The program to run: requested (a path, or a name looked up in PATH);
// the plain "gs" gives way to the one HOTFOLDER_GHOSTSCRIPT names. "" when
// there is none, with what was looked for in missing.
std::string LocateGhostscript(const wxString& requested, std::string& missing);

// The limits of one preview run: the given wall-clock time (processor time
// alike), a bounded address space, stopped through stopFd.
posix::ChildLimits PreviewLimits(int timeoutSeconds, int stopFd);

// Runs program -dSAFER -dBATCH -dNOPAUSE -dQUIET with options, on the first
// page of file only.
posix::ChildRun RunGhostscript(const std::string& program, const std::vector<std::string>& options,
                               const std::string& file, const posix::ChildLimits& limits);

// Why the run gave nothing to use, in words; "" when it ended well.
wxString GhostscriptFailure(const posix::ChildRun& run, const posix::ChildLimits& limits);

// What goes into -sOutputFile= for path: Ghostscript reads "%" there as
// the start of a page-number format.
std::string OutputFileArgument(const std::string& path);
