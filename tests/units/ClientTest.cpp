// The client: its configuration file and the application language, read from
// the workstation language file, with the decimal separator and the
// process's C locale that follow it.
#include <clocale>

#include <gtest/gtest.h>
#include <wx/filename.h>
#include <wx/intl.h>
#include <wx/log.h>

#include "ClientEnvironment.h"
#include "db/PluginInitialize.h"
#include "utils/Config.h"
#include "utils/HFHelper.h"

using utils::Config;

void ExpectCasesOfTheValueTable(); // UnitsTest.cpp

namespace
{
// This client ships version 3.3, the version that follows the workstation
// language.
const std::string kResources = HF_TEST_DATA_DIR "/server/Resources";
[[maybe_unused]] ::testing::Environment* const g_environment =
    ::testing::AddGlobalTestEnvironment(new ClientEnvironment("Resources"));

using Client = RestoresCLocale;

std::string Evaluate(const std::string& op, std::string input)
{
    wxString text;
    if (op == "config-string")
        return Config::ReadString(input, text) ? "yes " + text.ToStdString() : "no";
    if (op == "config-long")
        return std::to_string(Config::ReadLong(input, 30));
    if (op == "locale-name")
        return HFHelper::GetLocaleNameForLanguage(input).ToStdString();
    if (op == "system-locale")
        return HFHelper::GetSystemLocaleForName(input).ToStdString();
    if (op == "measurement") // LC_ALL names the locale; the locale program must agree
    {
        const char* saved = std::getenv("LC_ALL");
        const std::string old = saved ? saved : "";
        setenv("LC_ALL", input.c_str(), 1);
        const std::string unit = HFHelper::GetSystemMeasurementUnit().ToStdString();
        const std::string program = testkit::RunProgram({"locale", "-k", "LC_MEASUREMENT"}).out;
        saved ? setenv("LC_ALL", old.c_str(), 1) : unsetenv("LC_ALL");
        return unit +
               (program.find(unit == "0" ? "measurement=1" : "measurement=2") != std::string::npos
                    ? ""
                    : " (the locale program disagrees)");
    }
    for (const auto& [escape, character] : {std::pair{"\\t", "\t"}, {"\\r", "\r"}, {"\\n", "\n"}})
        for (size_t at; (at = input.find(escape)) != std::string::npos;)
            input.replace(at, 2, character);
    if (input == "(no file)")
        ClientEnvironment::RemoveLanguageFile();
    else
        ClientEnvironment::WriteLanguageFile(input + "\n");
    if (op == "app-locale")
        return HFHelper::GetLocaleName().ToStdString();
    if (op == "separator")
    {
        const std::string separator = HFHelper::GetDecimalSeparatorFromAppLang().ToStdString();
        return separator + " " + setlocale(LC_NUMERIC, nullptr) + " " + localeconv()->decimal_point;
    }
    return wxLocale::GetLanguageName(HFHelper::GetLanguageID()).ToStdString();
}
} // namespace

TEST_F(Client, CasesOfTheTable)
{
    ASSERT_TRUE(Config::GetInstance().Initialize());
    std::string missing; // system locales the machine lacks
    for (const testkit::CaseFields& c : testkit::Cases("units/client.txt", 4))
    {
        const std::string system = c[0] == "separator" ? c[2].substr(2, 11)
                                   : c[0] == "measurement" && c[1].rfind("xx", 0) ? c[1]
                                                                                  : "C";
        if (!testkit::ScopedLocale(system.c_str()))
        {
            missing += " " + system;
            continue;
        }
        const std::string expected =
            c[2] == "(system)"
                ? wxLocale::GetLanguageName(wxLocale::GetSystemLanguage()).ToStdString()
            : c[2] == "\"\"" ? ""
                             : c[2];
        EXPECT_EQ(Evaluate(c[0], c[1] == "\"\"" ? "" : c[1]), expected) << c[0] << " " << c[1];
    }
    if (!missing.empty())
        GTEST_SKIP() << "not generated on this machine (scripts/setup.sh):" << missing;
}

TEST_F(Client, VersionAndLanguageFileDirectory)
{
    EXPECT_EQ("3.3", HFHelper::getHFVersion(true));
    const wxString directory = HFHelper::GetLanguageFileDirectory();
    EXPECT_EQ(wxString(ClientEnvironment::Home()) + "/Vomal QDK", directory);
    EXPECT_TRUE(wxFileName::DirExists(directory));
}

TEST_F(Client, StoredValuesKeepPointWhileGermanIsSelected)
{
    SKIP_WITHOUT_LOCALE("de_DE.UTF-8");
    ClientEnvironment::WriteLanguageFile("de_DE");
    ASSERT_EQ(",", HFHelper::GetDecimalSeparatorFromAppLang());
    EXPECT_EQ("8,50", wxString::Format("%.2f", 8.5)); // display text follows the language
    ExpectCasesOfTheValueTable();                     // stored and exchanged numbers do not
    std::vector<stPageAttribute> sheets;
    ASSERT_TRUE(PluginInitialize::InitializeSheetInfo(
        "<S><SheetInfo><Width>595.28</Width><PSCommand>x</PSCommand></SheetInfo></S>", sheets));
    ASSERT_EQ(1u, sheets.size());
    EXPECT_EQ(595.28, sheets[0].Width);
}

TEST_F(Client, ConfigurationKeysAddedOnlyWhenNewDisplayKeysRebuilt)
{
    ASSERT_TRUE(Config::GetInstance().Initialize());
    Config::GetInstance().AddKey("POLL_INTERVAL", "99");
    Config::GetInstance().AddKey("ADDED_AT_RUN_TIME", "yes");
    wxString value;
    ASSERT_TRUE(Config::GetInstance().GetKey("POLL_INTERVAL", value));
    EXPECT_EQ("30", value);
    ASSERT_TRUE(Config::GetInstance().GetKey("ADDED_AT_RUN_TIME", value));
    EXPECT_EQ("yes", value);
    ASSERT_TRUE(Config::GetInstance().Initialize()); // not duplicated
    wxArrayString keys, names;
    Config::GetInstance().GetJPDisplayKeys(keys, names);
    EXPECT_EQ(wxJoin(keys, ','), "JobName,Copies,Collate,Stapling");
    // "Collate" has no display name, so the lists fall out of step.
    EXPECT_EQ(wxJoin(names, ','), "Job name,Number of copies,Staple");
}

TEST(ConfigLocation, ResourcesBesideTheExecutablesUnlessNamedMissingOrBrokenFileIsFalse)
{
    unsetenv("HOTFOLDER_RESOURCES_DIR");
    const wxString directory = Config::GetResourcesDirectory();
    setenv("HOTFOLDER_RESOURCES_DIR", kResources.c_str(), 1);
    EXPECT_EQ(wxString(HF_BUILD_DIR) + "/Resources", directory); // tests are built into bin/
    EXPECT_EQ(kResources + "/HFConfig.cfg", Config::GetConfigFilePath().ToStdString());
    ASSERT_TRUE(Config::GetInstance().Initialize());
    setenv("HOTFOLDER_RESOURCES_DIR", (kResources + "-missing").c_str(), 1);
    EXPECT_FALSE(Config::GetInstance().Initialize());
    {
        wxLogNull quiet;
        setenv("HOTFOLDER_RESOURCES_DIR", (kResources + "-broken").c_str(), 1);
        EXPECT_FALSE(Config::GetInstance().Initialize());
    }
    setenv("HOTFOLDER_RESOURCES_DIR", kResources.c_str(), 1);
    EXPECT_EQ(30, Config::ReadLong("POLL_INTERVAL", 0)); // the keys read before are kept
}
