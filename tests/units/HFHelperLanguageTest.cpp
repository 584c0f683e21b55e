// The application language: read from the workstation language file, and
// with it the decimal separator and the process's C locale.
#include <clocale>

#include <gtest/gtest.h>
#include <wx/filename.h>
#include <wx/intl.h>

#include "ClientEnvironment.h"
#include "SettingsKeys.h"
#include "Units.h"
#include "db/PluginInitialize.h"
#include "utils/CLocaleNumbers.h"
#include "utils/HFHelper.h"

namespace
{
class AppLanguage : public RestoresCLocale
{
};

std::string Evaluate(const std::string& op, const std::string& input)
{
    if (op == "locale-name")
        return HFHelper::GetLocaleNameForLanguage(input).ToStdString();
    if (op == "system-locale")
        return HFHelper::GetSystemLocaleForName(input).ToStdString();
    if (input == "(no file)")
        ClientEnvironment::RemoveLanguageFile();
    else
        ClientEnvironment::WriteLanguageFile(input + "\n");
    return wxLocale::GetLanguageName(HFHelper::GetLanguageID()).ToStdString();
}

std::string NumericLocale()
{
    return setlocale(LC_NUMERIC, nullptr);
}
} // namespace

TEST_F(AppLanguage, CasesOfTheTable)
{
    const auto cases = testkit::ReadCaseTable("units/languages.txt");
    ASSERT_FALSE(cases.empty());
    for (const testkit::CaseFields& c : cases)
    {
        ASSERT_EQ(c.size(), 4u);
        const std::string input = c[1] == "\"\"" ? "" : c[1];
        const std::string expected =
            c[2] == "(system)"
                ? wxLocale::GetLanguageName(wxLocale::GetSystemLanguage()).ToStdString()
            : c[2] == "\"\"" ? ""
                             : c[2];
        EXPECT_EQ(Evaluate(c[0], input), expected) << c[0] << " " << c[1];
    }
}

TEST_F(AppLanguage, VersionAndLanguageFileDirectory)
{
    EXPECT_EQ("3.3", HFHelper::getHFVersion(true));
    const wxString directory = HFHelper::GetLanguageFileDirectory();
    EXPECT_EQ(wxString(ClientEnvironment::Home()) + "/Vomal QDK", directory);
    EXPECT_TRUE(wxFileName::DirExists(directory));
}

TEST_F(AppLanguage, CodeInMixedCaseWithBlanksSelectsFrench)
{
    ClientEnvironment::WriteLanguageFile("  Fr_fR \t\r\nde_DE\n");
    EXPECT_EQ(wxLANGUAGE_FRENCH, HFHelper::GetLanguageID());
    EXPECT_EQ(wxLANGUAGE_FRENCH, HFHelper::GetLocale(true));
    EXPECT_EQ("French", HFHelper::GetLocaleName());
}

TEST_F(AppLanguage, LanguagesSwitchTheProcessLocaleThroughTheirAliases)
{
    SKIP_WITHOUT_LOCALE("de_DE.UTF-8");
    SKIP_WITHOUT_LOCALE("en_US.UTF-8");
    SKIP_WITHOUT_LOCALE("pt_BR.UTF-8");
    const std::pair<const char*, const char*> cases[] = {
        {"de_DE", "de_DE.UTF-8"}, {"PT_br", "pt_BR.UTF-8"}, {"en_US", "en_US.UTF-8"}};
    for (const auto& [code, locale] : cases)
    {
        ClientEnvironment::WriteLanguageFile(code);
        const std::string separator = std::string(locale) == "en_US.UTF-8" ? "." : ",";
        EXPECT_EQ(separator, HFHelper::GetDecimalSeparatorFromAppLang()) << code;
        EXPECT_EQ(locale, NumericLocale());
        EXPECT_EQ(separator, localeconv()->decimal_point);
    }
}

TEST_F(AppLanguage, StoredValuesKeepPointWhileGermanIsSelected)
{
    SKIP_WITHOUT_LOCALE("de_DE.UTF-8");
    ClientEnvironment::WriteLanguageFile("de_DE");
    ASSERT_EQ(",", HFHelper::GetDecimalSeparatorFromAppLang());
    // Display text follows the language...
    EXPECT_EQ("8,50", wxString::Format("%.2f", 8.5));
    // ...stored and exchanged numbers do not.
    EXPECT_EQ("595.500000", FormatSettingDouble(595.5));
    EXPECT_EQ("8.50in x 11.00in", formatUnit(8.5, UNIT_INCH) + " x " + formatUnit(11, UNIT_INCH));
    EXPECT_EQ(842.9, utils::StrToDoubleC("842.9"));
    std::vector<stPageAttribute> sheets;
    ASSERT_TRUE(PluginInitialize::InitializeSheetInfo(
        "<S><SheetInfo><Width>595.28</Width><PSCommand>x</PSCommand></SheetInfo></S>", sheets));
    ASSERT_EQ(1u, sheets.size());
    EXPECT_EQ(595.28, sheets[0].Width);
}
