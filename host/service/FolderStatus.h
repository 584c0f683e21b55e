#pragma once
#include <string>
#include <vector>

#include <wx/string.h>

// What "hotfolder status" tells of one listed folder. The counts come from
// what the jobs leave behind, so they hold whichever process ran the jobs:
// done jobs are the originals in the kept-originals folder (today: moved
// there since local midnight), failed jobs the lines of failed-jobs.log
// (but those saying an original was retried), printed jobs the lines of the
// container's printed-jobs.log.
struct FolderStatus
{
    wxString path;
    wxString problem; // why the folder cannot be served; empty when it can
    wxString name;    // the name stored in Folder.cfg; may be empty
    wxString server;  // the bound server's name; empty when none
    wxString outputType;
    wxString page;
    bool preflight = false; // outputs go through Ghostscript before delivery
    size_t waiting = 0;
    size_t doneToday = 0, doneTotal = 0;
    size_t failedToday = 0, failedTotal = 0;
    wxString lastFailure;
    // Printing: the bound queue as the scheduler reports it, the jobs on their
    // way (the journal's open print records) and the verdicts logged.
    std::string queue;
    std::string queueState;
    std::vector<std::string> queueReasons;
    wxString printingHeld; // why printing waits; empty when it does not
    size_t printing = 0;
    size_t printedToday = 0, printedTotal = 0;
    size_t printFailedToday = 0;
    wxString lastPrintFailure;
};

FolderStatus ReadFolderStatus(const wxString& path);
