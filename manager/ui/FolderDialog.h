#pragma once
#include <memory>

#include <wx/dialog.h>

#include "core/FolderSetup.h"

class FilterSession;
class HotFolder;
class PrinterChoiceCtrl;
class wxDirPickerCtrl;
class wxStaticText;
class wxTextCtrl;
class wxXmlNode;

// Add… (no folder given: a new hot folder, made where the picker points)
// and Settings… of a listed folder: its name, its printer, and below them
// the filter's own settings panel, brought up from the module as a host
// does and rebuilt for the printer picked. OK stores everything, or keeps
// the dialog open and says why not.
class FolderDialog : public wxDialog
{
public:
    FolderDialog(wxWindow* parent, const wxString& modulePath, const wxString& folder = wxString(),
                 const wxString& name = wxString());
    ~FolderDialog() override;

    // What OK does: false (after a message) when something is refused.
    bool Accept();
    // The folder made or changed.
    wxString Folder() const;

    wxDirPickerCtrl& FolderPicker() const { return *m_folderPicker; }
    wxTextCtrl& NameField() const { return *m_name; }
    PrinterChoiceCtrl& Printer() const { return *m_printer; }
    // The filter's panel; null when it could not be brought up (the reason
    // is shown in its place).
    wxWindow* FilterPanel() const { return m_panel; }
    // Builds the filter's panel again for the printer now chosen, keeping
    // what the user set in the old one.
    void RebuildFilterPanel();

private:
    std::unique_ptr<wxXmlNode> CurrentFilterSetting();
    void DropFilterPanel();
    void Refuse(const wxString& message);

    wxString m_modulePath;
    wxString m_folder; // empty when adding
    wxString m_storedName;
    PrinterChoice m_storedPrinter;
    std::unique_ptr<HotFolder> m_stored;
    wxString m_openError; // why the folder's stored settings cannot be read
    wxDirPickerCtrl* m_folderPicker = nullptr;
    wxTextCtrl* m_name = nullptr;
    PrinterChoiceCtrl* m_printer = nullptr;
    wxWindow* m_panelHolder = nullptr;
    wxStaticText* m_panelNote = nullptr;
    wxWindow* m_panel = nullptr;
    // Outlives the panel it made: the panel's code lives in the module.
    std::unique_ptr<FilterSession> m_session;
};
