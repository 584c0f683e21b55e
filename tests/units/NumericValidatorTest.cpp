// What a measure field accepts, by the application language's decimal
// separator: as text, from a clone, and typed into a real text control.
#include <cstdlib>
#include <memory>

#include <gtest/gtest.h>
#include <wx/app.h>
#include <wx/frame.h>
#include <wx/init.h>
#include <wx/textctrl.h>

#include "NumericValidator.h"
#include "TestKit.h"

namespace
{
// A real text control needs the toolkit and a display (xvfb-run).
bool ToolkitStarted()
{
    static const bool started = []
    {
        static int argc = 1;
        static wxChar arg0[] = wxT("numeric_validator_test");
        static wxChar* argv[] = {arg0, nullptr};
        if (!std::getenv("DISPLAY"))
            return false;
        wxApp::SetInstance(new wxApp);
        return wxEntryStart(argc, argv) && std::atexit(wxEntryCleanup) == 0;
    }();
    return started;
}

std::vector<testkit::CaseFields> Cases()
{
    auto cases = testkit::ReadCaseTable("units/numeric-validator.txt");
    for (testkit::CaseFields& c : cases)
        c[0] = c[0] == "\"\"" ? "" : c[0];
    return cases;
}
} // namespace

TEST(NumericValidatorText, CasesOfTheTableAlsoForAClone)
{
    const auto cases = Cases();
    ASSERT_FALSE(cases.empty());
    for (const testkit::CaseFields& c : cases)
    {
        wxString value;
        const NumericValidator validator(&value, c[0]);
        std::unique_ptr<wxObject> copy(validator.Clone());
        const auto* clone = dynamic_cast<NumericValidator*>(copy.get());
        ASSERT_NE(nullptr, clone);
        EXPECT_EQ(validator.IsValid(c[1]).empty(), c[2] == "yes") << c[0] << " " << c[1];
        EXPECT_EQ(clone->IsValid(c[1]).empty(), c[2] == "yes") << c[0] << " " << c[1];
    }
    EXPECT_EQ("+-eE.", NumericValidator::ExcludedCharacters(","));
    EXPECT_EQ("+-eE,", NumericValidator::ExcludedCharacters("."));
}

TEST(NumericValidatorWindow, FiltersKeystrokesAndTransfersTheBoundString)
{
    if (!ToolkitStarted())
        GTEST_SKIP() << "no display";
    wxValidator::SuppressBellOnError(true);
    wxFrame* frame = new wxFrame(nullptr, wxID_ANY, "validator");
    wxTextCtrl* text = new wxTextCtrl(frame, wxID_ANY);
    wxString value;
    for (const testkit::CaseFields& c : Cases())
    {
        text->SetValidator(NumericValidator(&value, c[0]));
        bool through = true; // every keystroke let through to the control
        for (const wxUniChar typed : wxString(c[1]))
        {
            wxKeyEvent event(wxEVT_CHAR);
            event.m_keyCode = event.m_uniChar = typed;
            event.SetEventObject(text);
            text->GetValidator()->ProcessEvent(event);
            through = through && event.GetSkipped();
        }
        EXPECT_EQ(through, c[2] == "yes") << c[0] << " " << c[1];
    }
    value = "8,5";
    ASSERT_TRUE(text->GetValidator()->TransferToWindow());
    EXPECT_EQ("8,5", text->GetValue());
    text->ChangeValue("215,9");
    ASSERT_TRUE(text->GetValidator()->TransferFromWindow());
    EXPECT_EQ("215,9", value);
    frame->Destroy();
}
