// Settings text to converter parameters over the table
// tests/data/filter/parameters.txt.
#include <locale>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "EPS.h"
#include "TestKit.h"

namespace
{
// The value of a field of the loaded filter, as the table writes it.
std::string Field(EPS& eps, const std::string& name)
{
    const EPStoPSparams_t& p = eps.GetParams();
    if (name == "spd")
        return p.setPageDeviceString ? p.setPageDeviceString : "(null)";
    if (name.rfind("setting:", 0) == 0)
        return eps.GetSettings()[name.substr(8)].ToStdString();
    if (name.rfind("has:", 0) == 0)
        return std::to_string(eps.GetSettings().count(name.substr(4)));
    std::ostringstream all;
    all.imbue(std::locale::classic());
    all.precision(12); // 25.4 mm may come out a rounding step away from 72
    all << " pageWidth=" << p.pageWidth << " pageHeight=" << p.pageHeight
        << " imageableLLX=" << p.imageableLLX << " imageableLLY=" << p.imageableLLY
        << " imageableURX=" << p.imageableURX << " imageableURY=" << p.imageableURY
        << " imageWidth=" << p.imageWidth << " imageHeight=" << p.imageHeight
        << " imagePosition=" << p.imagePosition << " customSize=" << p.customSize
        << " autoScale=" << p.autoScale << " fitToPage=" << p.fitToPage
        << " shrinkToFit=" << p.shrinkToFit << " scaleToPrintable=" << p.scaleToPrintable
        << " autoRotate=" << p.autoRotate << " constrainProportions=" << p.constrainProportions
        << " widthGiven=" << p.widthGiven << " heightGiven=" << p.heightGiven
        << " settings=" << eps.GetSettings().size() << " status=" << eps.GetStatus() << " ";
    const std::string text = all.str();
    const size_t at = text.find(" " + name + "=");
    if (at == std::string::npos)
        return "unknown field " + name;
    const size_t start = at + name.size() + 2;
    return text.substr(start, text.find(' ', start) - start);
}

void RunTable(bool decimalComma)
{
    for (const auto& c : testkit::Cases("filter/parameters.txt", 4, 21))
    {
        if (c[1] == "de" && !decimalComma)
            continue;
        SCOPED_TRACE(c[0]);
        EPS eps("test");
        if (c[2] != "(none)")
            for (const std::string& load : testkit::Split(c[2], " then "))
            {
                for (const std::string& setting : testkit::Split(load, "; "))
                    if (setting != "-")
                    {
                        const size_t equals = setting.find('=');
                        eps.GetSettings()[setting.substr(0, equals)] =
                            wxString::FromUTF8(setting.substr(equals + 1));
                    }
                eps.LoadEPSParams();
            }
        for (const std::string& expected : testkit::Split(c[3], "; "))
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
