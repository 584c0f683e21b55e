// The custom page size dialog: start values, unit switching, limit checks
// on OK, and keystrokes typed for real.
#include <wx/frame.h>
#include <wx/msgdlg.h>
#include <wx/radiobut.h>
#include <wx/stattext.h>
#include <wx/testing.h>
#include <wx/textctrl.h>
#include <wx/timer.h>
#include <wx/uiaction.h>

#include "ControlIds.h"
#include "CustomPageSizeDlg.h"
#include "GuiTestSupport.h"

using namespace ui_test;

namespace
{
class CustomDialog : public GuiTest
{
protected:
    // Limits in points, shown in `unit`.
    CustomPageSizeDlg* Open(double minW, double maxW, double minH, double maxH, double width,
                            double height, Unit_t unit)
    {
        for (double* value : {&minW, &maxW, &minH, &maxH, &width, &height})
            convertToUnit(*value, UNIT_POINT, unit);
        m_dialog = new CustomPageSizeDlg(m_frame, wxID_ANY, "Custom page size", minW, maxW, minH,
                                         maxH, width, height, unit, m_heightIsLength);
        return m_dialog;
    }
    void TearDown() override
    {
        if (m_dialog)
            m_dialog->Destroy();
        GuiTest::TearDown();
    }
    wxString Label(int id) const { return m_dialog->FindWindow(id)->GetLabel(); }
    wxTextCtrl* Field(int id) const { return wxDynamicCast(m_dialog->FindWindow(id), wxTextCtrl); }
    wxRadioButton* Radio(int id) const
    {
        return wxDynamicCast(m_dialog->FindWindow(id), wxRadioButton);
    }

    bool m_heightIsLength = false;
    CustomPageSizeDlg* m_dialog = nullptr;
};

// Keystrokes need the window to have the keyboard focus for real.
bool FocusFor(wxWindow* field)
{
    field->SetFocus();
    for (int i = 0; i < 40 && wxWindow::FindFocus() != field; ++i)
        Pump(25);
    return wxWindow::FindFocus() == field;
}

// Types keys into the focused field and returns once the field has seen
// every key come back up, so a busy display cannot leave keys in flight.
// False when they did not all arrive within ten seconds.
bool TypeKeys(wxWindow* field, const std::string& keys)
{
    size_t released = 0;
    auto count = [&released](wxKeyEvent& event)
    {
        ++released;
        event.Skip();
    };
    field->Bind(wxEVT_KEY_UP, count);
    wxUIActionSimulator().Text(keys.c_str());
    for (int i = 0; i < 400 && released < keys.size(); ++i)
        Pump(25);
    field->Unbind(wxEVT_KEY_UP, count);
    return released >= keys.size();
}
} // namespace

TEST_F(CustomDialog, UnitSwitchConvertsSizesAndRangeLabels)
{
    Open(72, 1000, 72, 1400, 612, 792, UNIT_INCH);
    EXPECT_EQ("8.50", Field(ID_CUSTOM_WIDTH_TEXT)->GetValue());
    EXPECT_EQ("(1.00 - 13.89)", Label(ID_CUSTOM_WIDTH_RANGE));
    EXPECT_EQ("(1.00 - 19.44)", Label(ID_CUSTOM_HEIGHT_RANGE));
    EXPECT_EQ("Height:", Label(ID_CUSTOM_HEIGHT_LABEL));
    EXPECT_TRUE(Radio(ID_CUSTOM_UNIT_INCH)->GetValue());

    ClickRadio(Radio(ID_CUSTOM_UNIT_MM));
    EXPECT_EQ("215.90", Field(ID_CUSTOM_WIDTH_TEXT)->GetValue());
    EXPECT_EQ("279.40", Field(ID_CUSTOM_HEIGHT_TEXT)->GetValue());
    // From the two-decimal inch limits: 1.00 in and 13.89 in.
    EXPECT_EQ("(25.40 - 352.81)", Label(ID_CUSTOM_WIDTH_RANGE));
    EXPECT_EQ("(25.40 - 493.78)", Label(ID_CUSTOM_HEIGHT_RANGE));

    ClickRadio(Radio(ID_CUSTOM_UNIT_POINT));
    EXPECT_EQ("612.00", Field(ID_CUSTOM_WIDTH_TEXT)->GetValue());
    double width = 0, height = 0;
    Unit_t unit = UNIT_INCH;
    m_dialog->GetPageSizes(width, height, unit);
    EXPECT_EQ(UNIT_POINT, unit);
    EXPECT_DOUBLE_EQ(792, height);
}

TEST_F(CustomDialog, StartsFromLetterOrTheMinimumWhenTheSizeIsOutside)
{
    Open(72, 1000, 72, 1400, 2000, 792, UNIT_POINT);
    EXPECT_EQ("612.00", Field(ID_CUSTOM_WIDTH_TEXT)->GetValue());
    EXPECT_EQ("792.00", Field(ID_CUSTOM_HEIGHT_TEXT)->GetValue());
    m_dialog->Destroy();

    // Letter is too small for these limits.
    Open(700, 1000, 800, 1400, 2000, 792, UNIT_POINT);
    EXPECT_EQ("700.00", Field(ID_CUSTOM_WIDTH_TEXT)->GetValue());
    EXPECT_EQ("800.00", Field(ID_CUSTOM_HEIGHT_TEXT)->GetValue());
}

TEST_F(CustomDialog, TooSmallIsRefusedAndBelowTheMinimumOnlyWarned)
{
    m_heightIsLength = true;
    Open(72, 1000, 72, 1400, 612, 792, UNIT_POINT);
    EXPECT_EQ("Length:", Label(ID_CUSTOM_HEIGHT_LABEL));

    TypeText(Field(ID_CUSTOM_WIDTH_TEXT), "0.05");
    bool accepted = true;
    wxTEST_DIALOG(accepted = m_dialog->AcceptSizes(), wxExpectModal<wxMessageDialog>(wxID_OK));
    EXPECT_FALSE(accepted);

    TypeText(Field(ID_CUSTOM_WIDTH_TEXT), "50");
    wxTEST_DIALOG(accepted = m_dialog->AcceptSizes(), wxExpectModal<wxMessageDialog>(wxID_OK));
    EXPECT_TRUE(accepted);
    double width = 0, height = 0;
    Unit_t unit = UNIT_INCH;
    m_dialog->GetPageSizes(width, height, unit);
    EXPECT_DOUBLE_EQ(50, width);

    TypeText(Field(ID_CUSTOM_WIDTH_TEXT), "500");
    TypeText(Field(ID_CUSTOM_HEIGHT_TEXT), "1400");
    EXPECT_TRUE(m_dialog->AcceptSizes()); // no message at all
}

TEST_F(CustomDialog, TypedKeysAboveTheMaximumOrNotNumbersAreUndone)
{
    Open(72, 1000, 72, 1400, 612, 792, UNIT_POINT);
    m_dialog->Show();
    wxTextCtrl* width = Field(ID_CUSTOM_WIDTH_TEXT);
    if (!FocusFor(width))
        GTEST_SKIP() << "the display gives no keyboard focus";
    width->Clear();
    ASSERT_TRUE(TypeKeys(width, "1001"));
    EXPECT_EQ("100", width->GetValue());
    width->Clear();
    ASSERT_TRUE(TypeKeys(width, "7x2.255"));
    EXPECT_EQ("72.25", width->GetValue());
}

TEST_F(CustomDialog, EnterAnswersOkAndEscapeCancels)
{
    for (const auto& [key, expected] :
         {std::pair<int, int>{WXK_RETURN, wxID_OK}, std::pair<int, int>{WXK_ESCAPE, wxID_CANCEL}})
    {
        Open(72, 1000, 72, 1400, 612, 792, UNIT_POINT);
        // A real modal loop; a timer ends it if the key never arrives.
        RealModalScope realModal;
        wxTimer guard;
        guard.Bind(wxEVT_TIMER, [this](wxTimerEvent&) { m_dialog->EndModal(wxID_ABORT); });
        m_dialog->CallAfter(
            [this, key = key]()
            {
                FocusFor(Field(ID_CUSTOM_WIDTH_TEXT));
                wxUIActionSimulator().Char(key);
            });
        guard.StartOnce(5000);
        const int result = m_dialog->ShowModal();
        guard.Stop();
        if (result == wxID_ABORT)
            GTEST_SKIP() << "the display delivered no keystroke";
        EXPECT_EQ(expected, result);
        m_dialog->Destroy();
        m_dialog = nullptr;
    }
}
