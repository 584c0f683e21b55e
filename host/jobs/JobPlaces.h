#pragma once
#include <string>

#include <wx/string.h>

// Where a hot folder's jobs go.
struct JobPlaces
{
    wxString configFile;   // the folder's Folder.cfg, copied into every job
    wxString workFolder;   // parent of the per-job work directories
    wxString failedFolder; // failed originals and the failure log
    wxString keptFolder;   // originals of successful jobs
    wxString outputFolder; // outputs and their job tickets
    std::string cupsQueue; // where delivered outputs are printed; empty: nowhere
    // Every output goes through Ghostscript before delivery (Preflight.h).
    bool preflight = false;
};

// The failure log in the failed folder: "time <TAB> name <TAB> reason" lines.
extern const char kFailureLogName[];
// A delivered output's job ticket is the output's name with this appended.
extern const char kTicketSuffix[];

enum class JobResult
{
    Done,
    Failed,
    OriginalStuck // processed or not, the original could not be moved away
};
