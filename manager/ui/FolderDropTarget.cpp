#include "ui/FolderDropTarget.h"

#include <wx/intl.h>

#include "core/DropCopy.h"
#include "posix/NativePath.h"
#include "ui/LiveList.h"

FolderDropTarget::FolderDropTarget(LiveList& folders, Report report)
    : m_folders(folders), m_report(std::move(report))
{
}

bool FolderDropTarget::OnDropFiles(wxCoord x, wxCoord y, const wxArrayString& files)
{
    const long row = m_folders.RowAt(wxPoint(x, y));
    if (row < 0 || row >= static_cast<long>(m_folders.Keys().size()))
    {
        m_report(_("Drop the files on the row of the hot folder they are for."));
        return false;
    }
    const wxString folder = m_folders.Keys()[static_cast<size_t>(row)];
    wxString problems;
    for (const wxString& file : files)
    {
        wxString copiedAs, error;
        if (!CopyIntoHotFolder(file, folder, copiedAs, error))
            problems += posix::ShownLine(file) + ": " + posix::ShownLine(error) + "\n";
    }
    if (!problems.empty())
        m_report(problems.Trim());
    return problems.empty();
}
