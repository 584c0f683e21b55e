#pragma once
// Clean-up of job folders. Works with system calls only: no path ever reaches
// a shell.
#include <wx/string.h>

// Clears the immutable flag where set and allowed, and gives every entry of
// the tree at path mode 0777. False when path does not exist or any entry
// could not be made writable.
bool MakeFolderWritable(wxString const& path);

// Removes everything below folder and then folder itself, after making each
// entry writable. Failures are not reported.
void DeleteFolderChildren(wxString const& folder);
