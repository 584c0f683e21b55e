// Units, measures and the encodings of stored setting values.
#include <gtest/gtest.h>

#include <charconv>
#include <sstream>

#include "SettingsKeys.h"
#include "TestKit.h"
#include "Units.h"

namespace
{
Unit_t UnitOf(const std::string& word)
{
    return word == "inch"    ? UNIT_INCH
           : word == "mm"    ? UNIT_MM
           : word == "point" ? UNIT_POINT
                             : static_cast<Unit_t>(std::stoi(word));
}

std::string WordOf(Unit_t unit)
{
    return unit == UNIT_INCH ? "inch" : unit == UNIT_MM ? "mm" : "point";
}

std::string Result(bool ok, double value)
{
    char text[64];
    const auto end = std::to_chars(text, text + sizeof text, value, std::chars_format::general, 15);
    return (ok ? "yes " : "no ") + std::string(text, end.ptr);
}

// The case's answer in the form of the table's expected column.
std::string Evaluate(const std::string& op, std::string input)
{
    if (input.size() >= 2 && input.front() == '"')
        input = input.substr(1, input.size() - 2);
    std::istringstream words(input);
    std::string a, b, c;
    words >> a >> b >> c;
    double value = 0; // read with the classic C++ locale, whatever the C locale is
    std::istringstream(a) >> value;
    bool ok = true;
    if (op == "convert")
        ok = convertToUnit(value, UnitOf(b), UnitOf(c));
    if (op == "adjust")
        return Result(true, AdjustValue(value)).substr(4);
    if (op == "cm-inch")
    {
        const auto unit = [](const std::string& w) {
            return w == "cm" ? UNIT2_CM : w == "inch" ? UNIT2_INCH : static_cast<Unit2_t>(2);
        };
        ok = GetValueInUnits(value, unit(b), unit(c));
    }
    if (op == "format")
        return formatUnit(value, UnitOf(b)).ToStdString();
    if (op == "server-unit")
        return WordOf(UnitFromServerWord(input));
    if (op == "flag-on")
        return IsSettingOn(input) ? "yes" : "no";
    if (op == "flag-format")
        return FormatSettingFlag(value != 0).ToStdString();
    if (op == "double-format")
        return FormatSettingDouble(value).ToStdString();
    if (op == "int-format")
        return FormatSettingInt(static_cast<long>(value)).ToStdString();
    if (op == "parse-double")
        ok = ParseSettingDouble(input, value);
    if (op == "custom-unit")
    {
        Unit_t unit = UNIT_POINT;
        ok = DecodeCustomPageUnit(input, unit);
        return (ok ? "yes " : "no ") + WordOf(unit);
    }
    if (op == "read-flag") // the stored text ("(absent)": no entry) and the default
    {
        MapPropToValue settings(10);
        if (a != "(absent)")
            settings["K"] = a == "(empty)" ? "" : a;
        ok = ReadSettingFlag(settings, "K", b == "1");
        return (ok ? "yes" : "no") + std::string(settings.count("K") ? " listed" : "");
    }
    if (op == "default-dimension")
        return DefaultOriginalDimension(input == "inch").ToStdString();
    return Result(ok, value);
}

} // namespace

// Also run by ClientTest.cpp while the application language is German.
void ExpectCasesOfTheValueTable()
{
    for (const testkit::CaseFields& c : testkit::Cases("units/values.txt", 4))
    {
        EXPECT_EQ(Evaluate(c[0], c[1]), c[2]) << c[0] << " " << c[1] << ": " << c[3];
    }
}

TEST(UnitsAndSettingValues, CasesOfTheTable)
{
    ExpectCasesOfTheValueTable();
}
