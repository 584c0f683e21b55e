// The EPS settings panel driven like a user would: load a map, change
// controls, save, and compare everything written.
#include <wx/msgdlg.h>
#include <wx/testing.h>
#include <wx/uiaction.h>

#include "CustomPageSizeDlg.h"
#include "PanelTestFixture.h"

using namespace ui_test;

namespace
{
using Keys = std::map<std::string, std::string>;

// What a save of the untouched defaults writes, with Letter chosen.
Keys LetterDefaults()
{
    return {
        {"OUTPUTFILETYPEEPS", "1"},
        {"OUTPUTFILETYPEPS", "0"},
        {"CUSTOMPAGESIZE", "0"},
        {"DEFAULTPAGESIZE", "Letter"},
        {"ORIENTATIONPOTRAIT", "1"},
        {"ORIENTATIONLANDSCAPE", "0"},
        {"AUTOROTATE", "0"},
        {"IMAGEPOSITION", "Center"},
        {"FORCEPAGESIZEX", "612.000000"},
        {"FORCEPAGESIZEY", "792.000000"},
        {"IMAGEEABLESIZELLX", "10.000000"},
        {"IMAGEEABLESIZELLY", "11.000000"},
        {"IMAGEEABLESIZEURX", "602.000000"},
        {"IMAGEEABLESIZEURY", "781.000000"},
        {"PAGESIZE_COMMAND", "<</PageSize [612 792]>> setpagedevice"},
        // Read on load; an absent key is left behind empty.
        {"CUSTOMPAGEWIDTH", ""},
        {"CUSTOMPAGEHEIGHT", ""},
        {"CUSTOMPAGETUNIT", ""},
        {"ORIGINALSIZE", "1"},
        {"CUSTOMSIZE", "0"},
        {"CONTRAINPROPORTION", "1"},
        {"ORIGINALWIDTHOPTION", "1"},
        {"ORIGINALHEIGHTOPTION", "0"},
        {"ORIGINALWIDTH", "0.25"},
        {"ORIGINALWIDTHUNIT", "inch"},
        {"ORIGINALHEIGHT", "0.25"},
        {"ORIGINALHEIGHTUNIT", "inch"},
        {"FORCEAUTOSCALE", "0"},
        {"FITTOPAGE", "1"},
        {"SHRINKTOFIT", "0"},
        {"SCALETOPRINT", "0"},
    };
}
} // namespace

using SettingsPanel = PanelTest;

TEST_F(SettingsPanel, EmptyMapLoadsEpsOutputWithPageAndImageControlsOff)
{
    Build();
    MapPropToValue settings;
    m_panel->LoadUISettings(settings);

    EXPECT_TRUE(Radio(ID_OUTPUT_EPS_RADIO)->GetValue());
    EXPECT_FALSE(Radio(ID_OUTPUT_PS_RADIO)->GetValue());
    for (int id : std::initializer_list<int>{ID_PAGESIZE_COMBO, ID_CUSTOMPAGESIZE_BUTTON,
                                             ID_IMAGEPOSITION_COMBO, ID_ORIGINALSIZE_RADIO,
                                             ID_CUSTOMSIZE_RADIO, ID_AUTOSCALE_RADIO, ID_WIDTH_TEXT,
                                             ID_FITTOPAGE_RADIO})
        EXPECT_FALSE(Enabled(id)) << id;
    EXPECT_TRUE(Enabled(ID_OUTPUT_PS_RADIO));
    for (const auto& entry : settings)
        EXPECT_TRUE(entry.second.empty()) << entry.first;

    ASSERT_TRUE(Save(settings));
    EXPECT_EQ(LetterDefaults(), Sorted(settings));
}

TEST_F(SettingsPanel, PickingPsEnablesControlsAndResetsToOriginalSizeOnlyOnce)
{
    Build();
    MapPropToValue settings;
    m_panel->LoadUISettings(settings);

    ClickRadio(Radio(ID_OUTPUT_PS_RADIO));
    EXPECT_TRUE(Enabled(ID_PAGESIZE_COMBO));
    EXPECT_TRUE(Enabled(ID_CUSTOMSIZE_RADIO));
    EXPECT_TRUE(Radio(ID_ORIGINALSIZE_RADIO)->GetValue());
    // "Original Size" leaves the custom fields and the scaling choices off.
    EXPECT_FALSE(Enabled(ID_WIDTH_TEXT));
    EXPECT_FALSE(Enabled(ID_FITTOPAGE_RADIO));

    ClickRadio(Radio(ID_CUSTOMSIZE_RADIO));
    EXPECT_TRUE(Enabled(ID_WIDTH_TEXT));
    EXPECT_FALSE(Enabled(ID_HEIGHT_TEXT)); // width drives while constrained
    ClickRadio(Radio(ID_OUTPUT_PS_RADIO)); // again: nothing to undo
    EXPECT_TRUE(Radio(ID_CUSTOMSIZE_RADIO)->GetValue());

    ClickRadio(Radio(ID_OUTPUT_EPS_RADIO));
    EXPECT_FALSE(Enabled(ID_CUSTOMSIZE_RADIO));
    EXPECT_TRUE(Radio(ID_ORIGINALSIZE_RADIO)->GetValue());

    ASSERT_TRUE(Save(settings));
    EXPECT_EQ(LetterDefaults(), Sorted(settings));

    ClickRadio(Radio(ID_OUTPUT_PS_RADIO));
    ClickRadio(Radio(ID_AUTOSCALE_RADIO));
    EXPECT_TRUE(Enabled(ID_SHRINKTOFIT_RADIO));
    ClickRadio(Radio(ID_SHRINKTOFIT_RADIO));
    ToggleCheck(Control<wxCheckBox>(ID_SCALETOPRINT_CHECK));
    SelectComboItem(Combo(ID_IMAGEPOSITION_COMBO), "Bottom Right");
    ASSERT_TRUE(Save(settings));
    Keys expected = LetterDefaults();
    expected["OUTPUTFILETYPEEPS"] = "0";
    expected["OUTPUTFILETYPEPS"] = "1";
    expected["ORIGINALSIZE"] = "0";
    expected["FORCEAUTOSCALE"] = "1";
    expected["FITTOPAGE"] = "0";
    expected["SHRINKTOFIT"] = "1";
    expected["SCALETOPRINT"] = "1";
    expected["IMAGEPOSITION"] = "Bottom Right";
    EXPECT_EQ(expected, Sorted(settings));
}

TEST_F(SettingsPanel, CustomPageSizeIsWrittenInPointsWithATruncatedCommand)
{
    MapPropToValue settings;
    BuildAndLoadPs(settings);

    wxTEST_DIALOG(ClickButton(ID_CUSTOMPAGESIZE_BUTTON), EnterCustomSizeInPoints("595.5", "842.9"));
    EXPECT_EQ("8.27in x 11.71in", Combo(ID_PAGESIZE_COMBO)->GetValue());

    ASSERT_TRUE(Save(settings));
    Keys expected = LetterDefaults();
    expected["OUTPUTFILETYPEEPS"] = "0";
    expected["OUTPUTFILETYPEPS"] = "1";
    expected["CUSTOMPAGESIZE"] = "1";
    expected["DEFAULTPAGESIZE"] = "8.27in x 11.71in";
    expected["FORCEPAGESIZEX"] = "595.500000";
    expected["FORCEPAGESIZEY"] = "842.900000";
    expected["IMAGEEABLESIZELLX"] = "5";
    expected["IMAGEEABLESIZELLY"] = "8";
    expected["IMAGEEABLESIZEURX"] = "589.500000";
    expected["IMAGEEABLESIZEURY"] = "835.900000";
    expected["CUSTOMPAGEWIDTH"] = "595.500000";
    expected["CUSTOMPAGEHEIGHT"] = "842.900000";
    expected["CUSTOMPAGETUNIT"] = "0";
    expected["PAGESIZE_COMMAND"] =
        "\n595 842 0 0 1 pop pop pop 2 array astore << /PageSize 3 -1 roll >> setpagedevice";
    EXPECT_EQ(expected, Sorted(settings));

    // A server paper afterwards replaces the page description again.
    SelectComboItem(Combo(ID_PAGESIZE_COMBO), "A4 (210 x 297 mm)");
    ASSERT_TRUE(Save(settings));
    EXPECT_EQ("0", settings["CUSTOMPAGESIZE"]);
    EXPECT_EQ("A4", settings["DEFAULTPAGESIZE"]);
    EXPECT_EQ("595.280000", settings["FORCEPAGESIZEX"]);
    EXPECT_EQ("827.720000", settings["IMAGEEABLESIZEURY"]);
    EXPECT_EQ("<</PageSize [595 842]>> setpagedevice", settings["PAGESIZE_COMMAND"]);
}

TEST_F(SettingsPanel, CancelledCustomDialogLeavesThePaperChoice)
{
    MapPropToValue settings;
    BuildAndLoadPs(settings);
    const unsigned entries = Combo(ID_PAGESIZE_COMBO)->GetCount();
    wxTEST_DIALOG(ClickButton(ID_CUSTOMPAGESIZE_BUTTON), CancelCustomSize());
    EXPECT_EQ(entries, Combo(ID_PAGESIZE_COMBO)->GetCount());
    EXPECT_FALSE(m_panel->IsCustomPageSize());
    EXPECT_DOUBLE_EQ(612, m_panel->GetCustomWidthPoints());
}

TEST_F(SettingsPanel, StoredCustomPageIsShownInTheStoredUnit)
{
    MapPropToValue settings;
    settings["CUSTOMPAGESIZE"] = "1";
    settings["CUSTOMPAGEWIDTH"] = "612.000000";
    settings["CUSTOMPAGEHEIGHT"] = "792.000000";
    settings["CUSTOMPAGETUNIT"] = "1";
    settings["DEFAULTPAGESIZE"] = "215.90mm x 279.40mm";
    BuildAndLoadPs(settings);
    EXPECT_EQ("215.90mm x 279.40mm", Combo(ID_PAGESIZE_COMBO)->GetValue());
    EXPECT_EQ(UNIT_MM, m_panel->GetCustomPageUnit());

    // An unknown unit keeps the one set before.
    settings["CUSTOMPAGETUNIT"] = "7";
    m_panel->LoadUISettings(settings);
    EXPECT_EQ(UNIT_MM, m_panel->GetCustomPageUnit());

    // A key no sheet has is shown as it stands.
    settings["CUSTOMPAGESIZE"] = "0";
    settings["DEFAULTPAGESIZE"] = "Folio";
    m_panel->LoadUISettings(settings);
    EXPECT_EQ("Folio", m_panel->GetPageSize());
}

TEST_F(SettingsPanel, ImageWidthLimitsAreCheckedOnSave)
{
    MapPropToValue settings;
    BuildAndLoadPs(settings);
    ClickRadio(Radio(ID_CUSTOMSIZE_RADIO));

    TypeText(Text(ID_WIDTH_TEXT), "48");
    ASSERT_TRUE(Save(settings));
    EXPECT_EQ("48", settings["ORIGINALWIDTH"]);

    TypeText(Text(ID_WIDTH_TEXT), "48.01");
    bool saved = true;
    wxTEST_DIALOG(saved = Save(settings), ExpectMessageContaining("(0.25in - 48in)"));
    EXPECT_FALSE(saved);
    EXPECT_EQ("48.01", settings["ORIGINALWIDTH"]); // written before the check
    EXPECT_EQ("0.25", Text(ID_WIDTH_TEXT)->GetValue());
    ASSERT_TRUE(Save(settings));
    EXPECT_EQ("0.25", settings["ORIGINALWIDTH"]);
}

TEST_F(SettingsPanel, ConstrainedHeightIsNotCheckedWhileWidthDrives)
{
    MapPropToValue settings;
    settings["CUSTOMSIZE"] = "1";
    settings["ORIGINALSIZE"] = "0";
    settings["ORIGINALHEIGHT"] = "99";
    BuildAndLoadPs(settings);
    EXPECT_TRUE(Radio(ID_CUSTOMSIZE_RADIO)->GetValue());
    EXPECT_FALSE(Enabled(ID_HEIGHT_TEXT));
    ASSERT_TRUE(Save(settings));

    // Unconstrained, both are checked: the height now fails.
    ToggleCheck(Control<wxCheckBox>(ID_CONSTRAIN_CHECK));
    EXPECT_TRUE(Enabled(ID_HEIGHT_TEXT));
    EXPECT_FALSE(Enabled(ID_WIDTH_RADIO));
    bool saved = true;
    wxTEST_DIALOG(saved = Save(settings), ExpectMessageContaining("Width / Height"));
    EXPECT_FALSE(saved);
    EXPECT_EQ("0.25", Text(ID_HEIGHT_TEXT)->GetValue());
    EXPECT_EQ("0", settings["CONTRAINPROPORTION"]);
}

TEST_F(SettingsPanel, UnitChangeConvertsTheFieldAndMillimetreLimitsApply)
{
    MapPropToValue settings;
    BuildAndLoadPs(settings);
    ClickRadio(Radio(ID_CUSTOMSIZE_RADIO));
    TypeText(Text(ID_WIDTH_TEXT), "8.5");
    SelectComboItem(Combo(ID_WIDTH_UNIT_COMBO), "mm");
    EXPECT_EQ("215.9000", Text(ID_WIDTH_TEXT)->GetValue());
    ASSERT_TRUE(Save(settings));
    EXPECT_EQ("215.9000", settings["ORIGINALWIDTH"]);
    EXPECT_EQ("mm", settings["ORIGINALWIDTHUNIT"]);

    TypeText(Text(ID_WIDTH_TEXT), "4.99");
    bool saved = true;
    wxTEST_DIALOG(saved = Save(settings), ExpectMessageContaining("(5mm - 1220mm)"));
    EXPECT_FALSE(saved);
    EXPECT_EQ("5", Text(ID_WIDTH_TEXT)->GetValue());

    // Height driving: the height field takes over.
    ClickRadio(Radio(ID_HEIGHT_RADIO));
    EXPECT_TRUE(Enabled(ID_HEIGHT_TEXT));
    EXPECT_FALSE(Enabled(ID_WIDTH_TEXT));
    ASSERT_TRUE(Save(settings));
    EXPECT_EQ("0", settings["ORIGINALWIDTHOPTION"]);
    EXPECT_EQ("1", settings["ORIGINALHEIGHTOPTION"]);
}

TEST_F(SettingsPanel, ValidatorsMoveValuesBetweenMembersAndControls)
{
    MapPropToValue settings;
    settings["FITTOPAGE"] = "0";
    settings["SHRINKTOFIT"] = "1";
    settings["IMAGEPOSITION"] = "Top Left";
    settings["ORIGINALWIDTH"] = "3.5";
    BuildAndLoadPs(settings);
    EXPECT_TRUE(Radio(ID_SHRINKTOFIT_RADIO)->GetValue());
    EXPECT_EQ("Top Left", Combo(ID_IMAGEPOSITION_COMBO)->GetValue());
    EXPECT_EQ("3.5", Text(ID_WIDTH_TEXT)->GetValue());

    // Controls changed without events reach the map only through the validators.
    Radio(ID_FITTOPAGE_RADIO)->SetValue(true);
    Combo(ID_IMAGEPOSITION_COMBO)->SetStringSelection("Top Right");
    Text(ID_WIDTH_TEXT)->ChangeValue("7.25");
    Control<wxCheckBox>(ID_SCALETOPRINT_CHECK)->SetValue(true);
    ASSERT_TRUE(Save(settings));
    EXPECT_EQ("1", settings["FITTOPAGE"]);
    EXPECT_EQ("0", settings["SHRINKTOFIT"]);
    EXPECT_EQ("Top Right", settings["IMAGEPOSITION"]);
    EXPECT_EQ("7.25", settings["ORIGINALWIDTH"]);
    EXPECT_EQ("1", settings["SCALETOPRINT"]);
}

TEST_F(SettingsPanel, ServerPreferringPointsShowsImageFieldsInTheSystemUnit)
{
    Build(true, "ui/server-ui-points.xml");
    EXPECT_EQ("mm", m_panel->GetMeasurementUnit());
    MapPropToValue settings;
    m_panel->LoadUISettings(settings);
    EXPECT_EQ("6.35", Text(ID_WIDTH_TEXT)->GetValue());
    EXPECT_EQ("mm", Combo(ID_WIDTH_UNIT_COMBO)->GetValue());
}

TEST_F(SettingsPanel, DisabledFilterShowsHeaderAndInputTypeOnlyAndTouchesNoKey)
{
    Build(false);
    EXPECT_EQ(nullptr, m_panel->FindWindow(ID_ORIGINALSIZE_RADIO));
    EXPECT_EQ(nullptr, m_panel->FindWindow(ID_PAGESIZE_COMBO));
    EXPECT_EQ(nullptr, m_panel->FindWindow(ID_OUTPUT_EPS_RADIO));
    ASSERT_NE(nullptr, m_panel->FindWindow(ID_INPUT_FILETYPE_TEXT));
    EXPECT_EQ(".eps", m_panel->FindWindow(ID_INPUT_FILETYPE_TEXT)->GetLabel());
    EXPECT_EQ(4u, m_panel->GetChildren().size()); // header strip, box, label and text
    MapPropToValue settings;
    settings["OUTPUTFILETYPEEPS"] = "0";
    EXPECT_TRUE(m_panel->LoadUISettings(settings));
    EXPECT_TRUE(Save(settings));
    EXPECT_EQ((Keys{{"OUTPUTFILETYPEEPS", "0"}}), Sorted(settings));
}

TEST_F(SettingsPanel, TabOrderFollowsTheLayout)
{
    MapPropToValue settings;
    settings["ORIGINALSIZE"] = "0";
    settings["CUSTOMSIZE"] = "1";
    settings["CONTRAINPROPORTION"] = "0";
    BuildAndLoadPs(settings);

    // The toolkit tabs through the panel's children in list order.
    std::vector<int> order;
    for (wxWindow* child : m_panel->GetChildren())
        if (child->GetId() >= ID_PAGESIZE_COMBO && child->GetId() <= ID_OUTPUT_EPS_RADIO)
            order.push_back(child->GetId());
    const std::vector<int> expected = {
        ID_ORIGINALSIZE_RADIO,    ID_CUSTOMSIZE_RADIO,    ID_CONSTRAIN_CHECK,
        ID_WIDTH_RADIO,           ID_WIDTH_TEXT,          ID_WIDTH_UNIT_COMBO,
        ID_HEIGHT_RADIO,          ID_HEIGHT_TEXT,         ID_HEIGHT_UNIT_COMBO,
        ID_AUTOSCALE_RADIO,       ID_FITTOPAGE_RADIO,     ID_SHRINKTOFIT_RADIO,
        ID_SCALETOPRINT_CHECK,    ID_PAGESIZE_LABEL,      ID_PAGESIZE_COMBO,
        ID_CUSTOMPAGESIZE_BUTTON, ID_IMAGEPOSITION_LABEL, ID_IMAGEPOSITION_COMBO,
        ID_OUTPUT_EPS_RADIO,      ID_OUTPUT_PS_RADIO};
    EXPECT_EQ(expected, order);

    // One real Tab: from the width field to its unit list.
    wxTextCtrl* width = Text(ID_WIDTH_TEXT);
    width->SetFocus();
    for (int i = 0; i < 40 && wxWindow::FindFocus() != width; ++i)
        Pump(25);
    if (wxWindow::FindFocus() != width)
        GTEST_SKIP() << "the display gives no keyboard focus";
    wxUIActionSimulator().Char(WXK_TAB);
    Pump(200);
    wxWindow* focus = wxWindow::FindFocus();
    ASSERT_NE(nullptr, focus);
    EXPECT_TRUE(focus == Combo(ID_WIDTH_UNIT_COMBO) ||
                focus->GetParent() == Combo(ID_WIDTH_UNIT_COMBO))
        << focus->GetId();
}
