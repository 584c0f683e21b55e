// The filter's settings in the host's preference XML, and what the server
// description switches on.
#include <gtest/gtest.h>
#include <wx/xml/xml.h>

#include "EPS.h"
#include "HostModule.h"
#include "TestKit.h"

TEST(Preferences, SaveThenLoadRestoresEverySettingAndTheFirstSaveWins)
{
    EPS source("a");
    source.GetSettings()["PAGESIZE_COMMAND"] = "\n595 842 0 0 1 setpagesize";
    source.GetSettings()["IMAGEPOSITION"] = "Top Left";
    source.GetSettings()["DEFAULTPAGESIZE"] = "A4";
    wxXmlNode host(wxXML_ELEMENT_NODE, "Filter");
    EXPECT_EQ(source.SavePreference(&host), 0);
    wxXmlNode* ui = host.GetChildren();
    ASSERT_NE(ui, nullptr);
    EXPECT_EQ(ui->GetName(), "UI");
    size_t elements = 0;
    for (wxXmlNode* e = ui->GetChildren(); e; e = e->GetNext(), ++elements)
    {
        ASSERT_NE(e->GetChildren(), nullptr) << e->GetName();
        EXPECT_EQ(e->GetChildren()->GetType(), wxXML_TEXT_NODE);
        EXPECT_EQ(e->GetChildren()->GetContent(), source.GetSettings()[e->GetName()]);
    }
    EXPECT_EQ(elements, source.GetSettings().size());
    // Saving again appends a second UI element; loading reads the first.
    source.GetSettings()["DEFAULTPAGESIZE"] = "Letter";
    source.SavePreference(&host);
    ASSERT_NE(ui->GetNext(), nullptr);
    EXPECT_EQ(ui->GetNext()->GetName(), "UI");

    EPS target("b");
    EXPECT_EQ(target.LoadPreference(&host), 0);
    EXPECT_EQ(target.GetSettings()["DEFAULTPAGESIZE"], "A4");
    for (const char* key : {"PAGESIZE_COMMAND", "IMAGEPOSITION", "OUTPUTFILETYPEEPS"})
        EXPECT_EQ(target.GetSettings()[key], source.GetSettings()[key]) << key;
    // Loading alone leaves the parameters as constructed.
    EXPECT_EQ(target.GetParams().imagePosition, 4u);
    EXPECT_EQ(target.GetParams().setPageDeviceString, nullptr);
    EXPECT_FALSE(target.IsOutputTypeOne());
}

TEST(Preferences, InitialisationReadsTheUIElementAtAnyDepth)
{
    // wxXmlNode's parent constructor puts a node first: AddChild appends.
    wxXmlNode root(wxXML_ELEMENT_NODE, "FilterSetting");
    auto* filter = new wxXmlNode(wxXML_ELEMENT_NODE, "Filter");
    auto* ui = new wxXmlNode(wxXML_ELEMENT_NODE, "UI");
    root.AddChild(filter);
    filter->AddChild(ui);
    hf_test::AddSetting(ui, "OUTPUTFILETYPEEPS", "0");
    hf_test::AddSetting(ui, "IMAGEPOSITION", "Bottom Left");
    hf_test::AddSetting(ui, "FORCEPAGESIZEX", "612");
    auto* twice = new wxXmlNode(wxXML_ELEMENT_NODE, "DEFAULTPAGESIZE");
    ui->AddChild(twice);
    for (const char* text : {"A4", "Letter"}) // the last text wins
        twice->AddChild(new wxXmlNode(wxXML_TEXT_NODE, "text", text));
    ui->AddChild(new wxXmlNode(wxXML_ELEMENT_NODE, "AUTOROTATE")); // no text: the value stays

    EPS eps("x");
    eps.GetSettings()["AUTOROTATE"] = "1";
    eps.GetSettings()["KEPT"] = "as it was";
    EXPECT_EQ(eps.InitilaizeFromPreference(&root), 0);
    EXPECT_FALSE(eps.IsOutputTypeOne());
    EXPECT_EQ(eps.GetSettings()["DEFAULTPAGESIZE"], "Letter");
    EXPECT_EQ(eps.GetSettings()["AUTOROTATE"], "1");
    EXPECT_EQ(eps.GetSettings()["KEPT"], "as it was");
    EXPECT_EQ(eps.GetParams().imagePosition, 0u);
    EXPECT_EQ(eps.GetParams().pageWidth, 612);
    EXPECT_TRUE(eps.GetParams().autoRotate);

    // Without a UI element the parameters are still rebuilt.
    EPS bare("y");
    wxXmlNode empty(wxXML_ELEMENT_NODE, "Filter");
    EXPECT_EQ(bare.InitilaizeFromPreference(&empty), 0);
    EXPECT_TRUE(bare.IsOutputTypeOne());
    EXPECT_EQ(bare.GetParams().pageWidth, 0);
    EXPECT_NE(bare.GetParams().setPageDeviceString, nullptr);
}

TEST(Initialization, ServerFlagsAndPaperLists)
{
    // The hot-folder feature is off, the filter's own feature on.
    const wxString server = testkit::ReadFile(HF_TEST_DATA_DIR "/filter/server-features.xml");
    EPS eps("x");
    EXPECT_EQ(eps.Initialize(server), 0);
    EXPECT_TRUE(eps.IsFilterEnabled());
    EXPECT_TRUE(eps.IsSubstrateFamilySupported());
    ASSERT_EQ(eps.GetSheetList().size(), 2u);
    EXPECT_EQ(eps.GetSheetList()[1].PaperName, "Letter");
    EXPECT_EQ(eps.GetSheetList()[1].Width, 612);
    EXPECT_EQ(eps.GetDefaultSheet().PaperName, "A4");
    EXPECT_EQ(eps.GetCustomPageSizeInfo().MaxMediaWidth, 3456);
    EXPECT_EQ(eps.GetCustomPageSizeInfo().LeftHWMargin, 12);
    EXPECT_EQ(eps.GetServerDescription(), server);

    // An empty text keeps the description and changes nothing learned; a
    // second description appends its sheets.
    EXPECT_EQ(eps.Initialize(""), 0);
    EXPECT_EQ(eps.GetServerDescription(), server);
    EXPECT_TRUE(eps.IsFilterEnabled());
    EXPECT_EQ(eps.GetSheetList().size(), 2u);
    eps.Initialize(server);
    EXPECT_EQ(eps.GetSheetList().size(), 4u);

    // The hot-folder feature takes only its strict words ("True" is none).
    EPS loose("y");
    loose.Initialize("<S><GA2_HOTFOLDERS>True</GA2_HOTFOLDERS></S>");
    EXPECT_FALSE(loose.IsFilterEnabled());
}
