#pragma once
#include <chrono>

#include <wx/string.h>

struct ServiceOptions
{
    wxString modulePath;
    std::chrono::milliseconds settle{500};
    bool stats = false; // print where the time went when it ends
};

// Serves every folder of the machine-wide hot-folder list from one process
// until the "RunService" marker is removed or SIGTERM/SIGINT arrives, each
// time after the job in hand. Returns an exit status.
int RunHotFolderService(const ServiceOptions& options);
