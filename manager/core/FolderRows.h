#pragma once
#include <vector>

#include <wx/string.h>

#include "service/FolderStatus.h"

// One listed hot folder as the manager's list shows it.
struct FolderRow
{
    wxString path;
    wxString name; // the name stored in Folder.cfg; the folder's own name when none
    FolderStatus
        status; // what "hotfolder status" knows of it (status.problem non-empty: not servable)
};

// The machine-wide list, in its order.
std::vector<FolderRow> ReadFolderRows();
