#pragma once
#include <wx/string.h>

// Where the filter module is: the explicit path, else $HOTFOLDER_MODULE, else
// ../lib/hotfolder/filters/EPS.so relative to this executable (the same
// relation holds in the build tree and after installation; an installation
// whose library directory is lib/<multiarch> is looked at as well).
wxString LocateFilterModule(const wxString& explicitPath);
