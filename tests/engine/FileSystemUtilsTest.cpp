// Folder clean-up: read-only and immutable entries are opened up and removed,
// links are never followed, and no path is ever run as a command. Clean-up
// runs as the user who owns the tree (nobody when the suite runs as root),
// since root passes every permission check and would hide a fault.
#include <fcntl.h>
#include <linux/fs.h>
#include <sys/ioctl.h>

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "FileSystemUtils.h"
#include "TestKit.h"

using testkit::Exists;

namespace
{
mode_t Mode(const std::string& path)
{
    struct stat info;
    return lstat(path.c_str(), &info) == 0 ? info.st_mode & 07777 : 0;
}

// Sets or clears the immutable flag and tells whether it is set now; false
// where the file system or the process's privileges do not allow it.
bool Immutable(const std::string& path, int change)
{
    const int fd = open(path.c_str(), O_RDONLY | O_NONBLOCK);
    int flags = 0;
    bool ok = fd >= 0 && ioctl(fd, FS_IOC_GETFLAGS, &flags) == 0;
    if (ok && change != 0)
    {
        flags = change > 0 ? (flags | FS_IMMUTABLE_FL) : (flags & ~FS_IMMUTABLE_FL);
        ok = ioctl(fd, FS_IOC_SETFLAGS, &flags) == 0;
    }
    if (fd >= 0)
        close(fd);
    return ok && (flags & FS_IMMUTABLE_FL);
}

// A read-only file, a read-only folder holding a file, a hidden file and a
// folder nobody may enter.
void BuildTree(const std::string& root)
{
    ASSERT_EQ(mkdir(root.c_str(), 0755), 0);
    for (const char* folder : {"/locked", "/closed"})
        ASSERT_EQ(mkdir((root + folder).c_str(), 0755), 0);
    for (const char* file : {"/readonly.txt", "/locked/inner.txt", "/.hidden", "/closed/deep.txt"})
        testkit::WriteFile(root + file, "x");
    chmod((root + "/readonly.txt").c_str(), 0444);
    chmod((root + "/locked").c_str(), 0555);
    chmod((root + "/closed").c_str(), 0);
}
} // namespace

TEST(FileSystemUtils, EveryEntryBecomesWritableThenTheTreeGoes)
{
    testkit::ScratchDir scratch("hf-fsutils");
    const std::string root = scratch.File("job"), other = scratch.File("job2");
    BuildTree(root);
    BuildTree(other);
    // The owner's clean-up, not root's: root reads a folder of mode 0
    // whatever its mode, and would hide a walk that never looks inside it.
    ASSERT_TRUE(testkit::HandOver(scratch.Path()));
    const std::string seen = testkit::AsUnprivileged(
        [&]
        {
            return std::string(MakeFolderWritable(scratch.File("missing").c_str()) ? "1" : "0") +
                   (MakeFolderWritable("") ? "1" : "0") +
                   (MakeFolderWritable(root.c_str()) ? "1" : "0") +
                   (DeleteFolderChildren(other.c_str()), "");
        });
    EXPECT_EQ(seen, "001") << "missing, empty, the tree";
    for (const char* entry : {"", "/readonly.txt", "/locked", "/locked/inner.txt", "/.hidden",
                              "/closed", "/closed/deep.txt"})
        EXPECT_EQ(Mode(root + entry), 0777u) << entry;
    EXPECT_FALSE(Exists(other));
}

// Setting and clearing the immutable flag takes a privilege no ordinary
// owner has, so this one runs as the test does.
TEST(FileSystemUtils, ImmutableFlagIsClearedAndTheFileRemoved)
{
    testkit::ScratchDir scratch("hf-fsutils");
    const std::string root = scratch.Sub("job"), frozen = root + "/frozen.txt";
    testkit::WriteFile(frozen, "f");
    if (!Immutable(frozen, +1))
        GTEST_SKIP() << "cannot set the immutable flag here (needs CAP_LINUX_IMMUTABLE and ext4)";
    EXPECT_TRUE(MakeFolderWritable(root.c_str()));
    EXPECT_FALSE(Immutable(frozen, 0));
    Immutable(frozen, +1);
    DeleteFolderChildren(root.c_str());
    EXPECT_FALSE(Exists(root));
    Immutable(frozen, -1); // lets the scratch folder go if the test failed
}

TEST(FileSystemUtils, LinksAreRemovedButNeverFollowedAndNamesNeverRun)
{
    testkit::ScratchDir scratch("hf-fsutils");
    const std::string outside = scratch.File("outside.txt"),
                      outsideDir = scratch.Sub("outside-dir");
    testkit::WriteFile(outside, "keep me");
    testkit::WriteFile(outsideDir + "/keep.txt", "keep");
    const std::vector<std::string> names = {"two words",
                                            "quote\"inside",
                                            "dollar $(touch pwned1)",
                                            "back `touch pwned2` quote",
                                            "semi; touch pwned3",
                                            "$HOME"};
    for (const std::string& name : names)
    {
        const std::string root = scratch.Sub(name), inner = root + "/inner; touch pwned4";
        testkit::WriteFile(inner, "x");
        ASSERT_EQ(symlink(outside.c_str(), (root + "/file-link").c_str()), 0);
        ASSERT_EQ(symlink(outsideDir.c_str(), (root + "/dir-link").c_str()), 0);
    }
    // The targets belong to the user who cleans up: a followed link would
    // change them.
    ASSERT_TRUE(testkit::HandOver(scratch.Path()));
    chmod(outside.c_str(), 0400);
    chmod(outsideDir.c_str(), 0700);
    for (const std::string& name : names)
        chmod(scratch.File(name + "/inner; touch pwned4").c_str(), 0444);
    char previous[4096];
    ASSERT_NE(getcwd(previous, sizeof previous), nullptr);
    // Any command smuggled in through a name would create a file here.
    ASSERT_EQ(chdir(scratch.Path().c_str()), 0);
    const std::string seen = testkit::AsUnprivileged(
        [&]
        {
            std::string modes;
            for (const std::string& name : names)
            {
                const std::string root = scratch.File(name);
                modes += MakeFolderWritable(root.c_str()) ? "1 " : "0 ";
                modes += std::to_string(Mode(root + "/inner; touch pwned4")) + " ";
                DeleteFolderChildren(root.c_str());
                modes += Exists(root) ? "kept\n" : "gone\n";
            }
            return modes;
        });
    ASSERT_EQ(chdir(previous), 0);
    std::string expected;
    for (size_t i = 0; i < names.size(); ++i)
        expected += "1 " + std::to_string(0777) + " gone\n";
    EXPECT_EQ(seen, expected) << "writable, the inner file's mode, the tree, for each name";
    EXPECT_EQ(Mode(outside), 0400u);
    EXPECT_EQ(Mode(outsideDir), 0700u);
    EXPECT_EQ(testkit::ReadFile(outside), "keep me");
    EXPECT_EQ(testkit::ReadFile(outsideDir + "/keep.txt"), "keep");
    for (const char* made : {"pwned1", "pwned2", "pwned3", "pwned4"})
        EXPECT_FALSE(Exists(scratch.File(made))) << made;
}

TEST(FileSystemUtils, FailsWhereThePermissionIsNotOurs)
{
    if (!testkit::RunsAsRoot())
        GTEST_SKIP() << "needs root to hand the work to another user";
    testkit::ScratchDir scratch("hf-fsutils");
    const std::string root = scratch.Sub("job");
    testkit::WriteFile(root + "/file.txt", "x");
    chmod((root + "/file.txt").c_str(), 0444);
    ASSERT_EQ(chmod(scratch.Path().c_str(), 0755), 0);
    const std::string seen = testkit::AsUnprivileged(
        [&]
        {
            const bool writable = MakeFolderWritable(root.c_str());
            DeleteFolderChildren(root.c_str());
            return std::string(writable ? "writable" : "not writable");
        });
    EXPECT_EQ(seen, "not writable") << "another user's tree";
    EXPECT_TRUE(Exists(root + "/file.txt")) << "another user's file was removed";
    EXPECT_EQ(Mode(root + "/file.txt"), 0444u);
}
