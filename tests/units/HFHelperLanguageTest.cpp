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

std::string CurrentNumericLocale()
{
    return setlocale(LC_NUMERIC, nullptr);
}
} // namespace

TEST_F(AppLanguage, VersionComesFromConfiguration)
{
    EXPECT_EQ("3.3", HFHelper::getHFVersion(true));
}

TEST_F(AppLanguage, LanguageFileDirectoryIsCreatedBesideTheDataDirectories)
{
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

TEST_F(AppLanguage, EveryCodeOfTheTableIsKnown)
{
    const std::pair<const char*, int> codes[] = {
        {"en_US", wxLANGUAGE_ENGLISH_US},
        {"es_ES", wxLANGUAGE_SPANISH},
        {"it_IT", wxLANGUAGE_ITALIAN},
        {"zh_CN", wxLANGUAGE_CHINESE_SIMPLIFIED_EXPLICIT},
        {"de_DE", wxLANGUAGE_GERMAN},
        {"ja_JP", wxLANGUAGE_JAPANESE},
        {"pt_BR", wxLANGUAGE_PORTUGUESE_BRAZILIAN},
        {"nl_NL", wxLANGUAGE_DUTCH},
        {"cs_CZ", wxLANGUAGE_CZECH},
        {"ru_RU", wxLANGUAGE_RUSSIAN},
        {"pl_PL", wxLANGUAGE_POLISH},
        {"tr_TR", wxLANGUAGE_TURKISH},
        {"zh_TW", wxLANGUAGE_CHINESE_TRADITIONAL_EXPLICIT},
        {"ko_KR", wxLANGUAGE_KOREAN},
    };
    for (const auto& [code, language] : codes)
    {
        ClientEnvironment::WriteLanguageFile(code);
        EXPECT_EQ(language, HFHelper::GetLanguageID()) << code;
    }
}

TEST_F(AppLanguage, LanguageNameIsAcceptedAndUnknownFallsBackToSystem)
{
    ClientEnvironment::WriteLanguageFile("Italian\n");
    EXPECT_EQ(wxLANGUAGE_ITALIAN, HFHelper::GetLanguageID());
    ClientEnvironment::WriteLanguageFile("xx_YY\n");
    EXPECT_EQ(wxLocale::GetSystemLanguage(), HFHelper::GetLanguageID());
    ClientEnvironment::RemoveLanguageFile();
    EXPECT_EQ(wxLocale::GetSystemLanguage(), HFHelper::GetLanguageID());
}

TEST(AppLanguageNames, HistoricLocaleNames)
{
    EXPECT_EQ("english-us", HFHelper::GetLocaleNameForLanguage("English (U.S.)"));
    EXPECT_EQ("english-us", HFHelper::GetLocaleNameForLanguage("English (U.K.)"));
    EXPECT_EQ("portuguese-brazilian", HFHelper::GetLocaleNameForLanguage("Portuguese (Brazilian)"));
    EXPECT_EQ("chinese-simplified", HFHelper::GetLocaleNameForLanguage("Chinese (Traditional)"));
    EXPECT_EQ("German", HFHelper::GetLocaleNameForLanguage("German"));
    EXPECT_EQ("", HFHelper::GetLocaleNameForLanguage(""));
}

TEST(AppLanguageNames, SystemLocaleForEachName)
{
    EXPECT_EQ("en_US.UTF-8", HFHelper::GetSystemLocaleForName("english-us"));
    EXPECT_EQ("pt_BR.UTF-8", HFHelper::GetSystemLocaleForName("portuguese-brazilian"));
    EXPECT_EQ("zh_CN.UTF-8", HFHelper::GetSystemLocaleForName("chinese-simplified"));
    EXPECT_EQ("de_DE.UTF-8", HFHelper::GetSystemLocaleForName("German"));
    EXPECT_EQ("ko_KR.UTF-8", HFHelper::GetSystemLocaleForName("Korean"));
    EXPECT_EQ("de_CH.UTF-8", HFHelper::GetSystemLocaleForName("German (Switzerland)"));
    EXPECT_EQ("", HFHelper::GetSystemLocaleForName("Klingon"));
    EXPECT_EQ("", HFHelper::GetSystemLocaleForName(""));
}

TEST_F(AppLanguage, GermanGivesCommaAndSwitchesTheProcessLocale)
{
    if (!HasLocale("de_DE.UTF-8"))
        GTEST_SKIP() << "de_DE.UTF-8 is not installed (scripts/setup.sh)";
    ClientEnvironment::WriteLanguageFile("de_DE\n");
    EXPECT_EQ(",", HFHelper::GetDecimalSeparatorFromAppLang());
    EXPECT_EQ("de_DE.UTF-8", CurrentNumericLocale());
    EXPECT_STREQ(",", localeconv()->decimal_point);
}

TEST_F(AppLanguage, EnglishAndBrazilianPortugueseGoThroughTheirAliases)
{
    if (!HasLocale("en_US.UTF-8") || !HasLocale("pt_BR.UTF-8"))
        GTEST_SKIP() << "en_US/pt_BR locales are not installed (scripts/setup.sh)";
    ClientEnvironment::WriteLanguageFile("PT_br");
    EXPECT_EQ(",", HFHelper::GetDecimalSeparatorFromAppLang());
    EXPECT_EQ("pt_BR.UTF-8", CurrentNumericLocale());
    ClientEnvironment::WriteLanguageFile("en_US");
    EXPECT_EQ(".", HFHelper::GetDecimalSeparatorFromAppLang());
    EXPECT_EQ("en_US.UTF-8", CurrentNumericLocale());
}

TEST_F(AppLanguage, StoredValuesKeepPointWhileGermanIsSelected)
{
    if (!HasLocale("de_DE.UTF-8"))
        GTEST_SKIP() << "de_DE.UTF-8 is not installed (scripts/setup.sh)";
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
