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

#include "GhostscriptOracle.h"

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
        ADD_FAILURE() << "unexpected modal dialog: " << dialog->GetTitle().ToStdString() << " / "
                      << dialog->GetClassInfo()->GetClassName();
        return wxID_CANCEL;
    }
    void Exit(wxDialog*) override {}
};
} // namespace

namespace ui_test
{
bool GuiAvailable()
{
    return g_guiAvailable;
}

RealModalScope::RealModalScope()
{
    g_realModalAllowed = true;
}

RealModalScope::~RealModalScope()
{
    g_realModalAllowed = false;
}

wxFrame* CreateHostFrame()
{
    auto* frame = new wxFrame(nullptr, wxID_ANY, "settings", wxDefaultPosition, wxSize(520, 720));
    frame->Show();
    return frame;
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

void ClickRadio(wxRadioButton* radio)
{
    ASSERT_NE(nullptr, radio);
    radio->SetValue(true);
    wxCommandEvent event(wxEVT_RADIOBUTTON, radio->GetId());
    event.SetEventObject(radio);
    event.SetInt(1);
    radio->HandleWindowEvent(event);
}

void ToggleCheck(wxCheckBox* check)
{
    ASSERT_NE(nullptr, check);
    check->SetValue(!check->GetValue());
    wxCommandEvent event(wxEVT_CHECKBOX, check->GetId());
    event.SetEventObject(check);
    event.SetInt(check->GetValue());
    check->HandleWindowEvent(event);
}

void SelectComboItem(wxComboBox* combo, const wxString& item)
{
    ASSERT_NE(nullptr, combo);
    const int index = combo->FindString(item, true);
    ASSERT_NE(wxNOT_FOUND, index) << item.ToStdString();
    combo->SetSelection(index);
    wxCommandEvent event(wxEVT_COMBOBOX, combo->GetId());
    event.SetEventObject(combo);
    event.SetInt(index);
    event.SetString(item);
    combo->HandleWindowEvent(event);
}

void TypeText(wxTextCtrl* field, const wxString& text)
{
    ASSERT_NE(nullptr, field);
    field->ChangeValue(text);
    field->SetInsertionPointEnd();
    wxCommandEvent event(wxEVT_TEXT, field->GetId());
    event.SetEventObject(field);
    event.SetString(text);
    field->HandleWindowEvent(event);
}

wxString TestDataText(const wxString& relative)
{
    return testkit::ReadFile(std::string(HF_TEST_DATA_DIR) + "/" + relative.ToStdString());
}

std::map<std::string, std::string> Sorted(const MapPropToValue& settings)
{
    std::map<std::string, std::string> sorted;
    for (const auto& entry : settings)
        sorted[entry.first.ToStdString()] = entry.second.ToStdString(wxConvUTF8);
    return sorted;
}

void GuiTest::SetUp()
{
    if (!GuiAvailable())
        GTEST_SKIP() << "no display";
    m_frame = CreateHostFrame();
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
