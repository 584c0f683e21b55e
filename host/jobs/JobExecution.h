#pragma once
#include <hotfolder/HFPlugin.h>

// What one call of the filter's Process left behind.
struct JobOutput
{
    long status = 0;          // the filter's status code
    wxString outputName;      // as the filter reported it
    wxString producedPath;    // the file to deliver; empty when there is none
    bool passThrough = false; // the filter asked for the input itself to be delivered
    double processSeconds = 0;
};

// Runs Process for job into workDirectory (where the filter writes its output
// and merges its job overrides into Folder.cfg) and finds the file to
// deliver: the named output in the work directory, or, when the filter
// passes the input through unchanged, the input itself.
JobOutput ProcessJob(HFPlugin& filter, const ReadyToProcessJobInfo& job,
                     const wxString& workDirectory, IProgressTracker* tracker);

// A new, empty, uniquely named directory inside parent, or empty with a
// reason.
wxString MakeUniqueDirectory(const wxString& parent, const wxString& prefix, wxString& error);
