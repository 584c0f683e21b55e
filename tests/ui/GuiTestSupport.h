#pragma once
// Shared by the settings panel GUI tests: a toolkit started once per test
// program, asserts that fail the test instead of popping up, a hook that
// fails on any modal dialog no wxTEST_DIALOG expects, and helpers that drive
// controls the way the toolkit reports user actions.
#include <map>
#include <string>

#include <gtest/gtest.h>
#include <wx/string.h>

#include <hotfolder/MapPropToValue.h>

#include "TestKit.h"

class wxCheckBox;
class wxComboBox;
class wxFrame;
class wxRadioButton;
class wxTextCtrl;

namespace ui_test
{
// Let pending events run for a while (ms).
void Pump(int milliseconds = 50);

// As if the user clicked/selected/typed: change the control, then send the
// event the toolkit would send.
void ClickRadio(wxRadioButton* radio);
void ToggleCheck(wxCheckBox* check);
void SelectComboItem(wxComboBox* combo, const wxString& item);
void TypeText(wxTextCtrl* field, const wxString& text);

inline wxString TestDataText(const wxString& relative)
{
    return wxString::FromUTF8(testkit::ReadFile(HF_TEST_DATA_DIR "/" + relative.ToStdString()));
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

// While it lives, modal dialogs run for real instead of failing the test
// (for tests that end them with simulated keys and a guard timer).
struct RealModalScope
{
    RealModalScope();
    ~RealModalScope();
};

// Base fixture: skips without a display; a shown frame hosts the test's
// windows and is destroyed afterwards.
class GuiTest : public ::testing::Test
{
protected:
    void SetUp() override;
    void TearDown() override;
    wxFrame* m_frame = nullptr;
};
} // namespace ui_test
