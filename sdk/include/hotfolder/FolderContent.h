#pragma once
#include <wx/arrstr.h>

// The host's listing of a hot folder, made before a filter sniffs it.
struct FolderContent
{
    wxArrayString m_arrFiles;   // full paths of the folder's files
    wxArrayString m_arrFolders; // full paths of its subfolders (host use)
};
