#pragma once
#include <string>
#include <vector>

#include <wx/datetime.h>
#include <wx/string.h>

// The lines the jobs of a hot folder leave in its logs, split into fields.

// failed-jobs.log in the failed folder: time, original's name, reason.
struct FailureLine
{
    std::string line; // as written: the same failure is the same line
    wxDateTime time;
    wxString name;
    wxString reason;
    bool retried = false; // "retried:" the original went back into the folder
    bool printer = false; // "printer:" the printer's verdict, also in printed-jobs.log
};
std::vector<FailureLine> ReadFailureLog(const wxString& failedFolder);

// printed-jobs.log in the container: time, verdict, queue, scheduler job,
// original's name, work id, reasons.
struct PrintedLine
{
    std::string line;
    wxDateTime time;
    std::string verdict; // "completed", "aborted", "cancelled", "refused"
    wxString queue;
    wxString name;
    wxString reason;
    bool Completed() const { return verdict == "completed"; }
    // "aborted on q1: why" in words.
    wxString Describe() const;
};
std::vector<PrintedLine> ReadPrintedLog(const wxString& container);
