#pragma once
#include <wx/string.h>

// Progress of a job as the host shows it. The first virtual function is
// the one filters call; its slot must stay first.
class IProgressTracker
{
public:
    virtual void ReportProgress(const wxString& path, int percent) = 0;
    virtual ~IProgressTracker() = default;
};
