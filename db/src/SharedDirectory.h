#pragma once
// Internal: directories every user of the machine shares.
#include <wx/string.h>

namespace db
{
// Creates the directory (and, with parents, every missing ancestor) and sets
// each one it created to mode 0777, which the umask would otherwise narrow.
// Reports nothing: a later file operation fails instead.
void MakeSharedDirectory(const wxString& directory, bool withParents);
} // namespace db
