// The custom page size dialog: the cases of tests/data/ui/custom-dialog.txt,
// the locale's decimal point, and keystrokes typed for real.
#include <wx/timer.h>
#include <wx/uiaction.h>

#include "PanelTestFixture.h"

using namespace ui_test;
using CustomDialog = PanelTest;

TEST_F(CustomDialog, CasesAsTabled)
{
    RunScenarios("ui/custom-dialog.txt");
}

TEST_F(CustomDialog, FieldsUseTheLocalesDecimalPoint)
{
    TESTKIT_USE_LOCALE(german, "de_DE.UTF-8");
    RunSteps("dialog 72 1000 72 1400 612 792 point; shows custom-width=612,00; "
             "type custom-width=500,5; accept yes; sizes 500.5 792 2");
}

TEST_F(CustomDialog, TypedKeysAboveTheMaximumOrNotNumbersAreUndone)
{
    RunSteps("dialog 72 1000 72 1400 612 792 point");
    m_dialog->Show();
    auto* width = wxDynamicCast(Root()->FindWindow(ControlId("custom-width")), wxTextCtrl);
    if (!FocusFor(width))
        GTEST_SKIP() << "the display gives no keyboard focus";
    for (const auto& [keys, shown] : {std::pair<std::string, std::string>{"1001", "100"},
                                      std::pair<std::string, std::string>{"7x2.255", "72.25"}})
    {
        width->Clear();
        // Waits until the field has seen every key come back up.
        size_t released = 0;
        auto count = [&released](wxKeyEvent& event) { ++released, event.Skip(); };
        width->Bind(wxEVT_KEY_UP, count);
        wxUIActionSimulator().Text(keys.c_str());
        for (int i = 0; i < 400 && released < keys.size(); ++i)
            Pump(25);
        width->Unbind(wxEVT_KEY_UP, count);
        ASSERT_GE(released, keys.size()) << "keys lost on the display";
        EXPECT_EQ(shown, width->GetValue());
    }
}

TEST_F(CustomDialog, EnterAnswersOkAndEscapeCancels)
{
    for (const auto& [key, expected] :
         {std::pair<int, int>{WXK_RETURN, wxID_OK}, std::pair<int, int>{WXK_ESCAPE, wxID_CANCEL}})
    {
        RunSteps("dialog 72 1000 72 1400 612 792 point");
        // A real modal loop; a timer ends it if the key never arrives.
        g_realModalAllowed = true;
        wxTimer guard;
        guard.Bind(wxEVT_TIMER, [this](wxTimerEvent&) { m_dialog->EndModal(wxID_ABORT); });
        m_dialog->CallAfter(
            [this, key = key]()
            {
                FocusFor(Root()->FindWindow(ControlId("custom-width")));
                wxUIActionSimulator().Char(key);
            });
        guard.StartOnce(5000);
        const int result = m_dialog->ShowModal();
        guard.Stop();
        g_realModalAllowed = false;
        if (result == wxID_ABORT)
            GTEST_SKIP() << "the display delivered no keystroke";
        EXPECT_EQ(expected, result);
    }
}
