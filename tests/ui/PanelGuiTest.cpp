// The EPS settings panel driven like a user would, over the scenarios of
// tests/data/ui/panel-scenarios.txt; then what a table cannot say: the
// sections' look and the keyboard order. The custom page
// size dialog over tests/data/ui/custom-dialog.txt, under a decimal-comma
// locale and with keys typed for real. And from the panel to the printed
// page: the user picks a custom page, a corner and an image width, the host
// saves, a filter set up from that preference converts, and Ghostscript
// shows the artwork where the user asked.
#include <memory>

#include <wx/dcmemory.h>
#include <wx/sizer.h>
#include <wx/statbox.h>
#include <wx/timer.h>
#include <wx/uiaction.h>
#include <wx/xml/xml.h>

#include <hotfolder/Themer.h>

#include "CWndDCPluginNamePanel.h"
#include "EPS.h"
#include "EPStoPS.h"
#include "GhostscriptOracle.h"
#include "PanelTestFixture.h"
#include "SampleEps.h"

using namespace ui_test;

namespace
{
std::string Pixels(const wxBitmap& bitmap)
{
    const wxImage image = bitmap.ConvertToImage();
    return std::string(reinterpret_cast<const char*>(image.GetData()),
                       3 * image.GetWidth() * image.GetHeight());
}

// The panel's section boxes, each with its distance from the left edge.
std::string Boxes(wxWindow* panel)
{
    std::string boxes;
    for (wxWindow* child : panel->GetChildren())
        if (auto* box = dynamic_cast<wxStaticBox*>(child))
            boxes += box->GetLabel().utf8_string() + " at " + std::to_string(box->GetPosition().x) +
                     "; ";
    return boxes;
}
} // namespace
using SettingsPanel = PanelTest;
using CustomDialog = PanelTest;
using PanelConversion = PanelTest;

// The panel as the host gets it from a filter, with the steps of
// tests/data/ui/filter-panel.txt on top of the panel's own: server NAME (a
// new filter initialised with it); stored K=V, ... (the filter's settings);
// show (ShowPluginUI); host-ok (SavePreference answers 0); host-refused TEXT
// (-1 after a message containing TEXT); written N (UI elements the host's
// node holds); param FIELD=V, ... (the filter's conversion parameters).
// After show and the saves the panel steps' map is a copy of the filter's.
class FilterPanel : public PanelTest
{
protected:
    void Step(const std::string& verb, const std::string& arg) override
    {
        if (verb == "server")
        {
            m_filter = std::make_unique<EPS>("EPS");
            m_host = std::make_unique<wxXmlNode>(wxXML_ELEMENT_NODE, "Filter");
            ASSERT_EQ(0, m_filter->Initialize(ServerDescription(arg)));
        }
        else if (verb == "stored")
            for (const auto& [key, value] : Pairs(arg))
                m_filter->GetSettings()[key] = wxString::FromUTF8(value);
        else if (verb == "show")
        {
            m_panel = wxDynamicCast(m_filter->ShowPluginUI(m_frame), ImageSizePanelWithoutMerge);
            ASSERT_NE(nullptr, m_panel);
            m_settings = m_filter->GetSettings();
        }
        else if (verb == "host-ok" || verb == "host-refused")
        {
            long result = 0;
            if (verb == "host-ok")
                result = m_filter->SavePreference(m_host.get());
            else
            {
                auto answer = [&](wxMessageDialog* box)
                {
                    EXPECT_NE(wxNOT_FOUND, box->GetMessage().Find(wxString::FromUTF8(arg)));
                    return int(wxID_OK);
                };
                wxTEST_DIALOG(result = m_filter->SavePreference(m_host.get()),
                              Answer<wxMessageDialog>(answer));
            }
            EXPECT_EQ(verb == "host-ok" ? 0 : -1, result);
            m_settings = m_filter->GetSettings();
        }
        else if (verb == "written")
        {
            size_t written = 0;
            for (wxXmlNode* child = m_host->GetChildren(); child; child = child->GetNext())
                written += child->GetName() == "UI";
            EXPECT_EQ(std::stoul(arg), written);
        }
        else if (verb == "param")
        {
            const EPStoPSparams_t& params = m_filter->GetParams();
            const std::map<std::string, double> fields = {{"pageWidth", params.pageWidth},
                                                          {"imagePosition", params.imagePosition},
                                                          {"imageWidth", params.imageWidth},
                                                          {"autoRotate", params.autoRotate}};
            for (const auto& [field, value] : Pairs(arg))
                EXPECT_DOUBLE_EQ(std::stod(value), fields.at(field)) << field;
        }
        else
            PanelTest::Step(verb, arg);
    }

    std::unique_ptr<EPS> m_filter;
    std::unique_ptr<wxXmlNode> m_host;
};

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
    // The strip shows the filter's name as the toolkit draws it in the
    // theme's font and colour.
    const stTheme theme = Themer::GetThemeService()->GetTheme("HeaderView");
    wxBitmap drawn(header->GetSize()), expected(header->GetSize()), blank(header->GetSize());
    {
        wxMemoryDC dc(drawn);
        dynamic_cast<CWndDCPluginNamePanel&>(*header).Draw(dc);
        dc.SelectObject(blank);
        dc.SetBackground(wxBrush(theme.m_background));
        dc.Clear();
        dc.SelectObject(expected);
        dc.Clear();
        dc.SetFont(theme.m_font);
        dc.SetTextForeground(theme.m_foreground);
        dc.DrawText("EPS", 8, 4);
    }
    EXPECT_EQ(Pixels(drawn), Pixels(expected));
    EXPECT_NE(Pixels(drawn), Pixels(blank));
    // Every section box in the host's default theme, in this order.
    const wxColour background = Themer::GetThemeService()->GetTheme("Default").m_background;
    wxString boxes;
    wxWindow* input = nullptr;
    for (wxWindow* child : m_panel->GetChildren())
        if (auto* box = dynamic_cast<wxStaticBox*>(child))
        {
            input = input ? input : box;
            boxes += box->GetLabel() + "; ";
            EXPECT_EQ(box->GetBackgroundColour(), background) << box->GetLabel();
        }
    EXPECT_EQ(boxes, "Input file type; Image size; Page; Output file type; ");
    // 5 pixels around the input box; 5 around each output choice.
    EXPECT_EQ(input->GetPosition(), wxPoint(5, 22 + 5));
    const wxRect eps = Control("eps")->GetRect();
    EXPECT_EQ(Control("ps")->GetPosition().x - eps.GetRight() - 1, 10);
}

TEST_F(SettingsPanel, PanelsOtherFiltersShare)
{
    const wxString xml = TestDataText("ui/server-ui.xml");
    const auto find = [](wxWindow* panel, const char* name)
    { return panel->FindWindow(ControlId(name)); };
    // Page and output sections alone, with the server's papers, 5 pixels in.
    wxWindow* page = PageSizePanelWithoutMerge_Factory::CreateInstance(m_frame, xml);
    page->Layout();
    EXPECT_TRUE(find(page, "original") == nullptr && find(page, "input") == nullptr);
    EXPECT_EQ(dynamic_cast<wxComboBox&>(*find(page, "page")).GetCount(), 2u);
    EXPECT_EQ(Boxes(page), "Page at 5; Output file type at 5; ");
    // The output section under the header strip and the input type; a filter
    // that cannot make PDF takes the choice away.
    auto* output = dynamic_cast<OutputFileTypePanelWithoutMerge*>(
        OutputFileTypePanelWithoutMerge_Factory::CreateInstance(m_frame, xml, "PDF", ".pdf"));
    ASSERT_NE(output, nullptr);
    EXPECT_EQ(Boxes(output), "Input file type at 5; Output file type at 5; ");
    EXPECT_EQ(find(output, "input")->GetLabel(), ".pdf");
    EXPECT_TRUE(find(output, "ps")->IsShown() && find(output, "pdf")->IsShown());
    output->RemovePDFOption();
    EXPECT_TRUE(find(output, "ps")->IsShown() && !find(output, "pdf")->IsShown());
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
    if (!FocusFor(Control("width")))
        GTEST_SKIP() << "the display gives no keyboard focus";
    wxUIActionSimulator().Char(WXK_TAB);
    Pump(200);
    wxWindow* focus = wxWindow::FindFocus();
    ASSERT_NE(nullptr, focus);
    EXPECT_TRUE(focus == Control("width-unit") || focus->GetParent() == Control("width-unit"));
}

TEST_F(FilterPanel, ShownAndSavedAsTabled)
{
    RunScenarios("ui/filter-panel.txt");
}

// Opening the settings and pressing OK must not change a custom page: the
// command's whole points and the forced size agree with what was stored,
// in every unit the list can show.
TEST_F(SettingsPanel, CustomPagesOfWholePointsSurviveLoadAndSave)
{
    for (const auto& row : testkit::Cases("ui/custom-page-whole-points.txt", 4, 3))
    {
        SCOPED_TRACE(row[3]);
        if (m_panel)
            m_panel->Destroy();
        m_settings.clear();
        Build();
        auto& paper = Need<wxComboBox>("page");
        const unsigned papers = paper.GetCount();
        std::vector<int> changed;
        wxString firstCommand;
        for (int size = std::stoi(row[1]); size <= std::stoi(row[2]); ++size)
        {
            const wxString points = wxString::Format("%d.000000", size);
            m_settings["OUTPUTFILETYPEEPS"] = "0";
            m_settings["CUSTOMPAGESIZE"] = "1";
            m_settings["CUSTOMPAGETUNIT"] = row[0];
            m_settings["DEFAULTPAGESIZE"] = "custom"; // no paper: the custom entry stays chosen
            m_settings["CUSTOMPAGEWIDTH"] = m_settings["CUSTOMPAGEHEIGHT"] = points;
            m_panel->LoadUISettings(m_settings);
            const bool kept = m_panel->GetCustomWidthPoints() == size && Save(m_settings) &&
                              m_settings["FORCEPAGESIZEX"] == points &&
                              m_settings["FORCEPAGESIZEY"] == points &&
                              m_settings["PAGESIZE_COMMAND"].StartsWith(
                                  wxString::Format("\n%d %d 0 0 1 ", size, size));
            if (!kept && changed.empty())
                firstCommand = m_settings["PAGESIZE_COMMAND"];
            if (!kept)
                changed.push_back(size);
            paper.Delete(papers); // the entry this load added
        }
        EXPECT_TRUE(changed.empty()) << changed.size() << " sizes changed, the first "
                                     << changed.front() << ": " << firstCommand;
    }
}

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

TEST_F(CustomDialog, KeysTypedForRealAreFilteredAndEnterAnswersOk)
{
    RunSteps("dialog 72 1000 72 1400 612 792 point");
    // A real modal loop; a timer ends it if the keys never arrive.
    g_realModalAllowed = true;
    wxTimer guard;
    guard.Bind(wxEVT_TIMER, [this](wxTimerEvent&) { m_dialog->EndModal(wxID_ABORT); });
    m_dialog->CallAfter(
        [this]
        {
            if (!FocusFor(Control<wxTextCtrl>("custom-width")))
                return;
            Control<wxTextCtrl>("custom-width")->Clear();
            // "1001" and "1002" pass the maximum, "x" is no number, the last
            // "5" a third decimal: each is undone as it is typed.
            wxUIActionSimulator().Text("1001x2.255");
            wxUIActionSimulator().Char(WXK_RETURN);
        });
    guard.StartOnce(10000);
    const int result = m_dialog->ShowModal();
    guard.Stop();
    g_realModalAllowed = false;
    if (result == wxID_ABORT)
        GTEST_SKIP() << "the display gives no keyboard focus or delivered no keystroke";
    EXPECT_EQ(wxID_OK, result);
    RunSteps("shows custom-width=100.25; sizes 100.25 792 2");
}

TEST_F(PanelConversion, SavedChoicesPlaceAndSizeTheArtwork)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript is not installed";

    EPS filter("EPS");
    ASSERT_EQ(0, filter.Initialize(TestDataText("ui/server-ui.xml")));
    ASSERT_TRUE(filter.IsFilterEnabled());
    filter.GetSettings()["IMAGEPOSITION"] = "Top Right";
    m_panel = wxDynamicCast(filter.ShowPluginUI(m_frame), ImageSizePanelWithoutMerge);
    ASSERT_NE(nullptr, m_panel);
    EXPECT_EQ("0", filter.GetSettings()["CUSTOMPAGETUNIT"]); // the server prefers inches
    // The panel shows the filter's own extension and settings.
    RunSteps("label input=.eps; shows position=Top Right; click ps; custom 500 700; select "
             "position=Bottom Left; click custom; type width=2");

    wxXmlNode host(wxXML_ELEMENT_NODE, "Filter");
    ASSERT_EQ(0, filter.SavePreference(&host));
    ASSERT_NE(nullptr, host.GetChildren());
    EXPECT_EQ("UI", host.GetChildren()->GetName());

    // The folder's jobs run on a filter set up from the saved preference;
    // the page command is fixed at an object's first parameter load.
    EPS processing("EPS");
    ASSERT_EQ(0, processing.Initialize(TestDataText("ui/server-ui.xml")));
    ASSERT_EQ(0, processing.InitilaizeFromPreference(&host));

    const testkit::ScratchDir folder;
    const std::string input = folder.File("art.eps"), output = folder.File("art.ps");
    ASSERT_TRUE(testkit::WriteFile(input, sample::RectangleEps(0, 0, 100, 50)));
    void* context = nullptr;
    ASSERT_EQ(1u, IsThisEPS(input.c_str(), &context));
    ASSERT_EQ(1, ConvertEPStoPS(&context, &processing.GetParams(), output.c_str()));

    const hf_test::GhostscriptReport report = hf_test::RunGhostscriptBBox(output);
    ASSERT_FALSE(report.postscriptError) << report.process.err;
    ASSERT_TRUE(report.marked);
    EXPECT_NEAR(500, report.pageWidth, 0.5);
    EXPECT_NEAR(700, report.pageHeight, 0.5);
    // 2 inches wide, proportions kept, in the bottom left corner of the
    // area inside the server's hardware margins (left 5, bottom 8).
    EXPECT_NEAR(5, report.marks.llx, 1.5);
    EXPECT_NEAR(8, report.marks.lly, 1.5);
    EXPECT_NEAR(5 + 144, report.marks.urx, 1.5);
    EXPECT_NEAR(8 + 72, report.marks.ury, 1.5);
}
