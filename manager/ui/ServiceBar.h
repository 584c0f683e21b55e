#pragma once
#include <functional>

#include <wx/panel.h>

#include "core/ServiceControl.h"

class wxButton;
class wxStaticText;

// The bar above the lists: what the service does, and the one button that
// fits: Start when it is stopped, Pause when it runs, Resume when paused.
class ServiceBar : public wxPanel
{
public:
    // changed: called after the button did its work, so the window rescans.
    ServiceBar(wxWindow* parent, std::function<void()> changed);

    void ShowState(ServiceState state);
    ServiceState State() const { return m_state; }
    wxStaticText& StateText() const { return *m_text; }
    wxButton& ActionButton() const { return *m_button; }

private:
    void OnAction();

    std::function<void()> m_changed;
    ServiceState m_state = ServiceState::Stopped;
    bool m_shown = false;
    wxStaticText* m_text = nullptr;
    wxButton* m_button = nullptr;
};
