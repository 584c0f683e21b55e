// The rules the configuration value classes hold themselves.
#include <gtest/gtest.h>

#include "FolderFixtures.h"
#include "db/ReadString.h"

using storetest::ParseNode;

TEST(SettingModel, NewSettingHasNoVersionAndEverySwitchOff)
{
    const db::Setting s;
    EXPECT_EQ(s.GetServerVersion(), -1);
    EXPECT_FALSE(s.GetStatusEnable() || s.GetStatusCentralized() || s.GetJobPresetAttched() ||
                 s.GetCustomInterval() || s.IsQuickSetsSupported() || s.IsQuickSetsEnabled() ||
                 s.GetIsWidthBased() || s.IsJobExpertSupported() || s.IsJobExpertEnabled());
    const db::Setting::PairString format("EPS", "Encapsulated");
    EXPECT_EQ(format.GetShortName(), "EPS");
    EXPECT_EQ(format.GetDisplayName(), "Encapsulated");
}

TEST(JobConfigurationModel, SaveGetRemoveAndFlatText)
{
    db::JobConfiguration job;
    wxString value = "untouched", display = "untouched", loc = "untouched";
    EXPECT_FALSE(job.GetProperty("PageSize", value, display, loc));
    EXPECT_EQ(value + display + loc, "untoucheduntoucheduntouched");

    job.SaveProperty("PageSize", "A4", "A4 shown", "A4 lokal");
    job.SaveProperty("PageSize", "A3", "A3 shown", "A3 lokal"); // replaces
    job.SaveProperty("Copies", "2", "two", "zwei");
    ASSERT_TRUE(job.GetProperty("PageSize", value, display, loc));
    EXPECT_EQ(value, "A3");
    EXPECT_EQ(display, "A3 shown");
    EXPECT_EQ(loc, "A3 lokal");
    EXPECT_FALSE(job.GetProperty("pagesize", value, display, loc)); // case-sensitive keys

    wxString text = "prefix\n";
    job.WriteToString(text);
    EXPECT_EQ(text, "prefix\n"
                    "<Key name=\"Copies\" value=\"2\" displayvalue=\"two\"/>\n"
                    "<Key name=\"PageSize\" value=\"A3\" displayvalue=\"A3 shown\"/>\n");

    job.RemoveProperty("Copies");
    EXPECT_EQ(job.GetProperties().size(), 1u);
    job.RemoveAll();
    wxString empty;
    job.WriteToString(empty);
    EXPECT_TRUE(empty.empty());
}

TEST(ImposeConfigurationModel, SaveGetAndFlatText)
{
    db::ImposeConfiguration impose;
    impose.SaveProperty("Layout", "2up", "Two up");
    impose.SaveProperty("Creep", "0.5", "Half");
    wxString value, display;
    ASSERT_TRUE(impose.GetProperty("Layout", value, display));
    EXPECT_EQ(value, "2up");
    EXPECT_EQ(display, "Two up");
    db::ImposeConfiguration::Map copy;
    impose.GetProperties(copy);
    db::ImposeConfiguration other;
    other.SetProperties(copy);
    wxString text;
    other.WriteToString(text);
    EXPECT_EQ(text, "<Key name=\"Creep\" value=\"0.5\" displayvalue=\"Half\"/>\n"
                    "<Key name=\"Layout\" value=\"2up\" displayvalue=\"Two up\"/>\n");
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
