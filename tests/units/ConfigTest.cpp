#include <gtest/gtest.h>
#include <wx/log.h>

#include "ClientEnvironment.h"
#include "utils/Config.h"

using utils::Config;

namespace
{
// Registered for this program by ClientEnvironmentResources.cpp.
const std::string kResources = std::string(HF_TEST_DATA_DIR) + "/server/Resources";

class ConfigFile : public ::testing::Test
{
protected:
    void SetUp() override { ASSERT_TRUE(Config::GetInstance().Initialize()); }
};
} // namespace

TEST_F(ConfigFile, EntriesByAttributePositionFirstValueWins)
{
    wxString value;
    ASSERT_TRUE(Config::ReadString("APP_HF_VERSION", value));
    EXPECT_EQ("3.3", value);
    // Attribute names are not looked at.
    ASSERT_TRUE(Config::ReadString("RETRY_COUNT", value));
    EXPECT_EQ("-4", value);
    // An entry with a single attribute is skipped.
    EXPECT_FALSE(Config::ReadString("LONELY", value));
}

TEST_F(ConfigFile, ReadLongParsesOrIgnoresTheDefault)
{
    EXPECT_EQ(30, Config::ReadLong("POLL_INTERVAL", 5));
    EXPECT_EQ(12, Config::ReadLong("MAX_JOBS", 5));
    EXPECT_EQ(0, Config::ReadLong("LOG_LEVEL", 5));
    EXPECT_EQ(-4, Config::ReadLong("RETRY_COUNT", 5));
    // A missing key gives 1, never the default.
    EXPECT_EQ(1, Config::ReadLong("NO_SUCH_KEY", 30));
}

TEST_F(ConfigFile, AddKeyNeverOverwrites)
{
    Config::GetInstance().AddKey("POLL_INTERVAL", "99");
    Config::GetInstance().AddKey("ADDED_AT_RUN_TIME", "yes");
    wxString value;
    ASSERT_TRUE(Config::GetInstance().GetKey("POLL_INTERVAL", value));
    EXPECT_EQ("30", value);
    ASSERT_TRUE(Config::GetInstance().GetKey("ADDED_AT_RUN_TIME", value));
    EXPECT_EQ("yes", value);
}

TEST_F(ConfigFile, DisplayKeysAreRebuiltNotDuplicated)
{
    ASSERT_TRUE(Config::GetInstance().Initialize());
    wxArrayString keys, names;
    Config::GetInstance().GetJPDisplayKeys(keys, names);
    ASSERT_EQ(4u, keys.size());
    EXPECT_EQ("JobName", keys[0]);
    EXPECT_EQ("Stapling", keys[3]);
    // "Collate" has no display name, so the lists fall out of step.
    ASSERT_EQ(3u, names.size());
    EXPECT_EQ("Job name", names[0]);
    EXPECT_EQ("Staple", names[2]);
}

TEST(ConfigLocation, ResourcesBesideTheExecutablesDirectory)
{
    unsetenv("HOTFOLDER_RESOURCES_DIR");
    const wxString directory = Config::GetResourcesDirectory();
    setenv("HOTFOLDER_RESOURCES_DIR", kResources.c_str(), 1);
    // The test program is built into <build>/bin.
    EXPECT_EQ(wxString(HF_BUILD_DIR) + "/Resources", directory);
    EXPECT_EQ(kResources + "/HFConfig.cfg", Config::GetConfigFilePath().ToStdString());
}

TEST(ConfigLocation, MissingOrBrokenFileIsFalseAndKeepsKeys)
{
    ASSERT_TRUE(Config::GetInstance().Initialize());
    const std::string good = kResources;
    setenv("HOTFOLDER_RESOURCES_DIR", (good + "-missing").c_str(), 1);
    EXPECT_FALSE(Config::GetInstance().Initialize());
    {
        wxLogNull quiet;
        setenv("HOTFOLDER_RESOURCES_DIR", (kResources + "-broken").c_str(), 1);
        EXPECT_FALSE(Config::GetInstance().Initialize());
    }
    setenv("HOTFOLDER_RESOURCES_DIR", good.c_str(), 1);
    EXPECT_EQ(30, Config::ReadLong("POLL_INTERVAL", 0));
}
