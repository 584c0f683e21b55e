#pragma once
#include <wx/string.h>

// Copies file into the hot folder under a temporary hidden name and renames
// it in, so the service never sees half a file; a free variant of the name
// ("a (2).eps") when one is waiting there. copiedAs: the final path. False
// with the reason; nothing of the copy stays behind then.
bool CopyIntoHotFolder(const wxString& file, const wxString& folder, wxString& copiedAs,
                       wxString& error);
