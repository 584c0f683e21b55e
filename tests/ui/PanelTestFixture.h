#pragma once
// A settings panel built by the factory from a test server description, and
// a driver for the panel scenarios of the case tables under tests/data/ui:
// one scenario a line, its steps separated by "; " (see panel-scenarios.txt).
#include <algorithm>
#include <functional>
#include <sstream>

#include <wx/button.h>
#include <wx/checkbox.h>
#include <wx/combobox.h>
#include <wx/frame.h>
#include <wx/msgdlg.h>
#include <wx/radiobut.h>
#include <wx/testing.h>
#include <wx/textctrl.h>

#include "ControlIds.h"
#include "ControlNames.h"
#include "CustomPageSizeDlg.h"
#include "GuiTestSupport.h"
#include "ImageSizePanelWithoutMerge.h"
#include "PanelFactories.h"

namespace ui_test
{
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

class PanelTest : public GuiTest
{
protected:
    ImageSizePanelWithoutMerge* Build(bool enabled = true, const std::string& server = "ui")
    {
        const wxString xml = TestDataText("ui/server-" + server + ".xml");
        m_panel = wxDynamicCast(ImageSizePanelWithoutMerge_Factory::CreateInstance(
                                    m_frame, xml, "EPS", ".eps", enabled, enabled),
                                ImageSizePanelWithoutMerge);
        m_frame->Layout();
        return m_panel;
    }

    // What the host does on OK.
    bool Save(MapPropToValue& settings)
    {
        m_panel->TransferDataFromWindow();
        return m_panel->SaveUISettings(settings);
    }

    template <typename T> T* Control(const std::string& name) const
    {
        return wxDynamicCast(Root()->FindWindow(ControlId(name)), T);
    }

    void ClickButton(int id)
    {
        wxCommandEvent event(wxEVT_BUTTON, id);
        event.SetEventObject(Root()->FindWindow(id));
        Root()->FindWindow(id)->HandleWindowEvent(event);
    }

    // What a control shows: "1"/"0" for a choice, the text of a field or
    // list, else its label.
    std::string Shown(const std::string& name) const
    {
        wxWindow* window = Root()->FindWindow(ControlId(name));
        if (!window)
            return "(absent)";
        if (auto* radio = wxDynamicCast(window, wxRadioButton))
            return radio->GetValue() ? "1" : "0";
        if (auto* check = wxDynamicCast(window, wxCheckBox))
            return check->GetValue() ? "1" : "0";
        if (auto* text = wxDynamicCast(window, wxTextCtrl))
            return text->GetValue().ToStdString(wxConvUTF8);
        if (auto* combo = wxDynamicCast(window, wxComboBox))
            return combo->GetValue().ToStdString(wxConvUTF8);
        return window->GetLabel().ToStdString(wxConvUTF8);
    }

    static std::vector<std::string> List(const std::string& text)
    {
        std::vector<std::string> items;
        for (size_t start = 0, comma = 0; comma != std::string::npos; start = comma + 2)
            items.push_back(text.substr(start, (comma = text.find(", ", start)) - start));
        return items;
    }

    // Runs one step; `arg` is the rest of the step after the first blank.
    void Step(const std::string& verb, const std::string& arg)
    {
        const size_t equals = arg.find('=');
        const std::string name = arg.substr(0, equals);
        const std::string value = equals == std::string::npos ? "" : arg.substr(equals + 1);
        const wxString wxValue = wxString::FromUTF8(value);
        bool saved = false;
        if (verb == "load")
        {
            for (const std::string& pair : List(arg))
                if (!pair.empty())
                    m_settings[pair.substr(0, pair.find('='))] = pair.substr(pair.find('=') + 1);
            EXPECT_TRUE(m_panel->LoadUISettings(m_settings));
        }
        else if (verb == "click")
            ClickRadio(Control<wxRadioButton>(arg));
        else if (verb == "toggle")
            ToggleCheck(Control<wxCheckBox>(arg));
        else if (verb == "select")
            SelectComboItem(Control<wxComboBox>(name), wxValue);
        else if (verb == "type")
            TypeText(Control<wxTextCtrl>(name), wxValue);
        else if (verb == "set") // without the event a user's change sends
        {
            if (auto* radio = Control<wxRadioButton>(name))
                radio->SetValue(true);
            else if (auto* check = Control<wxCheckBox>(name))
                check->SetValue(value == "1");
            else if (auto* text = Control<wxTextCtrl>(name))
                text->ChangeValue(wxValue);
            else
                Control<wxComboBox>(name)->SetStringSelection(wxValue);
        }
        else if (verb == "custom" || verb == "cancel-custom") // sizes typed in points
        {
            auto answer = [&](CustomPageSizeDlg* dialog)
            {
                if (verb == "cancel-custom")
                    return int(wxID_CANCEL);
                m_dialog = dialog;
                RunSteps("click custom-point"); // now shown as "612.00"
                std::string sizes = arg;        // typed in the field's notation
                std::replace(sizes.begin(), sizes.end(), '.', Shown("custom-width").at(3));
                const size_t blank = sizes.find(' ');
                RunSteps("type custom-width=" + sizes.substr(0, blank) +
                         "; type custom-height=" + sizes.substr(blank + 1));
                m_dialog = nullptr;
                return dialog->AcceptSizes() ? int(wxID_OK) : int(wxID_CANCEL);
            };
            wxTEST_DIALOG(ClickButton(ID_CUSTOMPAGESIZE_BUTTON), Answer<CustomPageSizeDlg>(answer));
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
            wxTEST_DIALOG(saved = Save(m_settings), Answer<wxMessageDialog>(answer));
            EXPECT_FALSE(saved);
        }
        else if (verb == "on" || verb == "off")
            for (const std::string& control : List(arg))
                EXPECT_EQ(verb == "on", Root()->FindWindow(ControlId(control))->IsEnabled())
                    << control;
        else if (verb == "shows")
            EXPECT_EQ(value, Shown(name));
        else if (verb == "label")
            EXPECT_EQ(wxValue, Root()->FindWindow(ControlId(name))->GetLabel());
        else if (verb == "key")
            for (const std::string& pair : List(arg))
            {
                const std::string key = pair.substr(0, pair.find('='));
                EXPECT_EQ(pair.substr(key.size() + 1), m_settings[key].ToStdString(wxConvUTF8));
            }
        else if (verb == "no-comma")
            for (const auto& entry : m_settings)
                EXPECT_FALSE(entry.second.Contains(",")) << entry.first;
        else if (verb == "is-custom")
            EXPECT_EQ(arg == "1", m_panel->IsCustomPageSize());
        else if (verb == "saved")
        {
            ASSERT_TRUE(Save(m_settings));
            std::map<std::string, std::string> expected;
            for (const auto& fields : testkit::ReadCaseTable("ui/panel-defaults.txt"))
                expected[fields[0]] = fields[1];
            for (const std::string& pair : List(arg))
                if (!pair.empty())
                    expected[pair.substr(0, pair.find('='))] = pair.substr(pair.find('=') + 1);
            EXPECT_EQ(expected, Sorted(m_settings));
        }
        else if (verb == "unit")
            EXPECT_EQ(std::stoi(arg), m_panel->GetCustomPageUnit());
        else if (verb == "page-size")
            EXPECT_EQ(wxString::FromUTF8(arg), m_panel->GetPageSize());
        else if (verb == "custom-width")
            EXPECT_DOUBLE_EQ(std::stod(arg), m_panel->GetCustomWidthPoints());
        else if (verb == "entries")
            EXPECT_EQ(std::stoul(value), Control<wxComboBox>(name)->GetCount());
        else if (verb == "dialog") // limits and size in points, shown in a unit
        {
            std::istringstream in(arg);
            double v[6];
            std::string unit, length;
            in >> v[0] >> v[1] >> v[2] >> v[3] >> v[4] >> v[5] >> unit >> length;
            const Unit_t shown = unit == "inch" ? UNIT_INCH : unit == "mm" ? UNIT_MM : UNIT_POINT;
            for (double& value : v)
                convertToUnit(value, UNIT_POINT, shown);
            m_heightIsLength = length == "length";
            CloseDialog();
            m_dialog = new CustomPageSizeDlg(m_frame, wxID_ANY, "Custom page size", v[0], v[1],
                                             v[2], v[3], v[4], v[5], shown, m_heightIsLength);
        }
        else if (verb == "accept") // "yes", or "warned yes"/"warned no" after a message
        {
            bool accepted = false;
            if (arg.rfind("warned", 0) == 0)
            {
                wxTEST_DIALOG(accepted = m_dialog->AcceptSizes(),
                              wxExpectModal<wxMessageDialog>(wxID_OK));
            }
            else
                accepted = m_dialog->AcceptSizes();
            EXPECT_EQ(arg.substr(arg.size() - 3) == "yes", accepted);
        }
        else if (verb == "sizes") // width height unit (0 inch, 1 mm, 2 point)
        {
            double width = 0, height = 0;
            Unit_t unit = UNIT_INCH;
            m_dialog->GetPageSizes(width, height, unit);
            std::ostringstream text;
            text << width << " " << height << " " << unit;
            EXPECT_EQ(arg, text.str());
        }
        else
            ADD_FAILURE() << "unknown step " << verb;
    }

    // Runs steps separated by "; "; "\\n" in a step stands for a line break.
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

    // Every scenario of a table: server | steps | what it checks.
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
                Build(true, fields[0]);
            RunSteps(fields[1]);
        }
    }

    void TearDown() override
    {
        CloseDialog();
        GuiTest::TearDown();
    }
    void CloseDialog()
    {
        if (m_dialog)
            m_dialog->Destroy();
        m_dialog = nullptr;
    }
    // The window whose controls the steps address: the open dialog, else the panel.
    wxWindow* Root() const { return m_dialog ? static_cast<wxWindow*>(m_dialog) : m_panel; }

    ImageSizePanelWithoutMerge* m_panel = nullptr;
    CustomPageSizeDlg* m_dialog = nullptr;
    bool m_heightIsLength = false;
    MapPropToValue m_settings;
};
} // namespace ui_test
