// The panel under a German application language: German labels, "," typed
// and shown, and still "." in every number the map receives.
#include <cstdlib>
#include <filesystem>

#include <hotfolder/HFTranslations.h>

#include "GermanClient.h"
#include "PanelTestFixture.h"

using namespace ui_test;

void UiTestBeforeToolkit()
{
    static const std::filesystem::path home = UseGermanClientConfiguration("ui-german");
    std::atexit([] { std::filesystem::remove_all(home); });
}

class GermanPanel : public PanelTest
{
protected:
    void SetUp() override
    {
        PanelTest::SetUp();
        if (IsSkipped())
            return;
        ASSERT_TRUE(HFTranslations::GetInstance()->SelectLanguage("de"));
    }
    void TearDown() override
    {
        HFTranslations::GetInstance()->SelectLanguage("en");
        PanelTest::TearDown();
    }
};

TEST_F(GermanPanel, LabelsAreGermanAndNumbersAreStoredWithAPoint)
{
    Build();
    EXPECT_EQ(",", m_panel->GetDecimalSeparator());
    EXPECT_EQ(wxString::FromUTF8("Originalgröße"), Radio(ID_ORIGINALSIZE_RADIO)->GetLabel());
    EXPECT_EQ("Benutzerdefiniert...", m_panel->FindWindow(ID_CUSTOMPAGESIZE_BUTTON)->GetLabel());
    EXPECT_EQ("Zoll", Combo(ID_WIDTH_UNIT_COMBO)->GetString(0));

    MapPropToValue settings;
    settings["OUTPUTFILETYPEEPS"] = "0";
    settings["ORIGINALSIZE"] = "0";
    settings["CUSTOMSIZE"] = "1";
    settings["ORIGINALWIDTH"] = "8.5";
    settings["ORIGINALWIDTHUNIT"] = "Zoll";
    m_panel->LoadUISettings(settings);
    EXPECT_EQ("8,5", Text(ID_WIDTH_TEXT)->GetValue());
    EXPECT_EQ("Mitte", Combo(ID_IMAGEPOSITION_COMBO)->GetValue());

    TypeText(Text(ID_WIDTH_TEXT), "12,75");
    wxTEST_DIALOG(ClickButton(ID_CUSTOMPAGESIZE_BUTTON), EnterCustomSizeInPoints("595.5", "842.9"));
    ASSERT_TRUE(Save(settings));
    EXPECT_EQ("12.75", settings["ORIGINALWIDTH"]);
    EXPECT_EQ("Zoll", settings["ORIGINALWIDTHUNIT"]);
    EXPECT_EQ("0.25", settings["ORIGINALHEIGHT"]);
    EXPECT_EQ("Mitte", settings["IMAGEPOSITION"]);
    EXPECT_EQ("595.500000", settings["FORCEPAGESIZEX"]);
    EXPECT_EQ("842.900000", settings["CUSTOMPAGEHEIGHT"]);
    EXPECT_EQ("589.500000", settings["IMAGEEABLESIZEURX"]);
    EXPECT_EQ("8.27in x 11.71in", settings["DEFAULTPAGESIZE"]);
    EXPECT_TRUE(settings["PAGESIZE_COMMAND"].StartsWith("\n595 842 0 0 1"));
    for (const auto& entry : settings)
        EXPECT_FALSE(entry.second.Contains(",")) << entry.first;

    TypeText(Text(ID_WIDTH_TEXT), "48,01");
    bool saved = true;
    wxTEST_DIALOG(saved = Save(settings), ExpectMessageContaining("(0.25in - 48in)"));
    EXPECT_FALSE(saved);
    EXPECT_EQ("0,25", Text(ID_WIDTH_TEXT)->GetValue());
    EXPECT_EQ("48.01", settings["ORIGINALWIDTH"]);
}
