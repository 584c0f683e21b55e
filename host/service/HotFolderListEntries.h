#pragma once
#include <vector>

#include <wx/string.h>

// The machine-wide list file, HotFolderList.cfg in the warehouse.
wxString HotFolderListFile();

// Every path the list names, in order, each once, whether or not it is a
// usable folder today (the service reports the ones that are not).
std::vector<wxString> ReadHotFolderListEntries();

// The entry that names the same folder as path, or empty.
wxString FindHotFolderListEntry(const wxString& path);
