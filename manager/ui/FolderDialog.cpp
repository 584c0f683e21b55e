#include "ui/FolderDialog.h"

#include <wx/button.h>
#include <wx/filepicker.h>
#include <wx/filename.h>
#include <wx/msgdlg.h>
#include <wx/panel.h>
#include <wx/sizer.h>
#include <wx/statbox.h>
#include <wx/stattext.h>
#include <wx/textctrl.h>
#include <wx/xml/xml.h>

#include "folder/HotFolder.h"
#include "module/FilterSession.h"
#include "posix/NativePath.h"
#include "ui/PrinterChoiceCtrl.h"

namespace
{
bool SameChoice(const PrinterChoice& a, const PrinterChoice& b)
{
    return a.kind == b.kind && (a.kind == PrinterChoice::Kind::None || a.value == b.value);
}
} // namespace

FolderDialog::FolderDialog(wxWindow* parent, const wxString& modulePath, const wxString& folder,
                           const wxString& name)
    : wxDialog(parent, wxID_ANY, folder.empty() ? _("Add a hot folder") : _("Hot folder settings"),
               wxDefaultPosition, wxDefaultSize, wxDEFAULT_DIALOG_STYLE | wxRESIZE_BORDER),
      m_modulePath(modulePath), m_folder(folder), m_storedName(name)
{
    m_folderPicker = new wxDirPickerCtrl(this, wxID_ANY, folder, _("Choose the hot folder"),
                                         wxDefaultPosition, wxSize(380, -1), wxDIRP_USE_TEXTCTRL);
    m_folderPicker->SetPath(folder);
    m_folderPicker->Enable(folder.empty()); // a listed folder stays where it is
    m_name = new wxTextCtrl(this, wxID_ANY, name);
    m_name->SetHint(_("the folder's own name when empty"));
    m_printer = new PrinterChoiceCtrl(this, [this] { RebuildFilterPanel(); });

    auto* fields = new wxFlexGridSizer(2, wxSize(8, 6));
    fields->AddGrowableCol(1);
    auto label = [this](const wxString& text) { return new wxStaticText(this, wxID_ANY, text); };
    fields->Add(label(_("&Folder:")), 0, wxALIGN_CENTER_VERTICAL);
    fields->Add(m_folderPicker, 1, wxEXPAND);
    fields->Add(label(_("&Name:")), 0, wxALIGN_CENTER_VERTICAL);
    fields->Add(m_name, 1, wxEXPAND);
    fields->Add(label(_("&Printer:")), 0, wxALIGN_TOP | wxTOP, 4);
    fields->Add(m_printer, 1, wxEXPAND);

    auto* box = new wxStaticBoxSizer(wxVERTICAL, this, _("Filter settings"));
    m_panelHolder = new wxPanel(box->GetStaticBox());
    m_panelHolder->SetSizer(new wxBoxSizer(wxVERTICAL));
    m_panelNote = new wxStaticText(m_panelHolder, wxID_ANY, wxString());
    m_panelHolder->GetSizer()->Add(m_panelNote, 0, wxEXPAND | wxALL, 4);
    box->Add(m_panelHolder, 1, wxEXPAND);

    auto* sizer = new wxBoxSizer(wxVERTICAL);
    sizer->Add(fields, 0, wxEXPAND | wxALL, 10);
    sizer->Add(box, 1, wxEXPAND | wxLEFT | wxRIGHT, 10);
    sizer->Add(CreateStdDialogButtonSizer(wxOK | wxCANCEL), 0, wxEXPAND | wxALL, 10);
    SetSizer(sizer);

    if (!folder.empty())
    {
        m_storedPrinter = CurrentPrinterChoice(folder);
        m_printer->SetValue(m_storedPrinter);
        m_stored = std::make_unique<HotFolder>();
        wxString error;
        if (!m_stored->Open(folder, error))
        {
            m_stored.reset();
            m_openError = posix::ShownLine(error);
        }
    }
    Bind(
        wxEVT_BUTTON,
        [this](wxCommandEvent&)
        {
            if (!Accept())
                return;
            if (IsModal())
                EndModal(wxID_OK);
            else
            {
                SetReturnCode(wxID_OK);
                Hide();
            }
        },
        wxID_OK);
    RebuildFilterPanel();
    m_name->SetFocus();
}

FolderDialog::~FolderDialog()
{
    DropFilterPanel();
}

wxString FolderDialog::Folder() const
{
    return m_folder.empty() ? m_folderPicker->GetPath() : m_folder;
}

void FolderDialog::DropFilterPanel()
{
    if (m_panel)
        m_panel->Destroy();
    m_panel = nullptr;
    m_session.reset();
}

// What the panel holds now (so a rebuilt panel starts from it), else what
// the folder stores; null for a new folder's defaults.
std::unique_ptr<wxXmlNode> FolderDialog::CurrentFilterSetting()
{
    if (m_session && m_panel)
    {
        auto filter = std::make_unique<wxXmlNode>(wxXML_ELEMENT_NODE, "Filter");
        filter->AddAttribute("name", m_session->Info().m_strIdentifier);
        if (m_session->Filter().SavePreference(filter.get()) == 0)
        {
            auto setting = std::make_unique<wxXmlNode>(wxXML_ELEMENT_NODE, "FilterSetting");
            setting->AddChild(filter.release());
            return setting;
        }
    }
    if (m_stored)
        return std::make_unique<wxXmlNode>(m_stored->GetFilterSetting());
    return nullptr;
}

void FolderDialog::RebuildFilterPanel()
{
    const std::unique_ptr<wxXmlNode> setting = CurrentFilterSetting();
    DropFilterPanel();
    wxString server, error;
    m_panelNote->SetLabel(m_openError);
    if (!LoadPrinterServer(m_printer->Value(), server, error))
    {
        m_panelNote->SetLabel(wxString::Format(_("The printer's description cannot be read: %s"),
                                               posix::ShownLine(error)));
        server.clear();
    }
    m_session = FilterSession::Start(m_modulePath, server, setting.get(), error);
    if (m_session)
        m_panel = m_session->Filter().ShowPluginUI(m_panelHolder);
    if (m_panel)
        m_panelHolder->GetSizer()->Add(m_panel, 1, wxEXPAND);
    else
        m_panelNote->SetLabel(
            wxString::Format(_("The filter's settings cannot be shown: %s"),
                             posix::ShownLine(m_session ? _("it offers no panel") : error)));
    m_panelNote->Show(!m_panelNote->GetLabel().empty());
    m_panelHolder->Layout();
    GetSizer()->SetSizeHints(this);
    Layout();
}

void FolderDialog::Refuse(const wxString& message)
{
    wxMessageBox(message, GetTitle(), wxOK | wxICON_WARNING, this);
}

bool FolderDialog::Accept()
{
    const wxString folder = Folder();
    const wxString name = m_name->GetValue().Strip(wxString::both);
    const PrinterChoice printer = m_printer->Value();
    if (folder.empty())
    {
        Refuse(_("Please choose the hot folder."));
        return false;
    }
    if (printer.kind == PrinterChoice::Kind::PpdFile && printer.value.empty())
    {
        Refuse(_("Please choose the printer description file (PPD)."));
        return false;
    }
    wxXmlNode filter(wxXML_ELEMENT_NODE, "Filter");
    if (m_session && m_panel)
    {
        filter.AddAttribute("name", m_session->Info().m_strIdentifier);
        if (m_session->Filter().SavePreference(&filter) != 0)
        {
            Refuse(_("Please correct the highlighted values."));
            return false;
        }
    }
    wxString error, warnings;
    const bool done = m_folder.empty()
                          ? CreateHotFolder(folder, name, printer, m_modulePath, warnings, error)
                      : (name == m_storedName && SameChoice(printer, m_storedPrinter))
                          ? true
                          : ChangeFolderSetup(folder, name, printer, error);
    if (!done)
    {
        Refuse(error);
        return false;
    }
    // Made or changed: should the settings fail below, OK again changes the
    // folder instead of making it twice.
    m_folder = folder;
    m_folderPicker->Disable();
    m_storedName = name;
    m_storedPrinter = printer;
    HotFolder stored;
    if (m_session && m_panel && !(stored.Open(folder, error) && stored.SaveFilter(filter, error)))
    {
        Refuse(error);
        return false;
    }
    if (!warnings.empty())
        wxMessageBox(warnings, GetTitle(), wxOK | wxICON_INFORMATION, this);
    return true;
}
