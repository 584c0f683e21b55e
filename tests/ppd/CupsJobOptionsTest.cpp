// Job overrides as CUPS options, one case a line of cups-options.txt.
#include <gtest/gtest.h>

#include "CupsJobOptions.h"
#include "TestKit.h"

namespace
{
printing::OptionList Pairs(const std::string& text)
{
    printing::OptionList pairs;
    for (size_t start = 0; text != "-" && start <= text.size();)
    {
        size_t end = text.find("; ", start);
        end = end == std::string::npos ? text.size() : end;
        const std::string pair = text.substr(start, end - start);
        pairs.emplace_back(pair.substr(0, pair.find('=')), pair.substr(pair.find('=') + 1));
        start = end + 2;
    }
    return pairs;
}
} // namespace

TEST(CupsJobOptions, OverridesOfTheTable)
{
    const auto cases = testkit::ReadCaseTable("ppd/cups-options.txt");
    ASSERT_FALSE(cases.empty());
    for (const testkit::CaseFields& row : cases)
        EXPECT_EQ(printing::CupsOptionsFromOverrides(Pairs(row[0])), Pairs(row[1])) << row.back();
}
