#pragma once
#include <functional>
#include <memory>

#include <wx/panel.h>

#include "core/ServiceControl.h"

class ServiceStarter;
class wxButton;
class wxStaticText;

// The bar above the lists: what the service does, and the one button that
// fits: Start when it is stopped, Pause when it runs, Resume when paused.
// A start runs off the window's thread; meanwhile the bar says so and its
// button waits.
class ServiceBar : public wxPanel
{
public:
    // changed: called after the button did its work, so the window rescans.
    ServiceBar(wxWindow* parent, std::function<void()> changed);
    ~ServiceBar() override;

    void ShowState(ServiceState state);
    ServiceState State() const { return m_state; }
    wxStaticText& StateText() const { return *m_text; }
    wxButton& ActionButton() const { return *m_button; }

private:
    void OnAction();
    void Start();
    void Started(bool done, const wxString& error);
    void Report(bool done, const wxString& error);

    std::function<void()> m_changed;
    std::unique_ptr<ServiceStarter> m_starter; // while a start is under way
    ServiceState m_state = ServiceState::Stopped;
    bool m_shown = false;
    wxStaticText* m_text = nullptr;
    wxButton* m_button = nullptr;
};
