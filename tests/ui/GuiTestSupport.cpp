#include "GuiTestSupport.h"

#include <cstdlib>
#include <stdexcept>

#include <wx/app.h>
#include <wx/checkbox.h>
#include <wx/combobox.h>
#include <wx/dialog.h>
#include <wx/frame.h>
#include <wx/modalhook.h>
#include <wx/radiobut.h>
#include <wx/stopwatch.h>
#include <wx/textctrl.h>

namespace
{
bool g_guiAvailable = false;
bool g_realModalAllowed = false;

class TestApp : public wxApp
{
public:
    bool OnInit() override { return true; }
};

void ThrowingAssertHandler(const wxString& file, int line, const wxString& func,
                           const wxString& cond, const wxString& msg)
{
    throw std::runtime_error(
        wxString::Format("wx assert %s:%d %s: %s %s", file, line, func, cond, msg).ToStdString());
}

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
} // namespace

namespace ui_test
{
RealModalScope::RealModalScope()
{
    g_realModalAllowed = true;
}
RealModalScope::~RealModalScope()
{
    g_realModalAllowed = false;
}

void Pump(int milliseconds)
{
    wxStopWatch watch;
    do
    {
        wxTheApp->ProcessPendingEvents();
        wxYield();
        wxMilliSleep(5);
    } while (watch.Time() < milliseconds);
}

// Sends the command event a control sends when the user changes it.
static void Send(wxWindow* control, wxEventType type, int value, const wxString& text = "")
{
    wxCommandEvent event(type, control->GetId());
    event.SetEventObject(control);
    event.SetInt(value);
    event.SetString(text);
    control->HandleWindowEvent(event);
}

void ClickRadio(wxRadioButton* radio)
{
    ASSERT_NE(nullptr, radio);
    radio->SetValue(true);
    Send(radio, wxEVT_RADIOBUTTON, 1);
}

void ToggleCheck(wxCheckBox* check)
{
    ASSERT_NE(nullptr, check);
    check->SetValue(!check->GetValue());
    Send(check, wxEVT_CHECKBOX, check->GetValue());
}

void SelectComboItem(wxComboBox* combo, const wxString& item)
{
    ASSERT_NE(nullptr, combo);
    const int index = combo->FindString(item, true);
    ASSERT_NE(wxNOT_FOUND, index) << item;
    combo->SetSelection(index);
    Send(combo, wxEVT_COMBOBOX, index, item);
}

void TypeText(wxTextCtrl* field, const wxString& text)
{
    ASSERT_NE(nullptr, field);
    field->ChangeValue(text);
    field->SetInsertionPointEnd();
    Send(field, wxEVT_TEXT, 0, text);
}

void GuiTest::SetUp()
{
    if (!g_guiAvailable)
        GTEST_SKIP() << "no display";
    m_frame = new wxFrame(nullptr, wxID_ANY, "settings", wxDefaultPosition, wxSize(520, 720));
    m_frame->Show();
}

void GuiTest::TearDown()
{
    if (m_frame)
    {
        m_frame->Destroy();
        Pump(10);
    }
}
} // namespace ui_test

// Test programs of this folder may run hooks before the toolkit starts.
void UiTestBeforeToolkit() __attribute__((weak));

int main(int argc, char** argv)
{
    ::testing::InitGoogleTest(&argc, argv);
    if (UiTestBeforeToolkit)
        UiTestBeforeToolkit();
    if (std::getenv("DISPLAY"))
    {
        wxApp::SetInstance(new TestApp);
        g_guiAvailable = wxEntryStart(argc, argv) && wxTheApp->CallOnInit();
    }
    wxSetAssertHandler(ThrowingAssertHandler);
    UnexpectedModalHook hook;
    if (g_guiAvailable)
        hook.Register();
    const int rc = RUN_ALL_TESTS();
    if (g_guiAvailable)
    {
        hook.Unregister();
        wxEntryCleanup();
    }
    return rc;
}
