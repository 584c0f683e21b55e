#include "ui/ServiceBar.h"

#include <wx/button.h>
#include <wx/msgdlg.h>
#include <wx/sizer.h>
#include <wx/stattext.h>

#include "ui/ServiceStarter.h"

ServiceBar::ServiceBar(wxWindow* parent, std::function<void()> changed)
    : wxPanel(parent), m_changed(std::move(changed))
{
    m_text = new wxStaticText(this, wxID_ANY, _(L"Reading the service's state…"));
    m_text->SetFont(m_text->GetFont().Bold());
    m_button = new wxButton(this, wxID_ANY, _("Start ser&vice"));
    m_button->Bind(wxEVT_BUTTON, [this](wxCommandEvent&) { OnAction(); });
    m_button->Disable();
    auto* sizer = new wxBoxSizer(wxHORIZONTAL);
    sizer->Add(m_text, 1, wxALIGN_CENTER_VERTICAL | wxRIGHT, 12);
    sizer->Add(m_button, 0, wxALIGN_CENTER_VERTICAL);
    SetSizer(sizer);
}

// Ends a start under way (the service may still come up), quickly.
ServiceBar::~ServiceBar() = default;

void ServiceBar::ShowState(ServiceState state)
{
    // While starting, the bar keeps saying so; the state shows once it ends.
    if (m_starter)
    {
        m_state = state;
        return;
    }
    if (m_shown && state == m_state)
        return;
    m_shown = true;
    m_state = state;
    switch (state)
    {
    case ServiceState::Running:
        m_text->SetLabel(_("The service is running: new files in the folders are converted."));
        m_button->SetLabel(_("&Pause service"));
        break;
    case ServiceState::Paused:
        m_text->SetLabel(_("The service is paused: files wait in the folders."));
        m_button->SetLabel(_("Resume ser&vice"));
        break;
    case ServiceState::Stopped:
        m_text->SetLabel(_("The service is stopped: nothing is converted."));
        m_button->SetLabel(_("Start ser&vice"));
        break;
    }
    m_button->Enable();
    Layout();
}

void ServiceBar::OnAction()
{
    if (m_starter)
        return;
    if (m_state == ServiceState::Stopped)
    {
        Start();
        return;
    }
    wxString error;
    const bool done = m_state == ServiceState::Running ? PauseService(error) : ResumeService(error);
    Report(done, error);
}

void ServiceBar::Start()
{
    m_text->SetLabel(_(L"Starting the service…"));
    m_button->Disable();
    Layout();
    m_starter = std::make_unique<ServiceStarter>(*this, [this](bool done, const wxString& error)
                                                 { Started(done, error); });
}

void ServiceBar::Started(bool done, const wxString& error)
{
    m_starter.reset(); // joins a thread whose last act was to send this
    m_shown = false;
    ShowState(m_state);
    Report(done, error);
}

void ServiceBar::Report(bool done, const wxString& error)
{
    if (!done)
        wxMessageBox(error, _("Service"), wxOK | wxICON_ERROR, this);
    if (m_changed)
        m_changed();
}
