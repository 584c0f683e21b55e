#include <gtest/gtest.h>

#include <wx/log.h>

#include "WarehouseFixture.h"
#include "db/HFDatabase.h"
#include "hotfolder/HFTranslations.h"

using db::HFDatabase;
using machinetest::ScopedUmask;
using storetest::ReadFile;
using storetest::WriteFile;

namespace
{
class Preferences : public machinetest::WarehouseTest
{
protected:
    std::string File() const { return Warehouse() + "/Preferences.cfg"; }
    void WriteRaw(const std::string& rootAttributes)
    {
        mkdir(Warehouse().c_str(), 0777);
        WriteFile(File(), "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<Preferences " +
                              rootAttributes + "/>\n");
    }
};

db::Preference FullPreference()
{
    db::Preference p;
    p.SetAppLang("de_DE");
    p.SetUnit("point");
    p.SetUserUnitChanged("true");
    p.SetImpositionPresetLocation("/presets");
    p.SetTimeInterval("15");
    p.SetStatusCustomLocation(true);
    p.SetJobsSaveLocation("/saved");
    p.SetStatusClearOriginal(true);
    p.SetOroginalJobClearValue("7");
    p.SetStatusClearFailed(true);
    p.SetFailedJobClearValue("3");
    p.SetStatusAutoRefresh(false);
    p.SetAutoRefreshPresetValue("60");
    return p;
}

// Switches the environment's measurement system for the system-unit rule.
class ScopedMeasurementLocale
{
public:
    explicit ScopedMeasurementLocale(const char* locale)
    {
        m_had = wxGetEnv("LC_ALL", &m_old);
        wxSetEnv("LC_ALL", locale);
    }
    ~ScopedMeasurementLocale()
    {
        if (m_had)
            wxSetEnv("LC_ALL", m_old);
        else
            wxUnsetEnv("LC_ALL");
    }

private:
    bool m_had;
    wxString m_old;
};
} // namespace

TEST(PreferenceModel, DefaultsAndEffectiveUnit)
{
    db::Preference p;
    EXPECT_TRUE(p.GetStatusAutoRefresh());
    EXPECT_EQ(p.GetAutoRefreshPresetValue(), "30");
    EXPECT_FALSE(p.GetStatusCustomLocation());
    EXPECT_EQ(p.GetUnit(), ""); // flag empty: the stored unit, even an empty one

    p.SetUnit("point");
    p.SetUserUnitChanged("False");
    {
        ScopedMeasurementLocale metric("de_DE.UTF-8");
        EXPECT_EQ(p.GetUnit(), HFTranslations::GetInstance()->Translate("mm"));
    }
    {
        ScopedMeasurementLocale imperial("en_US.UTF-8");
        EXPECT_EQ(p.GetUnit(), HFTranslations::GetInstance()->Translate("inch"));
    }
    p.SetUserUnitChanged("true");
    EXPECT_EQ(p.GetUnit(), "point");
}

TEST_F(Preferences, MissingFileReadsZeroAndKeepsDefaults)
{
    db::Preference p;
    EXPECT_EQ(HFDatabase::ReadPreferences(p), 0);
    EXPECT_EQ(p.GetAutoRefreshPresetValue(), "30");
}

TEST_F(Preferences, RoundTripOfEveryFieldInAttributeOrder)
{
    ScopedUmask restrictive(077);
    const db::Preference written = FullPreference();
    EXPECT_EQ(HFDatabase::WritePreferences(written), 0);
    EXPECT_EQ(ModeOf(Warehouse()), 0777u);
    EXPECT_NE(ReadFile(File()).find(
                  "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<Preferences AppLanguage=\"de_DE\" "
                  "Units=\"point\" UserChangedUnit=\"true\" ImposePresetLocation=\"/presets\" "
                  "TimeInterval=\"15\" IsCustomLocation=\"1\" SaveLocation=\"/saved\" "
                  "IsClearOriginalJobs=\"1\" ClearOriginalJobsValue=\"7\" IsClearFailedJobs=\"1\" "
                  "ClearFailedJobsValue=\"3\" IsAutoRefreshPreset=\"0\" "
                  "AutoRefreshPresetValue=\"60\"/>"),
              std::string::npos)
        << ReadFile(File());

    db::Preference read;
    EXPECT_EQ(HFDatabase::ReadPreferences(read), -1); // -1 means "the file exists"
    EXPECT_EQ(read.GetAppLang(), written.GetAppLang());
    EXPECT_EQ(read.GetStoredUnit(), "point");
    EXPECT_EQ(read.GetUserUnitChanged(), written.GetUserUnitChanged());
    EXPECT_EQ(read.GetImpositionPresetLocation(), written.GetImpositionPresetLocation());
    EXPECT_EQ(read.GetTimeInterval(), written.GetTimeInterval());
    EXPECT_EQ(read.GetStatusCustomLocation(), written.GetStatusCustomLocation());
    EXPECT_EQ(read.GetJobsSaveLocation(), written.GetJobsSaveLocation());
    EXPECT_EQ(read.GetStatusClearOriginal(), written.GetStatusClearOriginal());
    EXPECT_EQ(read.GetOroginalJobClearValue(), written.GetOroginalJobClearValue());
    EXPECT_EQ(read.GetStatusClearFailed(), written.GetStatusClearFailed());
    EXPECT_EQ(read.GetFailedJobClearValue(), written.GetFailedJobClearValue());
    EXPECT_EQ(read.GetStatusAutoRefresh(), written.GetStatusAutoRefresh());
    EXPECT_EQ(read.GetAutoRefreshPresetValue(), written.GetAutoRefreshPresetValue());
}

TEST_F(Preferences, OlderFileLoadsOnlyItsLeadingPart)
{
    WriteRaw("AppLanguage=\"fr_FR\" Units=\"mm\" ImposePresetLocation=\"/x\" "
             "TimeInterval=\"5\" IsCustomLocation=\"1\" AutoRefreshPresetValue=\"10\"");
    db::Preference p = FullPreference();
    EXPECT_EQ(HFDatabase::ReadPreferences(p), -1);
    EXPECT_EQ(p.GetAppLang(), "fr_FR");
    EXPECT_EQ(p.GetStoredUnit(), "mm");
    const db::Preference untouched = FullPreference();
    EXPECT_EQ(p.GetImpositionPresetLocation(), untouched.GetImpositionPresetLocation());
    EXPECT_EQ(p.GetTimeInterval(), untouched.GetTimeInterval());
    EXPECT_EQ(p.GetAutoRefreshPresetValue(), untouched.GetAutoRefreshPresetValue());
}

TEST_F(Preferences, StoredUnitWordsAreMatchedWithoutCaseOthersReadAsInch)
{
    const struct
    {
        const char* stored;
        const char* expected;
    } cases[] = {{"MM", "mm"}, {"Point", "point"}, {"inch", "inch"}, {"cm", "inch"}, {"", "inch"}};
    for (const auto& c : cases)
    {
        WriteRaw(std::string("AppLanguage=\"\" Units=\"") + c.stored + "\"");
        db::Preference p;
        HFDatabase::ReadPreferences(p);
        EXPECT_EQ(p.GetStoredUnit(), c.expected) << c.stored;
    }
}

TEST_F(Preferences, TranslatedUnitWordReadsBackAsInch)
{
    HFTranslations* translations = HFTranslations::GetInstance();
    if (!translations->SelectLanguage("de"))
        GTEST_SKIP() << "no German catalogue";
    db::Preference p;
    p.SetUnit(translations->Translate("point")); // "Punkt"
    p.SetUserUnitChanged("true");
    EXPECT_EQ(HFDatabase::WritePreferences(p), 0);
    db::Preference read;
    HFDatabase::ReadPreferences(read);
    EXPECT_EQ(read.GetStoredUnit(), translations->Translate("inch"));
    translations->SelectLanguage("en");
    EXPECT_NE(read.GetStoredUnit(), "inch"); // the translated word, not the keyword
}

TEST_F(Preferences, UnreadableFileLeavesPreferenceAlone)
{
    wxLogNull quiet;
    mkdir(Warehouse().c_str(), 0777);
    WriteFile(File(), "<Preferences AppLanguage='x'");
    db::Preference p = FullPreference();
    EXPECT_EQ(HFDatabase::ReadPreferences(p), -1);
    EXPECT_EQ(p.GetAppLang(), "de_DE");
}
