#pragma once
#include <wx/string.h>

// The hot-folder service as the manager's service bar sees and drives it.
enum class ServiceState
{
    Running,
    Paused, // running or not, the StopHF marker is present
    Stopped
};

ServiceState ReadServiceState();

// Starts the service: through systemd ("systemctl start hotfolder.service")
// where systemd runs and knows the unit; else "hotfolder serve" (the program
// beside this one, else the one on PATH) in the background, in its own
// session. True at once when it runs already; false with the reason when it
// did not come up within a few seconds.
bool StartService(wxString& error);

// Every folder waits (the StopHF marker is made) / goes on (it is removed).
bool PauseService(wxString& error);
bool ResumeService(wxString& error);
