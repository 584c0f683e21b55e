// The filter's settings in the host's preference XML, and what the server
// description switches on.
#include <gtest/gtest.h>
#include <wx/sstream.h>
#include <wx/xml/xml.h>

#include "EPS.h"

namespace
{
wxXmlNode* Element(wxXmlNode* parent, const wxString& name, const wxString& text = wxString())
{
    auto* node = new wxXmlNode(wxXML_ELEMENT_NODE, name);
    if (!text.empty())
        node->AddChild(new wxXmlNode(wxXML_TEXT_NODE, "text", text));
    if (parent)
        parent->AddChild(node);
    return node;
}
} // namespace

TEST(Preferences, SaveThenLoadRestoresEverySetting)
{
    EPS source("a");
    source.GetSettings()["PAGESIZE_COMMAND"] = "\n595 842 0 0 1 setpagesize";
    source.GetSettings()["IMAGEPOSITION"] = "Top Left";
    source.GetSettings()["FORCEPAGESIZEX"] = "595.500000";
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

    EPS target("b");
    EXPECT_EQ(target.LoadPreference(&host), 0);
    for (const auto& entry : source.GetSettings())
        EXPECT_EQ(target.GetSettings()[entry.first], entry.second) << entry.first;
    // Loading alone leaves the parameters as constructed.
    EXPECT_EQ(target.GetParams().imagePosition, 4u);
    EXPECT_EQ(target.GetParams().setPageDeviceString, nullptr);
    EXPECT_FALSE(target.IsOutputTypeOne());
}

TEST(Preferences, SavingTwiceAppendsAndLoadingUsesTheFirst)
{
    EPS eps("a");
    wxXmlNode host(wxXML_ELEMENT_NODE, "Filter");
    eps.GetSettings()["DEFAULTPAGESIZE"] = "A4";
    eps.SavePreference(&host);
    eps.GetSettings()["DEFAULTPAGESIZE"] = "Letter";
    eps.SavePreference(&host);
    ASSERT_NE(host.GetChildren()->GetNext(), nullptr);
    EXPECT_EQ(host.GetChildren()->GetNext()->GetName(), "UI");

    EPS reader("b");
    reader.LoadPreference(&host);
    EXPECT_EQ(reader.GetSettings()["DEFAULTPAGESIZE"], "A4");
}

TEST(Preferences, InitialisationReadsTheUIElementAtAnyDepth)
{
    wxXmlNode root(wxXML_ELEMENT_NODE, "FilterSetting");
    wxXmlNode* filter = Element(&root, "Filter");
    wxXmlNode* ui = Element(filter, "UI");
    Element(ui, "OUTPUTFILETYPEEPS", "0");
    Element(ui, "IMAGEPOSITION", "Bottom Left");
    Element(ui, "FORCEPAGESIZEX", "612");
    wxXmlNode* twice = Element(ui, "DEFAULTPAGESIZE", "A4");
    twice->AddChild(new wxXmlNode(wxXML_TEXT_NODE, "text", "Letter")); // the last one wins
    Element(ui, "AUTOROTATE"); // no content: the setting keeps its value

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
}

TEST(Preferences, WithoutUIStillRebuildsFromConstructorSettings)
{
    EPS eps("x");
    wxXmlNode empty(wxXML_ELEMENT_NODE, "Filter");
    EXPECT_EQ(eps.InitilaizeFromPreference(&empty), 0);
    EXPECT_TRUE(eps.IsOutputTypeOne());
    EXPECT_EQ(eps.GetParams().pageWidth, 0); // the page follows the (absent) settings
    EXPECT_NE(eps.GetParams().setPageDeviceString, nullptr);
}

TEST(Initialization, ServerFlagsAndPaperLists)
{
    const wxString server =
        "<Server><Features><GA2_HOTFOLDERS>no</GA2_HOTFOLDERS><HF_EPS_FILTER>On</HF_EPS_FILTER>"
        "<SubstrateFamilySupported>2</SubstrateFamilySupported></Features>"
        "<SheetInfo><PaperName>A4</PaperName><Width>595</Width><Height>842</Height>"
        "<PSCommand>a4</PSCommand><PaperName>Letter</PaperName><Width>612</Width>"
        "<Height>792</Height><PSCommand>letter</PSCommand></SheetInfo>"
        "<DefaultPPDPageSize><PaperName>A4</PaperName><Width>595</Width></DefaultPPDPageSize>"
        "<CustomPageSizeInfo><MaxMediaWidth>3456</MaxMediaWidth><LeftHWMargin>12</LeftHWMargin>"
        "</CustomPageSizeInfo></Server>";
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

    // An empty text keeps the description and changes nothing learned.
    EXPECT_EQ(eps.Initialize(""), 0);
    EXPECT_EQ(eps.GetServerDescription(), server);
    EXPECT_TRUE(eps.IsFilterEnabled());
    EXPECT_EQ(eps.GetSheetList().size(), 2u);
    // A second description appends its sheets.
    eps.Initialize(server);
    EXPECT_EQ(eps.GetSheetList().size(), 4u);
}

TEST(Initialization, StrictFlagForTheHotFolderFeature)
{
    EPS loose("x"), strict("y"), none("z");
    loose.Initialize("<S><GA2_HOTFOLDERS>True</GA2_HOTFOLDERS></S>");
    EXPECT_FALSE(loose.IsFilterEnabled()); // "True" is not one of the strict words
    strict.Initialize("<S><GA2_HOTFOLDERS>true</GA2_HOTFOLDERS></S>");
    EXPECT_TRUE(strict.IsFilterEnabled());
    none.Initialize("<not xml");
    EXPECT_FALSE(none.IsFilterEnabled());
    EXPECT_FALSE(none.IsSubstrateFamilySupported());
}
