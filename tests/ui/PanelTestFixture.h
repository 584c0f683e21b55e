#pragma once
// The settings GUI test programs, each of which includes this once: the
// toolkit started before the tests, asserts that throw (and so fail the
// test) instead of popping up, a hook that fails on any modal dialog no
// wxTEST_DIALOG expects; a panel built by the factory from a test server
// description, and a driver for the scenarios of the case tables under
// tests/data/ui: one scenario a line, its steps separated by "; " (the
// steps are listed in panel-scenarios.txt).
#include <algorithm>
#include <functional>
#include <map>
#include <sstream>
#include <stdexcept>

#include <gtest/gtest.h>
#include <wx/app.h>
#include <wx/button.h>
#include <wx/checkbox.h>
#include <wx/combobox.h>
#include <wx/frame.h>
#include <wx/modalhook.h>
#include <wx/msgdlg.h>
#include <wx/radiobut.h>
#include <wx/stopwatch.h>
#include <wx/testing.h>
#include <wx/textctrl.h>

#include "ControlIds.h"
#include "ControlNames.h"
#include "CustomPageSizeDlg.h"
#include "ImageSizePanelWithoutMerge.h"
#include "PanelFactories.h"
#include "TestKit.h"

namespace ui_test
{
inline bool g_guiAvailable = false;
inline bool g_realModalAllowed = false; // modal dialogs run for real (ended by keys and a timer)

// Fails on modal dialogs that no wxTEST_DIALOG expects instead of waiting for a user.
class UnexpectedModalHook : public wxModalDialogHook
{
protected:
    int Enter(wxDialog* dialog) override
    {
        if (!g_realModalAllowed)
            ADD_FAILURE() << "unexpected modal dialog: " << dialog->GetTitle();
        return g_realModalAllowed ? wxID_NONE : wxID_CANCEL;
    }
    void Exit(wxDialog*) override {}
};

// Answers a modal dialog of type Dialog with what `answer` returns.
template <typename Dialog> class Answer : public wxExpectModalBase<Dialog>
{
public:
    explicit Answer(std::function<int(Dialog*)> answer) : m_answer(std::move(answer)) {}

protected:
    int OnInvoked(Dialog* dialog) const override { return m_answer(dialog); }

private:
    std::function<int(Dialog*)> m_answer;
};

// Lets pending events run for a while (ms).
inline void Pump(int milliseconds)
{
    for (wxStopWatch watch; watch.Time() < milliseconds; wxMilliSleep(5))
        wxTheApp->ProcessPendingEvents(), wxYield();
}

// Gives the window the keyboard focus for real; false when the display gives none.
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

// The server description of tests/data/ui/server-NAME.xml; "NAME without
// ELEMENT" leaves that element (and what it holds) out.
inline wxString ServerDescription(const std::string& server)
{
    const size_t without = server.find(" without ");
    wxString xml = TestDataText("ui/server-" + server.substr(0, without) + ".xml");
    if (without != std::string::npos)
    {
        const wxString element = wxString::FromUTF8(server.substr(without + 9));
        const size_t start = xml.find("<" + element + ">");
        const size_t end = xml.find("</" + element + ">");
        if (start == wxString::npos || end == wxString::npos)
            throw std::runtime_error("no element " + server);
        xml.erase(start, end + element.length() + 3 - start);
    }
    return xml;
}

class PanelTest : public ::testing::Test
{
protected:
    // Skips without a display; a shown frame hosts the test's windows.
    void SetUp() override
    {
        if (!g_guiAvailable)
            GTEST_SKIP() << "no display";
        m_frame = new wxFrame(nullptr, wxID_ANY, "settings", wxDefaultPosition, wxSize(520, 720));
        m_frame->Show();
    }
    void TearDown() override
    {
        CloseDialog();
        if (m_frame)
        {
            m_frame->Destroy();
            Pump(10);
        }
    }
    void CloseDialog()
    {
        if (m_dialog)
            m_dialog->Destroy();
        m_dialog = nullptr;
    }

    void Build(bool enabled = true, const std::string& server = "ui")
    {
        const wxString xml = ServerDescription(server);
        m_panel = wxDynamicCast(ImageSizePanelWithoutMerge_Factory::CreateInstance(
                                    m_frame, xml, "EPS", ".eps", enabled, enabled),
                                ImageSizePanelWithoutMerge);
        m_frame->Layout();
    }

    // What the host does on OK.
    bool Save(MapPropToValue& settings)
    {
        m_panel->TransferDataFromWindow();
        return m_panel->SaveUISettings(settings);
    }

    // The window whose controls the steps address: the open dialog, else the panel.
    wxWindow* Root() const { return m_dialog ? static_cast<wxWindow*>(m_dialog) : m_panel; }
    // C++'s own type check: the toolkit's class records do not tell a radio
    // button from a check box, nor a custom window from its base.
    template <typename T = wxWindow> T* Control(const std::string& name) const
    {
        return dynamic_cast<T*>(Root()->FindWindow(ControlId(name)));
    }

    // A control the step needs; a missing one fails the test (as an exception).
    template <typename T = wxWindow> T& Need(const std::string& name) const
    {
        if (T* control = Control<T>(name))
            return *control;
        throw std::runtime_error("no such control: " + name);
    }

    // The event the toolkit sends when the user changes a control.
    void Send(wxWindow& control, wxEventType type, int value = 0, const wxString& text = "")
    {
        wxCommandEvent event(type, control.GetId());
        event.SetEventObject(&control);
        event.SetInt(value);
        event.SetString(text);
        control.HandleWindowEvent(event);
    }

    // What a control shows: "1"/"0" for a choice, the text of a field or
    // list, else its label.
    std::string Shown(const std::string& name) const
    {
        wxString shown = "(absent)";
        if (wxWindow* window = Control(name))
            shown = window->GetLabel();
        if (auto* radio = Control<wxRadioButton>(name))
            shown = radio->GetValue() ? "1" : "0";
        if (auto* check = Control<wxCheckBox>(name))
            shown = check->GetValue() ? "1" : "0";
        if (auto* text = Control<wxTextCtrl>(name))
            shown = text->GetValue();
        if (auto* combo = Control<wxComboBox>(name))
            shown = combo->GetValue();
        return shown.utf8_string();
    }

    // "A=1, B=2" as pairs.
    static std::vector<std::pair<std::string, std::string>> Pairs(const std::string& text)
    {
        std::vector<std::pair<std::string, std::string>> pairs;
        for (size_t start = 0, comma = 0; comma != std::string::npos && start < text.size();
             start = comma + 2)
        {
            const std::string item = text.substr(start, (comma = text.find(", ", start)) - start);
            const size_t equals = item.find('=');
            pairs.emplace_back(item.substr(0, equals),
                               equals == std::string::npos ? "" : item.substr(equals + 1));
        }
        return pairs;
    }

    // Runs one step; `arg` is the rest of the step after the first blank.
    virtual void Step(const std::string& verb, const std::string& arg)
    {
        const auto [name, value] =
            Pairs(arg).empty() ? std::pair<std::string, std::string>() : Pairs(arg).front();
        const wxString text = wxString::FromUTF8(value);
        bool ok = false;
        if (verb == "load")
        {
            for (const auto& [key, stored] : Pairs(arg))
                m_settings[key] = wxString::FromUTF8(stored);
            EXPECT_TRUE(m_panel->LoadUISettings(m_settings));
        }
        else if (verb == "click")
        {
            Need<wxRadioButton>(arg).SetValue(true);
            Send(Need(arg), wxEVT_RADIOBUTTON, 1);
        }
        else if (verb == "toggle")
        {
            Need<wxCheckBox>(arg).SetValue(!Need<wxCheckBox>(arg).GetValue());
            Send(Need(arg), wxEVT_CHECKBOX, Need<wxCheckBox>(arg).GetValue());
        }
        else if (verb == "select")
        {
            const int index = Need<wxComboBox>(name).FindString(text, true);
            ASSERT_NE(wxNOT_FOUND, index) << value;
            Need<wxComboBox>(name).SetSelection(index);
            Send(Need(name), wxEVT_COMBOBOX, index, text);
        }
        else if (verb == "type")
        {
            Need<wxTextCtrl>(name).ChangeValue(text);
            Need<wxTextCtrl>(name).SetInsertionPointEnd();
            Send(Need(name), wxEVT_TEXT, 0, text);
        }
        else if (verb == "set") // without the event a user's change sends
        {
            if (auto* radio = Control<wxRadioButton>(name))
                radio->SetValue(true);
            else if (auto* check = Control<wxCheckBox>(name))
                check->SetValue(value == "1");
            else if (auto* field = Control<wxTextCtrl>(name))
                field->ChangeValue(text);
            else
                Need<wxComboBox>(name).SetStringSelection(text);
        }
        else if (verb == "custom" || verb == "cancel-custom") // sizes typed in points
        {
            auto answer = [&](CustomPageSizeDlg* dialog)
            {
                if (verb == "cancel-custom")
                    return int(wxID_CANCEL);
                m_dialog = dialog;
                Step("click", "custom-point");
                std::string sizes = arg; // typed in the field's notation, as shown: "612.00"
                std::replace(sizes.begin(), sizes.end(), '.', Shown("custom-width").at(3));
                const size_t blank = sizes.find(' ');
                Step("type", "custom-width=" + sizes.substr(0, blank));
                Step("type", "custom-height=" + sizes.substr(blank + 1));
                m_dialog = nullptr;
                return dialog->AcceptSizes() ? int(wxID_OK) : int(wxID_CANCEL);
            };
            wxTEST_DIALOG(Send(Need("custom-page"), wxEVT_BUTTON),
                          Answer<CustomPageSizeDlg>(answer));
        }
        else if (verb == "save")
            EXPECT_TRUE(Save(m_settings));
        else if (verb == "refused")
        {
            auto answer = [&](wxMessageDialog* box)
            {
                EXPECT_NE(wxNOT_FOUND, box->GetMessage().Find(wxString::FromUTF8(arg)));
                return int(wxID_OK);
            };
            wxTEST_DIALOG(ok = Save(m_settings), Answer<wxMessageDialog>(answer));
            EXPECT_FALSE(ok);
        }
        else if (verb == "on" || verb == "off")
            for (const auto& [control, unused] : Pairs(arg))
                EXPECT_EQ(verb == "on", Need(control).IsEnabled()) << control;
        else if (verb == "shows")
            EXPECT_EQ(value, Shown(name));
        else if (verb == "label")
            EXPECT_EQ(text, Need(name).GetLabel());
        else if (verb == "key")
            for (const auto& [key, stored] : Pairs(arg))
                EXPECT_EQ(stored, m_settings[key].utf8_string()) << key;
        else if (verb == "no-comma")
            for (const auto& entry : m_settings)
                EXPECT_FALSE(entry.second.Contains(",")) << entry.first;
        else if (verb == "values") // the map's entries that are not empty, exactly
        {
            std::map<std::string, std::string> expected, held;
            for (const auto& [key, stored] : Pairs(arg))
                expected[key] = stored;
            for (const auto& entry : m_settings)
                if (!entry.second.empty())
                    held[entry.first.utf8_string()] = entry.second.utf8_string();
            EXPECT_EQ(expected, held);
        }
        else if (verb == "saved" || verb == "exactly") // the whole map (saved: defaults changed)
        {
            std::map<std::string, std::string> expected, saved;
            if (verb == "saved")
                for (const auto& fields : testkit::ReadCaseTable("ui/panel-defaults.txt"))
                    expected[fields[0]] = fields[1];
            ASSERT_TRUE(verb == "exactly" || Save(m_settings));
            for (const auto& [key, stored] : Pairs(arg))
                expected[key] = stored;
            for (const auto& entry : m_settings)
                saved[entry.first.utf8_string()] = entry.second.utf8_string();
            EXPECT_EQ(expected, saved);
        }
        else if (verb == "children")
            EXPECT_EQ(std::stoul(arg), m_panel->GetChildren().size());
        else if (verb == "is-custom")
            EXPECT_EQ(arg == "1", m_panel->IsCustomPageSize());
        else if (verb == "unit")
            EXPECT_EQ(std::stoi(arg), m_panel->GetCustomPageUnit());
        else if (verb == "page-size")
            EXPECT_EQ(wxString::FromUTF8(arg), m_panel->GetPageSize());
        else if (verb == "custom-width")
            EXPECT_EQ(std::stod(arg), m_panel->GetCustomWidthPoints());
        else if (verb == "entries")
            EXPECT_EQ(std::stoul(value), Need<wxComboBox>(name).GetCount());
        else if (verb == "dialog") // limits and size in points, shown in a unit
        {
            std::istringstream in(arg);
            double v[6];
            std::string unit, length;
            in >> v[0] >> v[1] >> v[2] >> v[3] >> v[4] >> v[5] >> unit >> length;
            const Unit_t shown = unit == "inch" ? UNIT_INCH : unit == "mm" ? UNIT_MM : UNIT_POINT;
            for (double& number : v)
                convertToUnit(number, UNIT_POINT, shown);
            m_heightIsLength = length == "length";
            CloseDialog();
            m_dialog = new CustomPageSizeDlg(m_frame, wxID_ANY, "Custom page size", v[0], v[1],
                                             v[2], v[3], v[4], v[5], shown, m_heightIsLength);
        }
        else if (verb == "accept") // "yes", or "warned yes"/"warned no" after a message
        {
            if (arg.rfind("warned", 0) == 0)
            {
                wxTEST_DIALOG(ok = m_dialog->AcceptSizes(),
                              wxExpectModal<wxMessageDialog>(wxID_OK));
            }
            else
                ok = m_dialog->AcceptSizes();
            EXPECT_EQ(arg.substr(arg.size() - 3) == "yes", ok);
        }
        else if (verb == "sizes") // width height unit (0 inch, 1 mm, 2 point)
        {
            double width = 0, height = 0;
            Unit_t unit = UNIT_INCH;
            m_dialog->GetPageSizes(width, height, unit);
            std::ostringstream sizes;
            sizes << width << " " << height << " " << unit;
            EXPECT_EQ(arg, sizes.str());
        }
        else
            ADD_FAILURE() << "unknown step " << verb;
    }

    // Runs steps separated by "; "; "\n" written in a step is a line break.
    void RunSteps(const std::string& steps)
    {
        for (size_t start = 0, end = 0; end != std::string::npos && !HasFatalFailure();
             start = end + 2)
        {
            std::string step = steps.substr(start, (end = steps.find("; ", start)) - start);
            for (size_t at; (at = step.find("\\n")) != std::string::npos;)
                step.replace(at, 2, "\n");
            SCOPED_TRACE(step);
            const size_t blank = step.find(' ');
            Step(step.substr(0, blank), blank == std::string::npos ? "" : step.substr(blank + 1));
        }
    }

    // Every scenario of a table: server ("-" for no panel, "disabled" for the
    // panel of a filter the server does not enable) | steps | what it checks.
    void RunScenarios(const std::string& table)
    {
        const auto scenarios = testkit::ReadCaseTable(table);
        ASSERT_FALSE(scenarios.empty()) << table;
        for (const auto& fields : scenarios)
        {
            SCOPED_TRACE(fields[2]);
            CloseDialog();
            if (m_panel)
                m_panel->Destroy();
            m_panel = nullptr;
            m_settings.clear();
            if (fields[0] != "-")
                Build(fields[0] != "disabled", fields[0] == "disabled" ? "ui" : fields[0]);
            RunSteps(fields[1]);
        }
    }

    wxFrame* m_frame = nullptr;
    ImageSizePanelWithoutMerge* m_panel = nullptr;
    CustomPageSizeDlg* m_dialog = nullptr;
    bool m_heightIsLength = false;
    MapPropToValue m_settings;
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
                    .utf8_string());
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
