#pragma once
#include <wx/string.h>

// Whether a service runs is known from an advisory lock the running service
// holds on a file beside the "RunService" marker, never from the marker
// alone: the kernel drops the lock when the process ends however it ends, so
// a killed service leaves nothing stale behind.
class ServiceLock
{
public:
    ServiceLock() = default;
    ~ServiceLock();
    ServiceLock(const ServiceLock&) = delete;
    ServiceLock& operator=(const ServiceLock&) = delete;

    // False with a reason when another service holds it or it cannot be made.
    bool Acquire(wxString& error);

private:
    int m_fd = -1;
};

wxString ServiceLockPath();
bool ServiceIsRunning();
