// The EPS settings panel driven like a user would, over the scenarios of
// tests/data/ui/panel-scenarios.txt; then what a table cannot say: the
// sections' look, the disabled panel and the keyboard order.
#include <wx/sizer.h>
#include <wx/statbox.h>
#include <wx/uiaction.h>

#include <hotfolder/Themer.h>

#include "PanelTestFixture.h"

using namespace ui_test;
using SettingsPanel = PanelTest;

TEST_F(SettingsPanel, ScenariosAsTabled)
{
    RunScenarios("ui/panel-scenarios.txt");
}

TEST_F(SettingsPanel, HeaderStripAndSectionsLook)
{
    Build();
    m_panel->GetSizer()->Layout();
    wxWindow* header = m_panel->GetChildren().front();
    EXPECT_EQ(header->GetBackgroundColour(), wxColour(0x3b, 0x4a, 0x5a));
    EXPECT_EQ(header->GetSize().y, 22);
    // Every section box in the host's default theme, in this order.
    const wxColour background = Themer::GetThemeService()->GetTheme("Default").m_background;
    wxString boxes;
    wxWindow* input = nullptr;
    for (wxWindow* child : m_panel->GetChildren())
        if (auto* box = wxDynamicCast(child, wxStaticBox))
        {
            input = input ? input : box;
            boxes += box->GetLabel() + "; ";
            EXPECT_EQ(box->GetBackgroundColour(), background) << box->GetLabel();
        }
    EXPECT_EQ(boxes, "Input file type; Image size; Page; Output file type; ");
    // 5 pixels around the input box; 5 around each output choice.
    EXPECT_EQ(input->GetPosition(), wxPoint(5, 22 + 5));
    const wxRect eps = Control<wxWindow>("eps")->GetRect();
    EXPECT_EQ(Control<wxWindow>("ps")->GetPosition().x - eps.GetRight() - 1, 10);
}

TEST_F(SettingsPanel, DisabledFilterShowsHeaderAndInputTypeOnlyAndTouchesNoKey)
{
    Build(false);
    for (const char* name : {"original", "page", "eps"})
        EXPECT_EQ("(absent)", Shown(name));
    EXPECT_EQ(".eps", Shown("input"));
    EXPECT_EQ(4u, m_panel->GetChildren().size()); // header strip, box, label and text
    m_settings["OUTPUTFILETYPEEPS"] = "0";
    EXPECT_TRUE(m_panel->LoadUISettings(m_settings));
    EXPECT_TRUE(Save(m_settings));
    EXPECT_EQ(1u, m_settings.size());
    EXPECT_EQ("0", m_settings["OUTPUTFILETYPEEPS"]);
}

TEST_F(SettingsPanel, TabOrderFollowsTheLayout)
{
    Build();
    Step("load", "OUTPUTFILETYPEEPS=0, ORIGINALSIZE=0, CUSTOMSIZE=1, CONTRAINPROPORTION=0");
    // The toolkit tabs through the panel's children in list order: the order
    // of tests/data/ui/control-ids.txt up to the PostScript choice.
    std::string order = " ", expected = " ";
    for (wxWindow* child : m_panel->GetChildren())
        for (const auto& [name, id] : ControlNames())
            if (id == child->GetId() && name.rfind("input", 0) != 0)
                order += name + " ";
    for (size_t i = 0; expected.find(" ps ") == std::string::npos; ++i)
        expected += ControlNames().at(i).first + " ";
    EXPECT_EQ(order, expected);

    // One real Tab: from the width field to its unit list.
    if (!FocusFor(Control<wxWindow>("width")))
        GTEST_SKIP() << "the display gives no keyboard focus";
    wxUIActionSimulator().Char(WXK_TAB);
    Pump(200);
    wxWindow* focus = wxWindow::FindFocus();
    ASSERT_NE(nullptr, focus);
    EXPECT_TRUE(focus == Control<wxWindow>("width-unit") ||
                focus->GetParent() == Control<wxWindow>("width-unit"));
}
