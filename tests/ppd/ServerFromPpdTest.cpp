// Server descriptions made from printer descriptions, compared byte for byte
// with a reviewed golden description per printer.
#include <gtest/gtest.h>

#include "PpdCases.h"
#include "ServerFromPpd.h"

using printing::ServerDescriptionFromPpd;

namespace
{
std::string Described(const std::string& ppd)
{
    wxString xml;
    std::string error;
    EXPECT_TRUE(ServerDescriptionFromPpd(ppd, xml, error)) << error;
    return std::string(xml.utf8_str());
}
} // namespace

TEST(ServerFromPpd, EachPrinterOfTheTableGivesItsGoldenDescription)
{
    testkit::ScratchDir dir;
    size_t checked = 0;
    for (const testkit::CaseFields& row : testkit::ReadCaseTable("ppd/descriptions.txt"))
    {
        SCOPED_TRACE(row[0] + ": " + row.back());
        const std::string ppd = ppd_cases::Resolve(row[0], dir.Path());
        if (ppd.empty())
        {
            std::printf("skipped (not installed): %s\n", row[0].c_str());
            continue;
        }
        EXPECT_EQ(Described(ppd), testkit::ReadFile(ppd_cases::Data(row[1])));
        ++checked;
    }
    EXPECT_GE(checked, 2u);
}

TEST(ServerFromPpd, NumbersUseFullStopUnderCommaLocale)
{
    TESTKIT_USE_LOCALE(comma, "de_DE.UTF-8");
    EXPECT_EQ(Described(ppd_cases::TestPpd()),
              testkit::ReadFile(ppd_cases::Data("test-postscript.xml")));
}

TEST(ServerFromPpd, UnreadableDescriptionsFailAndLeaveTheOutputAlone)
{
    testkit::ScratchDir dir;
    testkit::WriteFile(dir.File("letter.ppd"), "Dear printer,\nthis is not a description.\n");
    testkit::WriteFile(dir.File("nopages.ppd"), "*PPD-Adobe: \"4.3\"\n*FormatVersion: \"4.3\"\n"
                                                "*ModelName: \"Blank\"\n*NickName: \"Blank\"\n");
    for (const char* name : {"missing.ppd", "letter.ppd", "nopages.ppd"})
    {
        wxString xml = "untouched";
        std::string error;
        EXPECT_FALSE(ServerDescriptionFromPpd(dir.File(name), xml, error)) << name;
        EXPECT_EQ(xml, "untouched");
        EXPECT_NE(error.find(dir.File(name)), std::string::npos) << error;
    }
}
