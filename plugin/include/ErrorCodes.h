#pragma once
#include <wx/string.h>

#include <hotfolder/StatusCodes.h>

// The message for a code, through the user-interface catalogue. Unknown
// codes read "No Error", as the hosts' logs expect.
wxString GetErrorStringFromID(long code);
