#pragma once
#include <wx/string.h>

namespace db
{
// The four folders a hot folder works with.
class FolderConfiguration
{
public:
    const wxString& GetFailFolder() const { return m_strFailFolder; }
    void SetFailFolder(const wxString& path) { m_strFailFolder = path; }
    const wxString& GetWorkFolder() const { return m_strWorkFolder; }
    void SetWorkFolder(const wxString& path) { m_strWorkFolder = path; }
    // Stored in Folder.cfg as "Movefolder".
    const wxString& GetBackupFolder() const { return m_strBackupFolder; }
    void SetBackupFolder(const wxString& path) { m_strBackupFolder = path; }
    const wxString& GetHotFolder() const { return m_strHotFolder; }
    void SetHotFolder(const wxString& path) { m_strHotFolder = path; }

private:
    wxString m_strFailFolder;
    wxString m_strWorkFolder;
    wxString m_strBackupFolder;
    wxString m_strHotFolder;
};
} // namespace db
