#pragma once
// Shared by the settings panel GUI tests: a toolkit started once per test
// program, asserts that fail the test instead of popping up, and helpers
// that drive controls the way the toolkit reports user actions.
#include <map>
#include <string>

#include <gtest/gtest.h>
#include <wx/string.h>

#include <hotfolder/MapPropToValue.h>

class wxCheckBox;
class wxComboBox;
class wxFrame;
class wxRadioButton;
class wxTextCtrl;
class wxWindow;

namespace ui_test
{
// False when no display is available; GUI tests then skip.
bool GuiAvailable();

// A shown top-level frame to host a panel; destroyed by the fixture.
wxFrame* CreateHostFrame();

// Let pending events run for a while (ms).
void Pump(int milliseconds = 50);

// As if the user clicked/selected/typed: change the control, then send the
// event the toolkit would send.
void ClickRadio(wxRadioButton* radio);
void ToggleCheck(wxCheckBox* check);
void SelectComboItem(wxComboBox* combo, const wxString& item);
void TypeText(wxTextCtrl* field, const wxString& text);

// The text of a file in the test data folder.
wxString TestDataText(const wxString& relative);

// A map as an ordered std::map, for whole-map comparisons with readable
// failure output.
std::map<std::string, std::string> Sorted(const MapPropToValue& settings);

// While it lives, modal dialogs run for real instead of failing the test
// (for tests that end them with simulated keys and a guard timer).
class RealModalScope
{
public:
    RealModalScope();
    ~RealModalScope();
    RealModalScope(const RealModalScope&) = delete;
    RealModalScope& operator=(const RealModalScope&) = delete;
};

// Base fixture: skips without a display, cleans up the frame afterwards.
class GuiTest : public ::testing::Test
{
protected:
    void SetUp() override;
    void TearDown() override;
    wxFrame* m_frame = nullptr;
};
} // namespace ui_test
