#pragma once
#include <wx/string.h>

// The hot-folder service as the manager's service bar sees and drives it.
enum class ServiceState
{
    Running,
    Paused, // running, and the StopHF marker makes every folder wait
    Stopped // no service process, whatever markers are left
};

ServiceState ReadServiceState();

// Starts the service: through systemd ("systemctl start hotfolder.service")
// where systemd runs and knows the unit; else "hotfolder serve" (the program
// beside this one, else the one on PATH) in the background, in its own
// session. The StopHF marker goes first, so that the service converts. True
// at once when it runs already; false with the reason when it did not come
// up within a few seconds. Blocking (systemctl may take a minute): callers
// with a window run it on another thread and give stopFd, which once
// readable ends the waiting early with false and an empty error; a start
// already asked for may still come up.
bool StartService(wxString& error, int stopFd = -1);

// Every folder waits (the StopHF marker is made) / goes on (it is removed).
bool PauseService(wxString& error);
bool ResumeService(wxString& error);
