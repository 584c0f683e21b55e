#pragma once
// The toolkit side of the settings GUI test programs, each of which includes
// this once: the toolkit started before the tests, asserts that throw (and
// so fail the test) instead of popping up, a hook that fails on any modal
// dialog no wxTEST_DIALOG expects, and helpers that drive controls the way
// the toolkit reports user actions.
#include <cstdlib>
#include <map>
#include <stdexcept>
#include <string>

#include <gtest/gtest.h>
#include <wx/app.h>
#include <wx/checkbox.h>
#include <wx/combobox.h>
#include <wx/dialog.h>
#include <wx/frame.h>
#include <wx/modalhook.h>
#include <wx/radiobut.h>
#include <wx/stopwatch.h>
#include <wx/textctrl.h>

#include <hotfolder/MapPropToValue.h>

#include "TestKit.h"

namespace ui_test
{
inline bool g_guiAvailable = false;
inline bool g_realModalAllowed = false; // modal dialogs run for real (ended by keys and a timer)

// Catches modal dialogs that no wxTEST_DIALOG expects, so that a test
// fails instead of waiting for a user.
class UnexpectedModalHook : public wxModalDialogHook
{
protected:
    int Enter(wxDialog* dialog) override
    {
        if (g_realModalAllowed)
            return wxID_NONE;
        ADD_FAILURE() << "unexpected modal dialog: " << dialog->GetTitle() << " / "
                      << dialog->GetClassInfo()->GetClassName();
        return wxID_CANCEL;
    }
    void Exit(wxDialog*) override {}
};

// Let pending events run for a while (ms).
inline void Pump(int milliseconds = 50)
{
    wxStopWatch watch;
    do
    {
        wxTheApp->ProcessPendingEvents();
        wxYield();
        wxMilliSleep(5);
    } while (watch.Time() < milliseconds);
}

// As if the user changed a control: change it, then send the event the
// toolkit would send.
inline void Send(wxWindow* control, wxEventType type, int value, const wxString& text = "")
{
    wxCommandEvent event(type, control->GetId());
    event.SetEventObject(control);
    event.SetInt(value);
    event.SetString(text);
    control->HandleWindowEvent(event);
}

inline void ClickRadio(wxRadioButton* radio)
{
    ASSERT_NE(nullptr, radio);
    radio->SetValue(true);
    Send(radio, wxEVT_RADIOBUTTON, 1);
}

inline void ToggleCheck(wxCheckBox* check)
{
    ASSERT_NE(nullptr, check);
    check->SetValue(!check->GetValue());
    Send(check, wxEVT_CHECKBOX, check->GetValue());
}

inline void SelectComboItem(wxComboBox* combo, const wxString& item)
{
    ASSERT_NE(nullptr, combo);
    const int index = combo->FindString(item, true);
    ASSERT_NE(wxNOT_FOUND, index) << item;
    combo->SetSelection(index);
    Send(combo, wxEVT_COMBOBOX, index, item);
}

inline void TypeText(wxTextCtrl* field, const wxString& text)
{
    ASSERT_NE(nullptr, field);
    field->ChangeValue(text);
    field->SetInsertionPointEnd();
    Send(field, wxEVT_TEXT, 0, text);
}

// Gives the window the keyboard focus for real; false when the display
// gives none.
inline bool FocusFor(wxWindow* window)
{
    window->SetFocus();
    for (int i = 0; i < 40 && wxWindow::FindFocus() != window; ++i)
        Pump(25);
    return wxWindow::FindFocus() == window;
}

inline wxString TestDataText(const std::string& relative)
{
    return wxString::FromUTF8(testkit::ReadFile(HF_TEST_DATA_DIR "/" + relative));
}

// A map as an ordered std::map, for whole-map comparisons with readable
// failure output.
inline std::map<std::string, std::string> Sorted(const MapPropToValue& settings)
{
    std::map<std::string, std::string> sorted;
    for (const auto& entry : settings)
        sorted[entry.first.ToStdString()] = entry.second.ToStdString(wxConvUTF8);
    return sorted;
}

// Base fixture: skips without a display; a shown frame hosts the test's
// windows and is destroyed afterwards.
class GuiTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        if (!g_guiAvailable)
            GTEST_SKIP() << "no display";
        m_frame = new wxFrame(nullptr, wxID_ANY, "settings", wxDefaultPosition, wxSize(520, 720));
        m_frame->Show();
    }
    void TearDown() override
    {
        if (m_frame)
            m_frame->Destroy();
        Pump(10);
    }
    wxFrame* m_frame = nullptr;
};
} // namespace ui_test

// A test program may set things up before the toolkit starts.
void UiTestBeforeToolkit() __attribute__((weak));

int main(int argc, char** argv)
{
    ::testing::InitGoogleTest(&argc, argv);
    if (UiTestBeforeToolkit)
        UiTestBeforeToolkit();
    struct TestApp : wxApp
    {
        bool OnInit() override { return true; }
    };
    if (std::getenv("DISPLAY"))
    {
        wxApp::SetInstance(new TestApp);
        ui_test::g_guiAvailable = wxEntryStart(argc, argv) && wxTheApp->CallOnInit();
    }
    wxSetAssertHandler(
        [](const wxString& file, int line, const wxString& func, const wxString& cond,
           const wxString& msg)
        {
            throw std::runtime_error(
                wxString::Format("wx assert %s:%d %s: %s %s", file, line, func, cond, msg)
                    .ToStdString());
        });
    ui_test::UnexpectedModalHook hook;
    if (ui_test::g_guiAvailable)
        hook.Register();
    const int rc = RUN_ALL_TESTS();
    if (ui_test::g_guiAvailable)
    {
        hook.Unregister();
        wxEntryCleanup();
    }
    return rc;
}
