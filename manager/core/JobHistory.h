#pragma once
#include <cstddef>
#include <vector>

#include <wx/datetime.h>
#include <wx/string.h>

// The recent jobs of a hot folder, read from what they leave behind.
enum class JobOutcome
{
    Done,
    Failed,
    Printing,
    Printed,
    PrinterFailed
};

struct JobEntry
{
    wxDateTime time;
    wxString name; // the original's file name
    JobOutcome outcome;
    wxString reason;        // in words; empty when none
    wxString output;        // the output file when it still exists; empty otherwise
    bool retryable = false; // a failed original that can be put back
};

// Newest first, at most limit rows.
std::vector<JobEntry> ReadRecentJobs(const wxString& folder, size_t limit);

// Puts a failed job's original back into the hot folder.
bool RetryJob(const wxString& folder, const JobEntry& job, wxString& error);

// "done", "failed", "printing", "printed", "printer failed".
wxString JobOutcomeText(JobOutcome outcome);
