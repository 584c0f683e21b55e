// Folder clean-up: read-only and immutable entries are opened up and removed,
// links are never followed, and no path is ever run as a command.
#include <fcntl.h>
#include <linux/fs.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <string>

#include <gtest/gtest.h>

#include "EngineTestSupport.h"
#include "FileSystemUtils.h"

using namespace hf_test;

namespace
{
bool Exists(const std::string& path)
{
    struct stat info;
    return lstat(path.c_str(), &info) == 0;
}

mode_t Mode(const std::string& path)
{
    struct stat info;
    return lstat(path.c_str(), &info) == 0 ? info.st_mode & 07777 : 0;
}

// Sets or clears the immutable flag; false where the file system or the
// process's privileges do not allow it.
bool SetImmutable(const std::string& path, bool on)
{
    const int fd = open(path.c_str(), O_RDONLY | O_NONBLOCK);
    if (fd < 0)
        return false;
    int flags = 0;
    bool ok = ioctl(fd, FS_IOC_GETFLAGS, &flags) == 0;
    if (ok)
    {
        flags = on ? (flags | FS_IMMUTABLE_FL) : (flags & ~FS_IMMUTABLE_FL);
        ok = ioctl(fd, FS_IOC_SETFLAGS, &flags) == 0;
    }
    close(fd);
    return ok;
}

bool IsImmutable(const std::string& path)
{
    const int fd = open(path.c_str(), O_RDONLY | O_NONBLOCK);
    int flags = 0;
    const bool got = fd >= 0 && ioctl(fd, FS_IOC_GETFLAGS, &flags) == 0;
    if (fd >= 0)
        close(fd);
    return got && (flags & FS_IMMUTABLE_FL);
}

// A small tree: a read-only file, a read-only folder holding a file, a
// hidden file and a folder nobody may enter.
void BuildTree(const std::string& root)
{
    ASSERT_EQ(mkdir(root.c_str(), 0755), 0);
    WriteBytes(root + "/readonly.txt", "r");
    chmod((root + "/readonly.txt").c_str(), 0444);
    ASSERT_EQ(mkdir((root + "/locked").c_str(), 0755), 0);
    WriteBytes(root + "/locked/inner.txt", "i");
    chmod((root + "/locked").c_str(), 0555);
    WriteBytes(root + "/.hidden", "h");
    ASSERT_EQ(mkdir((root + "/closed").c_str(), 0755), 0);
    WriteBytes(root + "/closed/deep.txt", "d");
    chmod((root + "/closed").c_str(), 0);
}
} // namespace

TEST(FileSystemUtils, MissingPathIsNotMadeWritable)
{
    ScratchDir scratch;
    EXPECT_FALSE(MakeFolderWritable(scratch.File("missing").c_str()));
    EXPECT_FALSE(MakeFolderWritable(""));
}

TEST(FileSystemUtils, EveryEntryBecomesWritable)
{
    ScratchDir scratch;
    const std::string root = scratch.File("job");
    BuildTree(root);
    EXPECT_TRUE(MakeFolderWritable(root.c_str()));
    for (const char* entry : {"", "/readonly.txt", "/locked", "/locked/inner.txt", "/.hidden",
                              "/closed", "/closed/deep.txt"})
        EXPECT_EQ(Mode(root + entry), 0777u) << entry;
}

TEST(FileSystemUtils, DeleteRemovesTheTreeAndTheFolderItself)
{
    ScratchDir scratch;
    const std::string root = scratch.File("job");
    BuildTree(root);
    const bool immutable = [&]
    {
        WriteBytes(root + "/frozen.txt", "f");
        return SetImmutable(root + "/frozen.txt", true);
    }();
    DeleteFolderChildren(root.c_str());
    EXPECT_FALSE(Exists(root));
    if (!immutable)
        GTEST_SKIP() << "cannot set the immutable flag here; read-only entries were removed";
}

TEST(FileSystemUtils, ImmutableFlagIsCleared)
{
    ScratchDir scratch;
    const std::string root = scratch.File("job");
    ASSERT_EQ(mkdir(root.c_str(), 0755), 0);
    WriteBytes(root + "/frozen.txt", "f");
    if (!SetImmutable(root + "/frozen.txt", true))
        GTEST_SKIP() << "cannot set the immutable flag here (needs CAP_LINUX_IMMUTABLE and ext4)";
    EXPECT_TRUE(MakeFolderWritable(root.c_str()));
    EXPECT_FALSE(IsImmutable(root + "/frozen.txt"));
    SetImmutable(root + "/frozen.txt", false); // lets the scratch folder go
}

TEST(FileSystemUtils, LinksAreRemovedButNeverFollowed)
{
    ScratchDir scratch;
    const std::string outside = scratch.File("outside.txt");
    WriteBytes(outside, "keep me");
    chmod(outside.c_str(), 0400);
    const std::string outsideDir = scratch.File("outside-dir");
    ASSERT_EQ(mkdir(outsideDir.c_str(), 0700), 0);
    WriteBytes(outsideDir + "/keep.txt", "keep");

    const std::string root = scratch.File("job");
    ASSERT_EQ(mkdir(root.c_str(), 0755), 0);
    ASSERT_EQ(symlink(outside.c_str(), (root + "/file-link").c_str()), 0);
    ASSERT_EQ(symlink(outsideDir.c_str(), (root + "/dir-link").c_str()), 0);

    EXPECT_TRUE(MakeFolderWritable(root.c_str()));
    EXPECT_EQ(Mode(outside), 0400u);
    EXPECT_EQ(Mode(outsideDir), 0700u);

    DeleteFolderChildren(root.c_str());
    EXPECT_FALSE(Exists(root));
    EXPECT_EQ(testkit::ReadFile(outside), "keep me");
    EXPECT_EQ(testkit::ReadFile(outsideDir + "/keep.txt"), "keep");
}

TEST(FileSystemUtils, ShellCharactersInNamesAreJustCharacters)
{
    ScratchDir scratch;
    char previous[4096];
    ASSERT_NE(getcwd(previous, sizeof previous), nullptr);
    // Any command smuggled in through a name would create a file here.
    ASSERT_EQ(chdir(scratch.Path().c_str()), 0);
    for (const char* name : {"two words", "quote\"inside", "dollar $(touch pwned1)",
                             "back `touch pwned2` quote", "semi; touch pwned3", "$HOME"})
    {
        SCOPED_TRACE(name);
        const std::string root = scratch.File(name);
        ASSERT_EQ(mkdir(root.c_str(), 0755), 0);
        WriteBytes(root + "/inner; touch pwned4", "x");
        chmod((root + "/inner; touch pwned4").c_str(), 0444);
        EXPECT_TRUE(MakeFolderWritable(root.c_str()));
        EXPECT_EQ(Mode(root + "/inner; touch pwned4"), 0777u);
        DeleteFolderChildren(root.c_str());
        EXPECT_FALSE(Exists(root));
    }
    ASSERT_EQ(chdir(previous), 0);
    for (const char* made : {"pwned1", "pwned2", "pwned3", "pwned4"})
        EXPECT_FALSE(Exists(scratch.File(made))) << made;
}

TEST(FileSystemUtils, FailsWhereThePermissionIsNotOurs)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "needs root to test as another user";
    ScratchDir scratch;
    const std::string root = scratch.File("job");
    ASSERT_EQ(mkdir(root.c_str(), 0755), 0);
    WriteBytes(root + "/file.txt", "x");
    chmod((root + "/file.txt").c_str(), 0444);
    ASSERT_EQ(chmod(scratch.Path().c_str(), 0755), 0);
    const pid_t child = fork();
    ASSERT_GE(child, 0);
    if (child == 0)
    {
        if (setgid(65534) != 0 || setuid(65534) != 0)
            _exit(90);
        const bool writable = MakeFolderWritable(root.c_str());
        DeleteFolderChildren(root.c_str());
        _exit(writable ? 91 : 0);
    }
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 0) << "another user's tree was reported writable";
    EXPECT_TRUE(Exists(root + "/file.txt")) << "another user's file was removed";
    EXPECT_EQ(Mode(root + "/file.txt"), 0444u);
}
