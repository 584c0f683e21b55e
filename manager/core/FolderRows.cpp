#include "core/FolderRows.h"

#include <wx/filename.h>

#include "service/HotFolderListEntries.h"

std::vector<FolderRow> ReadFolderRows()
{
    std::vector<FolderRow> rows;
    for (const wxString& path : ReadHotFolderListEntries())
    {
        FolderRow row;
        row.path = path;
        row.status = ReadFolderStatus(path);
        row.name = row.status.name;
        if (row.name.empty())
        {
            const wxArrayString dirs = wxFileName::DirName(path).GetDirs();
            row.name = dirs.empty() ? path : dirs.Last();
        }
        rows.push_back(row);
    }
    return rows;
}
