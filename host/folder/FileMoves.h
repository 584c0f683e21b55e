#pragma once
#include <wx/string.h>

// File moves that never lose or overwrite a file. Names that are taken get a
// counter: "a.ps", then "a (2).ps", "a (3).ps", ...

// Moves file into directory under name (or the next free variant of it).
// Falls back to copy, sync and unlink across file systems. finalPath gets
// where the file ended up. False with a reason; the source is then untouched.
bool MoveIntoDirectory(const wxString& file, const wxString& directory, const wxString& name,
                       wxString& finalPath, wxString& error);

// Copies file to target (target must not exist). With sync the copy is on
// disk before this returns: needed only when the source goes away next.
bool CopyFileTo(const wxString& file, const wxString& target, wxString& error, bool sync = false);

// Creates directory and its missing parents.
bool MakeDirectories(const wxString& directory, wxString& error);

// Creates directory when missing and proves a file can be made in it.
bool EnsureWritableDirectory(const wxString& directory, wxString& error);

// Removes a directory tree made by the host (work directories).
bool RemoveTree(const wxString& directory);

// The candidate name for attempt n (n >= 1): "a.ps", "a (2).ps", ...
wxString NumberedName(const wxString& name, int attempt);
