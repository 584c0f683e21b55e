// The panel under a German application language: German labels, "," typed
// and shown, and still "." in every number the map receives.
#include <cstdlib>
#include <filesystem>
#include <fstream>

#include <hotfolder/HFTranslations.h>

#include "PanelTestFixture.h"

using namespace ui_test;

// The client follows the workstation language only as version 3.3; the
// language file and the configuration go to a private home for this run.
void UiTestBeforeToolkit()
{
    namespace fs = std::filesystem;
    const fs::path home = fs::temp_directory_path() / ("hf-ui-german-" + std::to_string(getpid()));
    fs::create_directories(home / "Vomal QDK");
    fs::create_directories(home / "Resources");
    std::ofstream(home / "Vomal QDK" / "current.lang") << "de_DE\n";
    std::ofstream(home / "Resources" / "HFConfig.cfg")
        << "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<HFConfig><Application>"
           "<HFConfiguration><Entry key=\"APP_HF_VERSION\" value=\"3.3\"/></HFConfiguration>"
           "</Application></HFConfig>\n";
    setenv("HOME", home.c_str(), 1);
    setenv("HOTFOLDER_RESOURCES_DIR", (home / "Resources").c_str(), 1);
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
