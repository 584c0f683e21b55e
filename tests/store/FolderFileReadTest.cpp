// Reading Folder.cfg: chained root attributes, positional block readers and
// files that cannot be read.
#include <gtest/gtest.h>

#include <sys/stat.h>

#include <wx/log.h>

#include "FolderFixtures.h"
#include "StoreTestSupport.h"

using namespace storetest;

namespace
{
const std::string kData = HF_TEST_DATA_DIR "/store/";
wxString DataFile(const char* name)
{
    return wxString::FromUTF8(kData + name);
}
} // namespace

TEST(FolderFileRead, OlderWriterLoadsItsLeadingPartOnly)
{
    db::Setting setting;
    setting.SetJobPresetAttched(false);
    setting.SetCustomTimeInterval("kept");
    setting.GetInputFormats().emplace_back("PDF", "already there");
    EXPECT_EQ(db::HFDatabase::ReadSetting(DataFile("FolderOlderWriter.cfg"), setting), 1);
    EXPECT_EQ(setting.GetName(), "Legacy");
    EXPECT_EQ(setting.GetServerName(), "old-press");
    EXPECT_TRUE(setting.GetStatusEnable());
    EXPECT_EQ(setting.GetBaseVirtualPrinterDisplayName(), "VP");
    EXPECT_EQ(setting.GetSelectedPreset(), "Old preset");
    EXPECT_TRUE(setting.GetStatusCentralized());
    // "Isjobpresetattached" is missing: it and everything after it keep
    // their values although some later attributes are present.
    EXPECT_FALSE(setting.GetCustomInterval());
    EXPECT_EQ(setting.GetCustomTimeInterval(), "kept");
    EXPECT_FALSE(setting.IsQuickSetsSupported());
    EXPECT_EQ(setting.GetServerVersion(), -1);
    // Input formats are appended; entries lacking a name are skipped.
    const db::Setting::InputFormats expected = {
        {"PDF", "already there"}, {"EPS", "EPS files"}, {"PS", "PostScript"}};
    EXPECT_EQ(setting.GetInputFormats(), expected);
}

TEST(FolderFileRead, MandatoryAttributeMissingGivesMinusOneButKeepsWhatWasRead)
{
    TempDir dir;
    WriteFile(dir / "Folder.cfg",
              "<HotFolder name='n' description='d' server_name='s' Enable='1'>"
              "<InputFormatsSummary><InputFormat ShortName='EPS' DisplayName='E'/>"
              "</InputFormatsSummary></HotFolder>");
    db::Setting setting;
    setting.SetServerName("before");
    EXPECT_EQ(db::HFDatabase::ReadSetting(dir.wx("Folder.cfg"), setting), -1);
    EXPECT_EQ(setting.GetName(), "n");
    EXPECT_EQ(setting.GetDescription(), "d");
    EXPECT_EQ(setting.GetServerName(), "before");
    EXPECT_FALSE(setting.GetStatusEnable());
    ASSERT_EQ(setting.GetInputFormats().size(), 1u);
}

TEST(FolderFileRead, ServerVersionAloneMayBeMissingAndFlagsParseBothWays)
{
    TempDir dir;
    WriteFile(dir / "Folder.cfg",
              "<HotFolder name='n' description='' server_ip='' server_name='' Enable='true' "
              "BaseVirtualPrinter='' BaseVirtualPrinterName='' BaseVirtualPrinterDisplayName='' "
              "HFPresetName='' Centralized='01' Isjobpresetattached='1' IsCustomInterval='0' "
              "TimeInterval='' PPDVersion='' ServerTypeAndJPDefaultKeyInfo='' "
              "server_textversion='9.1' server_type='t' Quickset='q' Quickset_Supported='2' "
              "Quickset_Enabled='0' IsWidthBased='-1' JobExpert_Supported='1' JobExpert='0' "
              "JobExpertRule='r'/>");
    db::Setting setting;
    setting.SetServerVersion(77);
    setting.SetJobExpertRule({"old", "old display"});
    EXPECT_EQ(db::HFDatabase::ReadSetting(dir.wx("Folder.cfg"), setting), 1);
    EXPECT_EQ(setting.GetServerVersion(), 77);
    EXPECT_EQ(setting.GetTextServerVersion(), "9.1");
    EXPECT_FALSE(setting.GetStatusEnable());      // only "1" is on
    EXPECT_FALSE(setting.GetStatusCentralized()); // "01" is not "1"
    EXPECT_TRUE(setting.GetJobPresetAttched());
    EXPECT_TRUE(setting.IsQuickSetsSupported()); // numeric: non-zero is on
    EXPECT_FALSE(setting.IsQuickSetsEnabled());
    EXPECT_TRUE(setting.GetIsWidthBased());
    EXPECT_TRUE(setting.IsJobExpertSupported());
    EXPECT_EQ(setting.GetJobExpertRule(), std::make_pair(wxString("r"), wxString("old display")));
}

TEST(FolderFileRead, BlockReadersTakeValuesByPositionAndReplaceTheirTarget)
{
    const wxString path = DataFile("FolderPositional.cfg");

    db::FolderConfiguration folders;
    folders.SetBackupFolder("/unchanged");
    folders.SetFailFolder("/no-fail-element");
    EXPECT_EQ(db::ConfigurationReader::ReadFolderConfiguration(path, folders), 0);
    EXPECT_EQ(folders.GetWorkFolder(), "/positional/work"); // direct child, first attribute
    EXPECT_EQ(folders.GetBackupFolder(), "/unchanged");     // element without attribute
    EXPECT_EQ(folders.GetFailFolder(), "/no-fail-element");

    db::JobConfiguration job;
    job.SaveProperty("Stale", "x", "x", "x");
    EXPECT_EQ(db::ConfigurationReader::ReadJobConfiguration(path, job), 0);
    const db::JobConfiguration::Map expectedJob = {{"Dup", {"first", "First shown", "Erst"}},
                                                   {"Short", {"value", "", ""}}};
    EXPECT_EQ(job.GetProperties(), expectedJob);

    db::ImposeConfiguration impose;
    EXPECT_EQ(db::ConfigurationReader::ReadImposeConfiguration(path, impose), 0);
    const db::ImposeConfiguration::Map expectedImpose = {{"Layout", {"4up", "Four up"}}};
    EXPECT_EQ(impose.GetProperties(), expectedImpose);

    db::PreflightConfiguration preflight;
    preflight.AddProperty("Stale", "x");
    EXPECT_EQ(db::ConfigurationReader::ReadPreflightConfiguration(path, preflight), 0);
    const db::PreflightConfiguration::List expectedPreflight = {{"Status", "TRUE"},
                                                                {"Status", "false"}};
    EXPECT_EQ(preflight.GetProperties(), expectedPreflight);
    EXPECT_TRUE(preflight.IsPreflightEnabled());
}

TEST(FolderFileRead, AbsentBlocksLeaveTargetsUnchanged)
{
    const wxString path = DataFile("FolderOlderWriter.cfg");
    db::ImposeConfiguration impose;
    impose.SaveProperty("Keep", "1", "One");
    db::PreflightConfiguration preflight;
    preflight.AddProperty("Keep", "1");
    db::FilterConfiguration filter;
    filter.SetFilterSettingNode(ParseNode("<FilterSetting><Filter name='kept'/></FilterSetting>"));
    const wxString filterBefore = NodeText(filter.GetFilterSettingNode());
    db::ConfigurationReader::ReadImposeConfiguration(path, impose);
    db::ConfigurationReader::ReadPreflightConfiguration(path, preflight);
    db::ConfigurationReader::ReadFilterConfiguration(path, filter);
    EXPECT_EQ(impose.GetProperties().size(), 1u);
    EXPECT_EQ(preflight.GetProperties().size(), 1u);
    EXPECT_EQ(NodeText(filter.GetFilterSettingNode()), filterBefore);
}

class UnreadableFolderFile : public ::testing::Test
{
protected:
    wxLogNull m_quiet; // the loader's error messages are expected here
    TempDir m_dir;

    // Every reader on path: results as expected and nothing changed.
    void ExpectEveryReaderLeavesOutputsAlone(const wxString& path, int settingResult)
    {
        FolderConfig config = FullFolderConfig();
        const FolderConfig before = config;
        EXPECT_EQ(db::HFDatabase::ReadSetting(path, config.setting), settingResult);
        EXPECT_EQ(db::ConfigurationReader::ReadFolderConfiguration(path, config.folders), 0);
        EXPECT_EQ(db::ConfigurationReader::ReadJobConfiguration(path, config.job), 0);
        EXPECT_EQ(db::ConfigurationReader::ReadFilterConfiguration(path, config.filter), 0);
        EXPECT_EQ(db::ConfigurationReader::ReadImposeConfiguration(path, config.impose), 0);
        EXPECT_EQ(db::ConfigurationReader::ReadPreflightConfiguration(path, config.preflight), 0);
        ExpectSameConfig(config, before);
    }
};

TEST_F(UnreadableFolderFile, MissingMalformedEmptyDirectoryAndAttributeless)
{
    ExpectEveryReaderLeavesOutputsAlone(m_dir.wx("none.cfg"), 0);
    WriteFile(m_dir / "bad.cfg", "<HotFolder name='x'><Paths></HotFolder>");
    ExpectEveryReaderLeavesOutputsAlone(m_dir.wx("bad.cfg"), -1);
    WriteFile(m_dir / "empty.cfg", "");
    ExpectEveryReaderLeavesOutputsAlone(m_dir.wx("empty.cfg"), -1);
    WriteFile(m_dir / "bare.cfg", "<?xml version='1.0'?>");
    ExpectEveryReaderLeavesOutputsAlone(m_dir.wx("bare.cfg"), -1);
    ASSERT_EQ(mkdir((m_dir / "dir.cfg").c_str(), 0755), 0);
    ExpectEveryReaderLeavesOutputsAlone(m_dir.wx("dir.cfg"), 0);

    // A root without attributes is refused before its blocks are looked at.
    WriteFile(m_dir / "noattr.cfg",
              "<HotFolder><InputFormatsSummary><InputFormat ShortName='a' DisplayName='b'/>"
              "</InputFormatsSummary></HotFolder>");
    db::Setting setting;
    EXPECT_EQ(db::HFDatabase::ReadSetting(m_dir.wx("noattr.cfg"), setting), -1);
    EXPECT_TRUE(setting.GetInputFormats().empty());
}
