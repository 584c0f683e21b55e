// The machine's Preferences.cfg and the unit it makes effective.
#include <gtest/gtest.h>

#include <wx/log.h>

#include "WarehouseFixture.h"
#include "db/HFDatabase.h"
#include "hotfolder/HFTranslations.h"

using db::HFDatabase;
using namespace machinetest;

namespace
{
const std::string kData = HF_TEST_DATA_DIR "/machine/";

class Preferences : public WarehouseTest
{
protected:
    std::string File() const { return Warehouse() + "/Preferences.cfg"; }
    void WriteRaw(const std::string& text)
    {
        mkdir(Warehouse().c_str(), 0777);
        testkit::WriteFile(File(), text);
    }
    // What WritePreferences makes of p.
    std::string Written(const db::Preference& p)
    {
        EXPECT_EQ(HFDatabase::WritePreferences(p), 0);
        return testkit::ReadFile(File());
    }
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
    p.SetUserUnitChanged("False"); // until the user picks one, the system's
    wxString oldAll;
    const bool hadAll = wxGetEnv("LC_ALL", &oldAll);
    wxSetEnv("LC_ALL", "de_DE.UTF-8");
    EXPECT_EQ(p.GetUnit(), HFTranslations::GetInstance()->Translate("mm"));
    wxSetEnv("LC_ALL", "en_US.UTF-8");
    EXPECT_EQ(p.GetUnit(), HFTranslations::GetInstance()->Translate("inch"));
    hadAll ? wxSetEnv("LC_ALL", oldAll) : wxUnsetEnv("LC_ALL");
    p.SetUserUnitChanged("true");
    EXPECT_EQ(p.GetUnit(), "point");
}

TEST_F(Preferences, ReadAndWrittenAgain)
{
    wxLogNull quiet;
    {
        ScopedUmask restrictive(077);
        EXPECT_EQ(HFDatabase::WritePreferences(db::Preference()), 0);
        EXPECT_EQ(ModeOf(Warehouse()), 0777u);
    }
    db::Preference full;
    WriteRaw(testkit::ReadFile(kData + "PreferencesFull.cfg"));
    ASSERT_EQ(HFDatabase::ReadPreferences(full), -1);
    const auto cases = testkit::ReadCaseTable("machine/preferences-read.txt");
    ASSERT_FALSE(cases.empty());
    for (const testkit::CaseFields& c : cases)
    {
        ASSERT_EQ(c.size(), 5u);
        SCOPED_TRACE(c[0]);
        unlink(File().c_str());
        if (c[0] != "(missing)")
            WriteRaw(testkit::ReadFile(kData + c[0]));
        db::Preference p = c[1] == "new" ? db::Preference() : full;
        EXPECT_EQ(HFDatabase::ReadPreferences(p), std::stoi(c[2]));
        EXPECT_EQ(Written(p), testkit::ReadFile(kData + c[3])) << c[4];
    }
}

TEST_F(Preferences, StoredUnitWordsAreMatchedWithoutCaseOthersReadAsInch)
{
    const std::pair<const char*, const char*> cases[] = {
        {"MM", "mm"}, {"Point", "point"}, {"inch", "inch"}, {"cm", "inch"}, {"", "inch"}};
    for (const auto& [stored, expected] : cases)
    {
        WriteRaw(std::string("<Preferences AppLanguage=\"\" Units=\"") + stored + "\"/>");
        db::Preference p;
        HFDatabase::ReadPreferences(p);
        EXPECT_EQ(p.GetStoredUnit(), expected) << stored;
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
