#pragma once
#include <functional>

#include <wx/dnd.h>

class LiveList;

// Files dropped on a row of the folders list are copied into that folder
// (under a hidden name first, then renamed in, so the service never takes
// half a file). Problems are collected and handed to `report` once.
class FolderDropTarget : public wxFileDropTarget
{
public:
    using Report = std::function<void(const wxString& problems)>;
    FolderDropTarget(LiveList& folders, Report report);

    bool OnDropFiles(wxCoord x, wxCoord y, const wxArrayString& files) override;

private:
    LiveList& m_folders;
    Report m_report;
};
