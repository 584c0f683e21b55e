// Operations that change an existing Folder.cfg: job overrides, the enable
// switch and the server name.
#include <gtest/gtest.h>

#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <wx/log.h>

#include "FolderFixtures.h"

using db::HFDatabase;
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

class FolderFileUpdate : public ::testing::Test
{
protected:
    void SetUp() override
    {
        m_config = FullFolderConfig();
        ASSERT_EQ(m_config.Write(File()), 0);
    }
    wxString Folder() const { return Wx(m_dir.Path()); }
    wxString Path() const { return Wx(File()); }
    std::string File() const { return m_dir.File("Folder.cfg"); }
    std::string Text() const { return testkit::ReadFile(File()); }
    // The file as every reader sees it, written again.
    std::string ReadBack() const
    {
        FolderConfig read;
        read.ReadAll(File());
        return read.Bytes();
    }
    // An attribute and an element no writer knows about.
    void AddUnknownContent()
    {
        std::string text = Text();
        text.replace(text.find("<HotFolder "), 11, "<HotFolder future=\"keep?\" ");
        text.replace(text.find("</HotFolder>"), 12, "<Future level=\"2\"/></HotFolder>");
        testkit::WriteFile(File(), text);
    }

    testkit::ScratchDir m_dir;
    FolderConfig m_config;
};
} // namespace

TEST_F(FolderFileUpdate, OverridesReplaceKeysThatDifferByCaseOrTrailingBlanks)
{
    m_config.job.SaveProperty("Staple ", "old", "old", "old");
    ASSERT_EQ(m_config.Write(File()), 0);
    EXPECT_TRUE(HFDatabase::WriteJobOverrides(
        Folder(), Strings({"pagesize", "Staple", "CustomPageSize", "COPIES ", "Copies"}),
        Strings({"Custom", "Left", "612 792", "3", "4"})));
    FolderConfig expected = m_config;
    expected.job.RemoveProperty("PageSize");
    expected.job.RemoveProperty("Staple ");
    expected.job.RemoveProperty("Copies");
    expected.job.SaveProperty("pagesize", "Custom", "Custom", "Custom");
    expected.job.SaveProperty("Staple", "Left", "Left", "Left");
    expected.job.SaveProperty("CustomPageSize", "612 792", "612 792", "612 792");
    expected.job.SaveProperty("Copies", "4", "4", "4"); // the later duplicate wins
    EXPECT_EQ(ReadBack(), expected.Bytes());            // every other block survives
}

TEST_F(FolderFileUpdate, OverridesWithoutKeysOrWithoutFileWriteNothing)
{
    AddUnknownContent();
    const std::string before = Text();
    EXPECT_FALSE(HFDatabase::WriteJobOverrides(Folder(), wxArrayString(), wxArrayString()));
    EXPECT_EQ(Text(), before);
    testkit::ScratchDir empty;
    EXPECT_FALSE(
        HFDatabase::WriteJobOverrides(Wx(empty.Path()), Strings({"PageSize"}), Strings({"A4"})));
    EXPECT_FALSE(testkit::Exists(empty.File("Folder.cfg")));
}

TEST_F(FolderFileUpdate, StatusUpdateReplacesTheValueInItsPlaceKeepingUnknownContent)
{
    AddUnknownContent();
    EXPECT_EQ(HFDatabase::UpdateFolderStatus(Path(), false), 0);
    EXPECT_EQ(HFDatabase::UpdateFolderStatus(Path(), false), 0);
    std::string text = Text();
    EXPECT_NE(text.find("future=\"keep?\""), std::string::npos);
    EXPECT_NE(text.find("<Future level=\"2\"/>"), std::string::npos);
    EXPECT_NE(text.find("JobExpertRuleDisplayValue=\"Rule Seven\" Enable=\"0\" Centralized=\"1\""),
              std::string::npos);
    EXPECT_EQ(text.find("Enable=\"0\"", text.find("Enable=\"0\"") + 1), std::string::npos);
    EXPECT_EQ(HFDatabase::UpdateFolderStatus(Path(), true), 0);
    EXPECT_EQ(ReadBack(), m_config.Bytes());

    // A full rewrite drops what it does not know.
    EXPECT_TRUE(HFDatabase::WriteJobOverrides(Folder(), Strings({"PageSize"}), Strings({"A5"})));
    EXPECT_EQ(Text().find("future="), std::string::npos);
    EXPECT_EQ(Text().find("<Future"), std::string::npos);

    // A root without "Enable" gets one appended.
    testkit::WriteFile(File(), "<HotFolder name='x'/>");
    EXPECT_EQ(HFDatabase::UpdateFolderStatus(Path(), true), 0);
    EXPECT_NE(Text().find("<HotFolder name=\"x\" Enable=\"1\"/>"), std::string::npos);
}

TEST_F(FolderFileUpdate, ServerNameRewritesOnlyWhenItChanges)
{
    AddUnknownContent();
    const std::string withUnknown = Text();
    EXPECT_FALSE(HFDatabase::UpdateServerName(Path(), "press-1"));
    EXPECT_EQ(Text(), withUnknown);
    EXPECT_TRUE(HFDatabase::UpdateServerName(Path(), "press-2"));
    FolderConfig expected = m_config;
    expected.setting.SetServerName("press-2");
    EXPECT_EQ(ReadBack(), expected.Bytes());
    EXPECT_EQ(Text().find("future="), std::string::npos);

    testkit::ScratchDir empty;
    EXPECT_FALSE(HFDatabase::UpdateServerName(Wx(empty.File("Folder.cfg")), "press-3"));
    EXPECT_FALSE(testkit::Exists(empty.File("Folder.cfg")));
}

TEST_F(FolderFileUpdate, UnreadableFilesAreNeverOverwritten)
{
    wxLogNull quiet;
    for (const char* broken : {"<HotFolder name='x'><JobSetting></HotFolder>", "", "\xff\xfe<"})
    {
        testkit::WriteFile(File(), broken);
        EXPECT_FALSE(
            HFDatabase::WriteJobOverrides(Folder(), Strings({"PageSize"}), Strings({"A4"})));
        EXPECT_EQ(HFDatabase::UpdateFolderStatus(Path(), true), -1);
        EXPECT_FALSE(HFDatabase::UpdateServerName(Path(), "other"));
        EXPECT_EQ(Text(), broken);
    }

    // A directory in the file's place stays a directory, even for a full write.
    ASSERT_EQ(unlink(File().c_str()), 0);
    ASSERT_EQ(mkdir(File().c_str(), 0755), 0);
    EXPECT_FALSE(HFDatabase::WriteJobOverrides(Folder(), Strings({"PageSize"}), Strings({"A4"})));
    EXPECT_EQ(HFDatabase::UpdateFolderStatus(Path(), true), -1);
    EXPECT_EQ(m_config.Write(File()), -1);
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
    ASSERT_EQ(chmod(m_dir.Path().c_str(), 0777), 0);
    ASSERT_EQ(chmod(File().c_str(), 0), 0);
    const std::string before = Text();
    const pid_t child = fork();
    ASSERT_NE(child, -1);
    if (child == 0)
    {
        wxLogNull quiet;
        if (setgid(65534) != 0 || setuid(65534) != 0)
            _exit(100);
        db::Setting setting;
        _exit((HFDatabase::ReadSetting(Path(), setting) != -1) |
              HFDatabase::WriteJobOverrides(Folder(), Strings({"PageSize"}), Strings({"A4"})) << 1 |
              (HFDatabase::UpdateFolderStatus(Path(), false) != -1) << 2 |
              HFDatabase::UpdateServerName(Path(), "other") << 3);
    }
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    ASSERT_TRUE(WIFEXITED(status));
    if (WEXITSTATUS(status) == 100)
        GTEST_SKIP() << "could not switch user";
    EXPECT_EQ(WEXITSTATUS(status), 0);
    EXPECT_EQ(Text(), before);
}
