// Panel logic that needs no window: enabling rules, page keys, range checks,
// separator exchange and the custom size keystroke filter.
#include <memory>

#include <gtest/gtest.h>
#include <wx/init.h>

#include "ControlIds.h"
#include "EnablingRules.h"
#include "ImageDimensionRange.h"
#include "PageSizeKeys.h"
#include "SizeKeystrokeFilter.h"
#include "UiText.h"

namespace
{
// The translation service finds its catalogues through the application object.
class ToolkitBase : public ::testing::Environment
{
public:
    void SetUp() override { m_init = std::make_unique<wxInitializer>(); }
    void TearDown() override { m_init.reset(); }

private:
    std::unique_ptr<wxInitializer> m_init;
};
::testing::Environment* const g_toolkit = ::testing::AddGlobalTestEnvironment(new ToolkitBase);
} // namespace

TEST(EnablingRules, CustomSizeLeavesOnlyTheDrivingFieldEditable)
{
    EnableRequests requests;
    CustomSizeSelectionRule(requests, true, true, false);
    EXPECT_EQ(1, RequestedState(requests, ID_WIDTH_TEXT));
    EXPECT_EQ(1, RequestedState(requests, ID_WIDTH_UNIT_COMBO));
    EXPECT_EQ(0, RequestedState(requests, ID_HEIGHT_TEXT));
    EXPECT_EQ(0, RequestedState(requests, ID_HEIGHT_UNIT_COMBO));
    EXPECT_EQ(1, RequestedState(requests, ID_CONSTRAIN_CHECK));

    requests.clear();
    CustomSizeSelectionRule(requests, true, false, true);
    EXPECT_EQ(0, RequestedState(requests, ID_WIDTH_TEXT));
    EXPECT_EQ(1, RequestedState(requests, ID_HEIGHT_TEXT));

    requests.clear();
    CustomSizeSelectionRule(requests, false, true, false);
    for (int id : {ID_CONSTRAIN_CHECK, ID_WIDTH_RADIO, ID_HEIGHT_RADIO, ID_WIDTH_TEXT,
                   ID_HEIGHT_TEXT, ID_WIDTH_UNIT_COMBO, ID_HEIGHT_UNIT_COMBO})
        EXPECT_EQ(0, RequestedState(requests, id)) << id;
    EXPECT_EQ(-1, RequestedState(requests, ID_FITTOPAGE_RADIO));
}

TEST(EnablingRules, ConstrainOffFreesBothDimensionsAndHidesTheChoice)
{
    EnableRequests requests;
    ConstrainSelectionRule(requests, false, true, true, false);
    EXPECT_EQ(1, RequestedState(requests, ID_WIDTH_TEXT));
    EXPECT_EQ(1, RequestedState(requests, ID_HEIGHT_TEXT));
    EXPECT_EQ(0, RequestedState(requests, ID_WIDTH_RADIO));
    EXPECT_EQ(0, RequestedState(requests, ID_HEIGHT_RADIO));

    requests.clear();
    ConstrainSelectionRule(requests, true, true, true, false);
    EXPECT_EQ(1, RequestedState(requests, ID_WIDTH_RADIO));
    EXPECT_EQ(0, RequestedState(requests, ID_HEIGHT_TEXT));
}

TEST(EnablingRules, OutputTypeSwitchesEveryPageAndImageControl)
{
    EnableRequests requests;
    PageAndImageGroupRule(requests, false);
    for (int id : std::initializer_list<int>{
             ID_PAGESIZE_COMBO, ID_CUSTOMPAGESIZE_BUTTON, ID_IMAGEPOSITION_LABEL,
             ID_IMAGEPOSITION_COMBO, ID_PAGESIZE_LABEL, ID_ORIGINALSIZE_RADIO, ID_CUSTOMSIZE_RADIO,
             ID_AUTOSCALE_RADIO, ID_SCALETOPRINT_CHECK})
        EXPECT_EQ(0, RequestedState(requests, id)) << id;
    EXPECT_EQ(-1, RequestedState(requests, ID_OUTPUT_PS_RADIO));
}

TEST(PageSizeKeys, CustomSizeIsTruncatedInTheCommandAndKeptInTheBox)
{
    stCustomPageSizeAttribute custom;
    custom.LeftHWMargin = 5;
    custom.RightHWMargin = 6;
    custom.TopHWMargin = 7;
    custom.BottomHWMargin = 8;
    custom.command = " pop pop setpagedevice";
    MapPropToValue settings;
    WriteCustomPageKeys(settings, 595.5, 842.9, custom, UNIT_MM);

    EXPECT_EQ("595.500000", settings["FORCEPAGESIZEX"]);
    EXPECT_EQ("842.900000", settings["FORCEPAGESIZEY"]);
    EXPECT_EQ("5", settings["IMAGEEABLESIZELLX"]);
    EXPECT_EQ("8", settings["IMAGEEABLESIZELLY"]);
    EXPECT_EQ("589.500000", settings["IMAGEEABLESIZEURX"]);
    EXPECT_EQ("835.900000", settings["IMAGEEABLESIZEURY"]);
    EXPECT_EQ("595.500000", settings["CUSTOMPAGEWIDTH"]);
    EXPECT_EQ("842.900000", settings["CUSTOMPAGEHEIGHT"]);
    EXPECT_EQ("1", settings["CUSTOMPAGETUNIT"]);
    EXPECT_EQ("1", settings["CUSTOMPAGESIZE"]);
    EXPECT_EQ("\n595 842 0 0 1 pop pop setpagedevice", settings["PAGESIZE_COMMAND"]);
    EXPECT_EQ(11u, settings.size());
}

TEST(PageSizeKeys, SheetLookupIsCaseSensitiveAndTakesTheFirstMatch)
{
    std::vector<stPageAttribute> sheets(3);
    sheets[0].PaperName = "Letter";
    sheets[0].PaperDisplayName = "Letter";
    sheets[1].PaperName = "A4";
    sheets[1].PaperDisplayName = "A4 paper";
    sheets[2].PaperName = "A4b";
    sheets[2].PaperDisplayName = "A4 paper";
    EXPECT_EQ(&sheets[1], FindSheetByDisplayName(sheets, "A4 paper"));
    EXPECT_EQ(nullptr, FindSheetByDisplayName(sheets, "a4 paper"));
    EXPECT_EQ(&sheets[2], FindSheetByPaperName(sheets, "A4b"));
    EXPECT_EQ(nullptr, FindSheetByPaperName(sheets, "A5"));

    EXPECT_EQ("8.50in x 11.00in", CustomPageEntryText(8.5, 11, UNIT_INCH));
    EXPECT_EQ("215.90mm x 279.40mm", CustomPageEntryText(215.9, 279.4, UNIT_MM));
}

TEST(ImageDimensionRange, InchAndMillimetreLimitsAreInclusiveAndNotSymmetric)
{
    EXPECT_TRUE(CheckImageDimension(48, "inch").valid);
    EXPECT_TRUE(CheckImageDimension(0.25, "inch").valid);
    const ImageDimensionCheck tooWide = CheckImageDimension(48.01, "inch");
    EXPECT_FALSE(tooWide.valid);
    EXPECT_EQ("(0.25in - 48in)", tooWide.rangeText);
    EXPECT_EQ("0.25", tooWide.resetText);
    EXPECT_FALSE(CheckImageDimension(0.24, "INCH").valid);

    EXPECT_TRUE(CheckImageDimension(5, "mm").valid);
    EXPECT_TRUE(CheckImageDimension(6, "mm").valid); // below a quarter inch, still accepted
    EXPECT_TRUE(CheckImageDimension(1220, "mm").valid);
    const ImageDimensionCheck tooSmall = CheckImageDimension(4.99, "mm");
    EXPECT_FALSE(tooSmall.valid);
    EXPECT_EQ("(5mm - 1220mm)", tooSmall.rangeText);
    EXPECT_EQ("5", tooSmall.resetText);

    EXPECT_TRUE(CheckImageDimension(-3, "point").valid);
}

TEST(ImageDimensionRange, SeparatorExchangeBothWays)
{
    EXPECT_EQ("8.5", ExchangeDecimalSeparator("8,5", ",", true));
    EXPECT_EQ("8,5", ExchangeDecimalSeparator("8.5", ",", false));
    EXPECT_EQ("8,5", ExchangeDecimalSeparator("8,5", ".", true));
    EXPECT_EQ("8.5", ExchangeDecimalSeparator("8.5", ".", false));
}

TEST(PlaceHolders, ReplacedInOrderOnlyWhenTheListsMatch)
{
    wxArrayString placeholders, replacements;
    placeholders.Add("[A]");
    placeholders.Add("[B]");
    replacements.Add("1");
    wxString message = "[A] and [B] and [A]";
    ReplacePlaceHolderString(message, placeholders, replacements);
    EXPECT_EQ("[A] and [B] and [A]", message);

    replacements.Add("2");
    ReplacePlaceHolderString(message, placeholders, replacements);
    EXPECT_EQ("1 and 2 and [A]", message);
}

namespace
{
// Types `text` character by character, as the field sees it.
SizeKeystrokeResult TypeInto(wxString field, const wxString& typed, double maximum,
                             const wxString& point = ".")
{
    SizeKeystrokeResult result;
    result.text = field;
    result.insertion = field.length();
    result.lastAccepted = field;
    for (wxUniChar ch : typed)
    {
        wxString text = result.text;
        text.insert(result.insertion, 1, ch);
        result =
            FilterSizeKeystroke(text, result.insertion + 1, point, maximum, result.lastAccepted);
    }
    return result;
}
} // namespace

TEST(SizeKeystrokeFilter, ValueAboveTheMaximumRevertsToTheLastAcceptedText)
{
    const SizeKeystrokeResult result = TypeInto("", "1001", 1000);
    EXPECT_EQ("100", result.text);
    EXPECT_EQ(3, result.insertion);
    EXPECT_EQ("1000", TypeInto("", "1000", 1000).text);
}

TEST(SizeKeystrokeFilter, LettersSecondSeparatorAndThirdDecimalAreUndone)
{
    EXPECT_EQ("12", TypeInto("", "1a2", 1000).text);
    EXPECT_EQ("1.5", TypeInto("", "1.5.", 1000).text);
    EXPECT_EQ("1.25", TypeInto("", "1.257", 1000).text);
    EXPECT_EQ("1,25", TypeInto("", "1,257", 1000, ",").text);
    EXPECT_EQ("15", TypeInto("", "1.5", 1000, ",").text); // "." is not this locale's point
    EXPECT_EQ("8", TypeInto("", "-8e", 1000).text);
}

TEST(SizeKeystrokeFilter, EditInTheMiddleRemovesTheTypedCharacterOnly)
{
    const SizeKeystrokeResult result = FilterSizeKeystroke("1x23", 2, ".", 1000, "123");
    EXPECT_EQ("123", result.text);
    EXPECT_EQ(1, result.insertion);
    EXPECT_DOUBLE_EQ(12.5, ParseSizeField("12,5", ","));
    EXPECT_TRUE(IsSeparatorAlreadyEntered("1,2,", ","));
    EXPECT_FALSE(IsSeparatorAlreadyEntered("1,2", ","));
}
