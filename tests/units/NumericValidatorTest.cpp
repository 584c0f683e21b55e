#include <cstdlib>
#include <memory>

#include <gtest/gtest.h>
#include <wx/app.h>
#include <wx/frame.h>
#include <wx/init.h>
#include <wx/textctrl.h>

#include "NumericValidator.h"
#include "TestKit.h"

TEST(NumericValidatorText, CasesOfTheTable)
{
    const auto cases = testkit::ReadCaseTable("units/numeric-validator.txt");
    ASSERT_FALSE(cases.empty());
    for (const testkit::CaseFields& c : cases)
    {
        ASSERT_EQ(c.size(), 4u);
        wxString value;
        const NumericValidator validator(&value, c[0] == "\"\"" ? "" : c[0]);
        EXPECT_EQ(validator.IsValid(c[1]).empty(), c[2] == "yes") << c[0] << " " << c[1];
    }
    EXPECT_EQ("+-eE.", NumericValidator::ExcludedCharacters(","));
    EXPECT_EQ("+-eE,", NumericValidator::ExcludedCharacters("."));
}

TEST(NumericValidatorText, CloneKeepsFilterAndBinding)
{
    wxString value;
    const NumericValidator validator(&value, ",");
    std::unique_ptr<wxObject> copy(validator.Clone());
    auto* text = dynamic_cast<NumericValidator*>(copy.get());
    ASSERT_NE(nullptr, text);
    EXPECT_FALSE(text->IsValid("1.5").empty());
    EXPECT_TRUE(text->IsValid("1,5").empty());
}

namespace
{
// A real text control needs the toolkit; run under a display (xvfb-run).
class NumericValidatorWindow : public ::testing::Test
{
protected:
    static void SetUpTestSuite()
    {
        if (!std::getenv("DISPLAY"))
            return;
        static int argc = 1;
        static wxChar arg0[] = wxT("numeric_validator_test");
        static wxChar* argv[] = {arg0, nullptr};
        wxApp::SetInstance(new wxApp);
        s_started = wxEntryStart(argc, argv);
    }
    static void TearDownTestSuite()
    {
        if (s_started)
            wxEntryCleanup();
        s_started = false;
    }

    void SetUp() override
    {
        if (!s_started)
            GTEST_SKIP() << "no display";
        m_frame = new wxFrame(nullptr, wxID_ANY, "validator");
        m_text = new wxTextCtrl(m_frame, wxID_ANY);
        m_text->SetValidator(NumericValidator(&m_value, ","));
    }
    void TearDown() override
    {
        if (m_frame)
            m_frame->Destroy();
    }

    // True when the validator lets the keystroke through to the control.
    bool Accepts(wxChar c)
    {
        wxKeyEvent event(wxEVT_CHAR);
        event.m_keyCode = c;
        event.m_uniChar = c;
        event.SetEventObject(m_text);
        m_text->GetValidator()->ProcessEvent(event);
        return event.GetSkipped();
    }

    static bool s_started;
    wxFrame* m_frame = nullptr;
    wxTextCtrl* m_text = nullptr;
    wxString m_value;
};
bool NumericValidatorWindow::s_started = false;
} // namespace

TEST_F(NumericValidatorWindow, TransfersBoundStringBothWays)
{
    m_value = "8,5";
    ASSERT_TRUE(m_text->GetValidator()->TransferToWindow());
    EXPECT_EQ("8,5", m_text->GetValue());
    m_text->ChangeValue("215,9");
    ASSERT_TRUE(m_text->GetValidator()->TransferFromWindow());
    EXPECT_EQ("215,9", m_value);
}

TEST_F(NumericValidatorWindow, FiltersKeystrokes)
{
    wxValidator::SuppressBellOnError(true);
    EXPECT_TRUE(Accepts('7'));
    EXPECT_TRUE(Accepts(','));
    for (wxChar bad : {'.', '+', '-', 'e', 'E', 'x'})
        EXPECT_FALSE(Accepts(bad)) << static_cast<char>(bad);
}
