#pragma once
// Internal: directories every user of the machine shares.
#include <wx/string.h>

namespace db
{
// Creates the directory and sets it to mode 0777, which the umask would
// otherwise narrow; one that exists keeps its mode. With parents, missing
// ancestors are made first as mkdir makes them, the umask applying: only
// the directory asked for is shared, not whatever lies above it.
// Reports nothing: a later file operation fails instead.
void MakeSharedDirectory(const wxString& directory, bool withParents);
} // namespace db
