// Settings text to converter parameters over the table
// tests/data/filter/parameters.txt.
#include <functional>
#include <locale>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "CaseTable.h"
#include "EPS.h"
#include "TestKit.h"

namespace
{
std::vector<std::string> Split(const std::string& text, const std::string& separator)
{
    std::vector<std::string> parts;
    for (size_t start = 0;;)
    {
        const size_t at = text.find(separator, start);
        parts.push_back(text.substr(start, at - start));
        if (at == std::string::npos)
            return parts;
        start = at + separator.size();
    }
}

// The value of a field of the loaded filter, as the table writes it.
std::string Field(EPS& eps, const std::string& name)
{
    const EPStoPSparams_t& p = eps.GetParams();
    const std::map<std::string, std::function<double()>> numbers = {
        {"pageWidth", [&] { return p.pageWidth; }},
        {"pageHeight", [&] { return p.pageHeight; }},
        {"imageableLLX", [&] { return p.imageableLLX; }},
        {"imageableLLY", [&] { return p.imageableLLY; }},
        {"imageableURX", [&] { return p.imageableURX; }},
        {"imageableURY", [&] { return p.imageableURY; }},
        {"imageWidth", [&] { return p.imageWidth; }},
        {"imageHeight", [&] { return p.imageHeight; }},
        {"imagePosition", [&] { return p.imagePosition; }},
        {"customSize", [&] { return p.customSize; }},
        {"autoScale", [&] { return p.autoScale; }},
        {"fitToPage", [&] { return p.fitToPage; }},
        {"shrinkToFit", [&] { return p.shrinkToFit; }},
        {"scaleToPrintable", [&] { return p.scaleToPrintable; }},
        {"autoRotate", [&] { return p.autoRotate; }},
        {"constrainProportions", [&] { return p.constrainProportions; }},
        {"widthGiven", [&] { return p.widthGiven; }},
        {"heightGiven", [&] { return p.heightGiven; }},
        {"settings", [&] { return eps.GetSettings().size(); }},
        {"status", [&] { return eps.GetStatus(); }},
    };
    if (name == "spd")
        return p.setPageDeviceString ? p.setPageDeviceString : "(null)";
    if (name.rfind("setting:", 0) == 0)
        return eps.GetSettings()[name.substr(8)].ToStdString();
    if (name.rfind("has:", 0) == 0)
        return std::to_string(eps.GetSettings().count(name.substr(4)));
    const auto number = numbers.find(name);
    if (number == numbers.end())
        return "unknown field " + name;
    // Twelve digits: 25.4 mm may come out a rounding step away from 72.
    std::ostringstream text;
    text.imbue(std::locale::classic());
    text.precision(12);
    text << number->second();
    return text.str();
}

void RunTable(bool decimalComma)
{
    const auto cases = testkit::ReadCaseTable("filter/parameters.txt");
    ASSERT_GT(cases.size(), 20u);
    for (const auto& c : cases)
    {
        ASSERT_EQ(c.size(), 4u) << c[0];
        if (c[1] == "de" && !decimalComma)
            continue;
        SCOPED_TRACE(c[0]);
        EPS eps("test");
        if (c[2] != "(none)")
            for (const std::string& load : Split(c[2], " then "))
            {
                for (const std::string& setting : Split(load, "; "))
                    if (setting != "-")
                    {
                        const size_t equals = setting.find('=');
                        eps.GetSettings()[setting.substr(0, equals)] =
                            wxString::FromUTF8(setting.substr(equals + 1));
                    }
                eps.LoadEPSParams();
            }
        for (const std::string& expected : Split(c[3], "; "))
        {
            const size_t equals = expected.find('=');
            EXPECT_EQ(Field(eps, expected.substr(0, equals)), expected.substr(equals + 1))
                << expected;
        }
    }
}
} // namespace

TEST(ConversionParameters, TableOfSettings)
{
    RunTable(false);
}

TEST(ConversionParameters, TableOfSettingsUnderADecimalCommaLocale)
{
    TESTKIT_USE_LOCALE(german, "de_DE.UTF-8");
    RunTable(true);
}
