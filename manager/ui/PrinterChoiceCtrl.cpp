#include "ui/PrinterChoiceCtrl.h"

#include <algorithm>

#include <wx/choice.h>
#include <wx/filepicker.h>
#include <wx/sizer.h>
#include <wx/stattext.h>

#include "CupsQueues.h"
#include "posix/NativePath.h"

PrinterChoiceCtrl::PrinterChoiceCtrl(wxWindow* parent, std::function<void()> changed)
    : wxPanel(parent), m_changed(std::move(changed))
{
    m_list = new wxChoice(this, wxID_ANY);
    m_ppd = new wxFilePickerCtrl(
        this, wxID_ANY, wxString(), _("Choose a printer description"),
        _("Printer descriptions") + " (*.ppd)|*.ppd;*.PPD;*.ppd.gz|" + _("All files") + "|*",
        wxDefaultPosition, wxDefaultSize, wxFLP_OPEN | wxFLP_FILE_MUST_EXIST | wxFLP_USE_TEXTCTRL);
    m_note = new wxStaticText(this, wxID_ANY, wxString());
    ListQueues();
    m_list->Bind(wxEVT_CHOICE,
                 [this](wxCommandEvent&)
                 {
                     Select(m_list->GetSelection());
                     if (m_changed)
                         m_changed();
                 });
    m_ppd->Bind(wxEVT_FILEPICKER_CHANGED,
                [this](wxFileDirPickerEvent&)
                {
                    if (m_changed)
                        m_changed();
                });
    auto* sizer = new wxBoxSizer(wxVERTICAL);
    sizer->Add(m_list, 0, wxEXPAND);
    sizer->Add(m_ppd, 0, wxEXPAND | wxTOP, 4);
    sizer->Add(m_note, 0, wxEXPAND | wxTOP, 2);
    SetSizer(sizer);
    Select(NoneEntry());
}

void PrinterChoiceCtrl::ListQueues()
{
    std::vector<printing::QueueInfo> queues;
    std::string error;
    m_list->Clear();
    m_queues.clear();
    if (printing::ListQueues(queues, error))
        for (const printing::QueueInfo& queue : queues)
        {
            m_queues.push_back(queue.name);
            const wxString name = posix::ShownLine(wxString::FromUTF8(queue.name));
            m_list->Append(queue.makeAndModel.empty()
                               ? name
                               : name + wxString(L" — ") +
                                     posix::ShownLine(wxString::FromUTF8(queue.makeAndModel)));
        }
    else
        m_note->SetLabel(wxString::Format(_("The printers cannot be listed: %s"),
                                          posix::ShownLine(wxString::FromUTF8(error))));
    m_list->Append(_(L"A printer description file (PPD)…"));
    m_list->Append(_("No printer: output only"));
}

int PrinterChoiceCtrl::PpdEntry() const
{
    return static_cast<int>(m_queues.size());
}

int PrinterChoiceCtrl::NoneEntry() const
{
    return static_cast<int>(m_queues.size()) + 1;
}

void PrinterChoiceCtrl::Select(int index)
{
    m_list->SetSelection(index);
    m_ppd->Enable(index == PpdEntry());
}

PrinterChoice PrinterChoiceCtrl::Value() const
{
    PrinterChoice choice;
    const int index = m_list->GetSelection();
    if (index >= 0 && index < PpdEntry())
    {
        choice.kind = PrinterChoice::Kind::Queue;
        choice.value = m_queues[static_cast<size_t>(index)];
    }
    else if (index == PpdEntry())
    {
        choice.kind = PrinterChoice::Kind::PpdFile;
        choice.value = m_ppd->GetPath().utf8_string();
    }
    return choice;
}

void PrinterChoiceCtrl::SetValue(const PrinterChoice& choice)
{
    switch (choice.kind)
    {
    case PrinterChoice::Kind::None:
        Select(NoneEntry());
        break;
    case PrinterChoice::Kind::PpdFile:
        m_ppd->SetPath(wxString::FromUTF8(choice.value));
        Select(PpdEntry());
        break;
    case PrinterChoice::Kind::Queue:
    {
        auto found = std::find(m_queues.begin(), m_queues.end(), choice.value);
        if (found == m_queues.end())
        {
            m_list->Insert(posix::ShownLine(wxString::FromUTF8(choice.value)), PpdEntry());
            found = m_queues.insert(m_queues.end(), choice.value);
        }
        Select(static_cast<int>(found - m_queues.begin()));
        break;
    }
    }
}
