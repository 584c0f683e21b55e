// From the settings panel to the printed page: the host shows the panel,
// the user picks a custom page, a corner and an image width, the host
// saves, a filter set up from that preference converts, and Ghostscript shows the artwork where the
// user asked.
#include <wx/xml/xml.h>

#include "EPS.h"
#include "EPStoPS.h"
#include "GhostscriptOracle.h"
#include "PanelTestFixture.h"
#include "SampleEps.h"

using namespace ui_test;

using PanelConversion = PanelTest;

TEST_F(PanelConversion, SavedChoicesPlaceAndSizeTheArtwork)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript is not installed";

    EPS filter("EPS");
    ASSERT_EQ(0, filter.Initialize(TestDataText("ui/server-ui.xml")));
    ASSERT_TRUE(filter.IsFilterEnabled());
    m_panel = wxDynamicCast(filter.ShowPluginUI(m_frame), ImageSizePanelWithoutMerge);
    ASSERT_NE(nullptr, m_panel);
    EXPECT_EQ("0", filter.GetSettings()["CUSTOMPAGETUNIT"]); // the server prefers inches
    RunSteps("click ps; custom 500 700; select position=Bottom Left; click custom; type width=2");

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
