#pragma once
#include <chrono>

#include <wx/string.h>

#include "service/ServedFolder.h"

class JobReport;
class RunStatistics;

struct ServiceOptions
{
    FolderOptions folder; // how each folder is worked
    bool stats = false;   // print where the time went when it ends
    // One folder instead of the machine-wide list ("hotfolder run --watch"):
    // no service lock or RunService marker, and the StopHF marker ends the
    // loop instead of pausing it.
    wxString onlyFolder;
    JobReport* report = nullptr;     // where messages go; the service log when null
    RunStatistics* totals = nullptr; // receives the counts of every folder at the end
};

// Serves every folder of the machine-wide hot-folder list from one process
// until the "RunService" marker is removed or SIGTERM/SIGINT arrives, each
// time after the job in hand. Returns an exit status.
int RunHotFolderService(const ServiceOptions& options);
