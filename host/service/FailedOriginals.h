#pragma once
#include <vector>

#include <wx/string.h>

class HotFolder;

// An original whose job failed and that can be taken again: one the filter
// refused (in the failed folder) or one whose output the printer aborted or
// cancelled (kept, with a "printer:" line in the failure log).
struct FailedOriginal
{
    wxString name; // as the dropper named it
    wxString path; // where it lies now
    bool atThePrinter = false;
};

// Every failed original of the folder, by name; an original retried since
// its last failure is not one.
std::vector<FailedOriginal> ListFailedOriginals(const HotFolder& folder);

// Moves a failed original back into the hot folder (under a free variant of
// its name if one is waiting there) and says so in the failure log. False
// with a reason; the original then stays where it was.
bool RetryFailedOriginal(const HotFolder& folder, const FailedOriginal& original, wxString& movedTo,
                         wxString& error);
