// Operations that change an existing Folder.cfg: job overrides, the enable
// switch and the server name.
#include <gtest/gtest.h>

#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <wx/filename.h>
#include <wx/log.h>

#include "FolderFixtures.h"
#include "StoreTestSupport.h"

using namespace storetest;

namespace
{
wxArrayString Strings(std::initializer_list<const char*> texts)
{
    wxArrayString out;
    for (const char* text : texts)
        out.Add(text);
    return out;
}

// A written file with an attribute and an element no writer knows about.
std::string WithUnknownContent(const std::string& written)
{
    std::string text = written;
    text.replace(text.find("<HotFolder "), 11, "<HotFolder future=\"keep?\" ");
    text.replace(text.find("</HotFolder>"), 12, "<Future level=\"2\"/></HotFolder>");
    return text;
}

class FolderFileUpdate : public ::testing::Test
{
protected:
    void SetUp() override
    {
        m_config = FullFolderConfig();
        ASSERT_EQ(m_config.Write(Path()), 0);
    }
    wxString Folder() const { return m_dir.wx(); }
    wxString Path() const { return m_dir.wx("Folder.cfg"); }
    std::string File() const { return m_dir / "Folder.cfg"; }

    TempDir m_dir;
    FolderConfig m_config;
};
} // namespace

TEST_F(FolderFileUpdate, OverridesReplaceKeysThatDifferByCaseOrTrailingBlanks)
{
    m_config.job.SaveProperty("Staple ", "old", "old", "old");
    ASSERT_EQ(m_config.Write(Path()), 0);
    EXPECT_TRUE(db::HFDatabase::WriteJobOverrides(Folder(),
                                                  Strings({"pagesize", "Staple", "CustomPageSize"}),
                                                  Strings({"Custom", "Left", "612 792"})));

    FolderConfig expected = m_config;
    expected.job.RemoveProperty("PageSize");
    expected.job.RemoveProperty("Staple ");
    expected.job.SaveProperty("pagesize", "Custom", "Custom", "Custom");
    expected.job.SaveProperty("Staple", "Left", "Left", "Left");
    expected.job.SaveProperty("CustomPageSize", "612 792", "612 792", "612 792");
    ExpectSameConfig(ReadAll(Path()), expected); // every other block survives
}

TEST_F(FolderFileUpdate, LaterDuplicateKeyWins)
{
    EXPECT_TRUE(db::HFDatabase::WriteJobOverrides(Folder(), Strings({"PageSize", "PAGESIZE "}),
                                                  Strings({"A4", "A3"})));
    db::JobConfiguration job;
    db::ConfigurationReader::ReadJobConfiguration(Path(), job);
    wxString value, display, loc;
    EXPECT_FALSE(job.GetProperty("PageSize", value, display, loc));
    ASSERT_TRUE(job.GetProperty("PAGESIZE ", value, display, loc));
    EXPECT_EQ(value, "A3");
}

TEST_F(FolderFileUpdate, OverridesWithoutKeysOrWithoutFileWriteNothing)
{
    const std::string before = WithUnknownContent(ReadFile(File()));
    WriteFile(File(), before);
    EXPECT_FALSE(db::HFDatabase::WriteJobOverrides(Folder(), wxArrayString(), wxArrayString()));
    EXPECT_EQ(ReadFile(File()), before);

    TempDir empty;
    EXPECT_FALSE(
        db::HFDatabase::WriteJobOverrides(empty.wx(), Strings({"PageSize"}), Strings({"A4"})));
    EXPECT_FALSE(wxFileName::Exists(empty.wx("Folder.cfg")));
}

TEST_F(FolderFileUpdate, FullRewritesDropUnknownContentStatusUpdateKeepsIt)
{
    WriteFile(File(), WithUnknownContent(ReadFile(File())));
    EXPECT_EQ(db::HFDatabase::UpdateFolderStatus(Path(), false), 0);
    std::string text = ReadFile(File());
    EXPECT_NE(text.find("future=\"keep?\""), std::string::npos);
    EXPECT_NE(text.find("<Future level=\"2\"/>"), std::string::npos);
    db::Setting setting;
    db::HFDatabase::ReadSetting(Path(), setting);
    EXPECT_FALSE(setting.GetStatusEnable());

    EXPECT_TRUE(
        db::HFDatabase::WriteJobOverrides(Folder(), Strings({"PageSize"}), Strings({"A5"})));
    text = ReadFile(File());
    EXPECT_EQ(text.find("future="), std::string::npos);
    EXPECT_EQ(text.find("<Future"), std::string::npos);
}

TEST_F(FolderFileUpdate, StatusUpdateReplacesTheValueInItsPlace)
{
    EXPECT_EQ(db::HFDatabase::UpdateFolderStatus(Path(), false), 0);
    EXPECT_EQ(db::HFDatabase::UpdateFolderStatus(Path(), false), 0);
    const std::string text = ReadFile(File());
    EXPECT_NE(text.find("JobExpertRuleDisplayValue=\"Rule Seven\" Enable=\"0\" Centralized=\"1\""),
              std::string::npos);
    EXPECT_EQ(text.find("Enable=\"0\"", text.find("Enable=\"0\"") + 1), std::string::npos);
    EXPECT_EQ(db::HFDatabase::UpdateFolderStatus(Path(), true), 0);
    FolderConfig after = ReadAll(Path());
    ExpectSameConfig(after, m_config);

    // A root without "Enable" gets one appended.
    WriteFile(File(), "<HotFolder name='x'/>");
    EXPECT_EQ(db::HFDatabase::UpdateFolderStatus(Path(), true), 0);
    EXPECT_NE(ReadFile(File()).find("<HotFolder name=\"x\" Enable=\"1\"/>"), std::string::npos);
}

TEST_F(FolderFileUpdate, ServerNameRewritesOnlyWhenItChanges)
{
    const std::string withUnknown = WithUnknownContent(ReadFile(File()));
    WriteFile(File(), withUnknown);
    EXPECT_FALSE(db::HFDatabase::UpdateServerName(Path(), "press-1"));
    EXPECT_EQ(ReadFile(File()), withUnknown);

    EXPECT_TRUE(db::HFDatabase::UpdateServerName(Path(), "press-2"));
    FolderConfig expected = m_config;
    expected.setting.SetServerName("press-2");
    ExpectSameConfig(ReadAll(Path()), expected);
    EXPECT_EQ(ReadFile(File()).find("future="), std::string::npos);

    TempDir empty;
    EXPECT_FALSE(db::HFDatabase::UpdateServerName(empty.wx("Folder.cfg"), "press-3"));
    EXPECT_FALSE(wxFileName::Exists(empty.wx("Folder.cfg")));
}

TEST_F(FolderFileUpdate, UnreadableFilesAreNeverOverwritten)
{
    wxLogNull quiet;
    for (const char* broken : {"<HotFolder name='x'><JobSetting></HotFolder>", "", "\xff\xfe<"})
    {
        WriteFile(File(), broken);
        EXPECT_FALSE(
            db::HFDatabase::WriteJobOverrides(Folder(), Strings({"PageSize"}), Strings({"A4"})));
        EXPECT_EQ(db::HFDatabase::UpdateFolderStatus(Path(), true), -1);
        EXPECT_FALSE(db::HFDatabase::UpdateServerName(Path(), "other"));
        EXPECT_EQ(ReadFile(File()), broken);
    }

    // A directory in the file's place stays a directory, even for a full write.
    ASSERT_EQ(unlink(File().c_str()), 0);
    ASSERT_EQ(mkdir(File().c_str(), 0755), 0);
    EXPECT_FALSE(
        db::HFDatabase::WriteJobOverrides(Folder(), Strings({"PageSize"}), Strings({"A4"})));
    EXPECT_EQ(db::HFDatabase::UpdateFolderStatus(Path(), true), -1);
    EXPECT_EQ(m_config.Write(Path()), -1);
    struct stat info;
    ASSERT_EQ(stat(File().c_str(), &info), 0);
    EXPECT_TRUE(S_ISDIR(info.st_mode));
}

TEST_F(FolderFileUpdate, FileWithoutReadPermissionIsNeverOverwritten)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "needs root to switch to an unprivileged user";
    // The directory is writable for the unprivileged user, so only the
    // store's own care keeps it from replacing the file it cannot read.
    ASSERT_EQ(chmod(m_dir.path().c_str(), 0777), 0);
    ASSERT_EQ(chmod(File().c_str(), 0), 0);
    const std::string before = ReadFile(File());

    const pid_t child = fork();
    ASSERT_NE(child, -1);
    if (child == 0)
    {
        wxLogNull quiet;
        if (setgid(65534) != 0 || setuid(65534) != 0)
            _exit(100);
        int failures = 0;
        db::Setting setting;
        if (db::HFDatabase::ReadSetting(Path(), setting) != -1)
            failures |= 1;
        if (db::HFDatabase::WriteJobOverrides(Folder(), Strings({"PageSize"}), Strings({"A4"})))
            failures |= 2;
        if (db::HFDatabase::UpdateFolderStatus(Path(), false) != -1)
            failures |= 4;
        if (db::HFDatabase::UpdateServerName(Path(), "other"))
            failures |= 8;
        _exit(failures);
    }
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    ASSERT_TRUE(WIFEXITED(status));
    if (WEXITSTATUS(status) == 100)
        GTEST_SKIP() << "could not switch user";
    EXPECT_EQ(WEXITSTATUS(status), 0);
    EXPECT_EQ(ReadFile(File()), before);
}
