// The rules the configuration value classes hold themselves.
#include <gtest/gtest.h>

#include "FolderFixtures.h"
#include "db/PluginInitialize.h"
#include "db/ReadString.h"

using storetest::ParseNode;

TEST(KeyedConfigurations, ReplaceByExactKeyAndListAsKeyLines)
{
    db::JobConfiguration job;
    wxString value = "untouched", display = "untouched", loc = "untouched";
    EXPECT_FALSE(job.GetProperty("PageSize", value, display, loc));
    EXPECT_EQ(value + display + loc, "untoucheduntoucheduntouched");
    job.SaveProperty("PageSize", "A4", "A4 shown", "A4 lokal");
    job.SaveProperty("PageSize", "A3", "A3 shown", "A3 lokal"); // replaces
    job.SaveProperty("Copies", "2", "two", "zwei");
    ASSERT_TRUE(job.GetProperty("PageSize", value, display, loc));
    EXPECT_EQ(value + "|" + display + "|" + loc, "A3|A3 shown|A3 lokal");
    EXPECT_FALSE(job.GetProperty("pagesize", value, display, loc)); // case-sensitive keys
    wxString text = "prefix\n";
    job.WriteToString(text);
    EXPECT_EQ(text, "prefix\n"
                    "<Key name=\"Copies\" value=\"2\" displayvalue=\"two\"/>\n"
                    "<Key name=\"PageSize\" value=\"A3\" displayvalue=\"A3 shown\"/>\n");
    // Texts differing in one part only are different.
    EXPECT_FALSE(db::JobSettingTexts("v", "d", "l") == db::JobSettingTexts("v", "d", "x"));
    EXPECT_FALSE(db::SettingTexts("v", "d") == db::SettingTexts("v", "x"));

    db::ImposeConfiguration impose;
    impose.SaveProperty("Layout", "2up", "Two up");
    ASSERT_TRUE(impose.GetProperty("Layout", value, display));
    EXPECT_EQ(value + "|" + display, "2up|Two up");
    EXPECT_FALSE(impose.GetProperty("Creep", value, display));
}

TEST(PreflightModel, FirstStatusEntryDecidesWithoutRegardToCase)
{
    db::PreflightConfiguration preflight;
    EXPECT_FALSE(preflight.IsPreflightEnabled());
    preflight.AddProperty("Profile", "true");
    EXPECT_FALSE(preflight.IsPreflightEnabled());
    preflight.AddProperty("STATUS", "TRUE");
    EXPECT_TRUE(preflight.IsPreflightEnabled());
    preflight.SetProperties({{"Status", "yes"}, {"Status", "true"}});
    EXPECT_FALSE(preflight.IsPreflightEnabled());
    // Entries are equal only when key and value are.
    using Entry = db::PreflightConfiguration::PairString;
    EXPECT_FALSE(Entry("Status", "TRUE") == Entry("Status", "false"));
    EXPECT_FALSE(Entry("Status", "TRUE") == Entry("Profile", "TRUE"));
    EXPECT_FALSE(db::Setting::PairString("EPS", "a") == db::Setting::PairString("EPS", "b"));
}

namespace
{
db::PreflightConfiguration::List PreflightEntries(const std::string& text)
{
    db::PreflightConfiguration::List entries;
    if (text != "-")
        for (const std::string& entry : testkit::Split(text, "; "))
            entries.emplace_back(entry.substr(0, entry.find('=')),
                                 entry.substr(entry.find('=') + 1));
    return entries;
}

std::string Shown(const db::PreflightConfiguration::List& entries)
{
    std::string text;
    for (const auto& entry : entries)
        text += (text.empty() ? "" : "; ") + entry.GetKey().ToStdString() + "=" +
                entry.GetValue().ToStdString();
    return text.empty() ? "-" : text;
}
} // namespace

TEST(PreflightModel, TheSwitchSetsTheDecidingEntryAndKeepsTheOthers)
{
    for (const testkit::CaseFields& c : testkit::Cases("store/preflight-switch.txt", 4, 4))
    {
        SCOPED_TRACE(c[0] + " | " + c[3]);
        db::PreflightConfiguration preflight;
        preflight.SetProperties(PreflightEntries(c[0]));
        preflight.SetPreflightEnabled(c[1] == "on");
        EXPECT_EQ(Shown(preflight.GetProperties()), c[2]);
        EXPECT_EQ(preflight.IsPreflightEnabled(), c[1] == "on");
    }
}

TEST(FilterOutputFormat, DecidedByTheFilterOwnSettings)
{
    db::FilterConfiguration filter;
    filter.SetFilterSettingNode(ParseNode(
        "<FilterSetting>"
        "<Filter name='Orv.EPS.1 '><UI><OUTPUTFILETYPEEPS>0</OUTPUTFILETYPEEPS>"
        "<OUTPUTFILETYPEPS>0</OUTPUTFILETYPEPS></UI></Filter>"
        "<Filter name='Orv.TIFF.1'><UI><OUTPUTFILETYPETIFF>0</OUTPUTFILETYPETIFF>"
        "<OUTPUTFILETYPETIFF>1</OUTPUTFILETYPETIFF></UI></Filter>"
        "<Filter name='Orv.PDF.1'><UI><OUTPUTFILETYPEPS>1</OUTPUTFILETYPEPS></UI></Filter>"
        "<Filter name='Orv.Office.1'><NoUI/></Filter>"
        "<Filter name='Orv.Office.1'><UI><OUTPUTFILETYPEPS>1</OUTPUTFILETYPEPS></UI></Filter>"
        "</FilterSetting>"));
    EXPECT_EQ(filter.GetOutputFormatForFilter("Orv.EPS.1", "X"), "PDF");
    EXPECT_EQ(filter.GetOutputFormatForFilter("Orv.TIFF.1", "X"), "TIFF"); // some child holds "1"
    EXPECT_EQ(filter.GetOutputFormatForFilter("Orv.PDF.1", "PDF/X"), "PDF/X");
    EXPECT_EQ(filter.GetOutputFormatForFilter("Orv.Office.1", "X"), "PS"); // later sibling
    EXPECT_EQ(filter.GetOutputFormatForFilter("Orv.eps.1", "X"), "");
    EXPECT_EQ(db::FilterConfiguration().GetOutputFormatForFilter("Orv.PDF.1", "PDF"), "");
    filter.SetFilterSettingNode(
        ParseNode("<FilterSetting><Filter name='Orv.EPS.1'><UI><OUTPUTFILETYPEEPS>1"
                  "</OUTPUTFILETYPEEPS><OUTPUTFILETYPEPS>1</OUTPUTFILETYPEPS></UI></Filter>"
                  "</FilterSetting>"));
    EXPECT_EQ(filter.GetOutputFormatForFilter("Orv.EPS.1", "X"), "EPS");
}

TEST(ReadStringHelper, CopiesOnlyPresentKeys)
{
    StdStrAttributeMap map;
    map[L"key"] = L"value";
    wxString out = "before";
    EXPECT_FALSE(db::ReadString(map, L"missing", out));
    EXPECT_EQ(out, "before");
    EXPECT_TRUE(db::ReadString(map, L"key", out));
    EXPECT_EQ(out, "value");
}

// A server that names no hardware margin has none: the custom page's
// printable area is the whole sheet.
TEST(CustomPageLimits, MarginsTheServerDoesNotNameAreZero)
{
    stCustomPageSizeAttribute custom;
    ASSERT_TRUE(PluginInitialize::InitializeCustomPageSizeInfo(
        "<S><CustomPageSizeInfo><MaxMediaWidth>900</MaxMediaWidth></CustomPageSizeInfo></S>",
        custom));
    EXPECT_EQ(custom.MaxMediaWidth, 900);
    EXPECT_EQ(custom.LeftHWMargin + custom.RightHWMargin, 0);
    EXPECT_EQ(custom.TopHWMargin + custom.BottomHWMargin, 0);
}
