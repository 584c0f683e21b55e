// A configuration file is replaced whole or not at all, even when the
// writing process is killed at an arbitrary moment.
#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <random>

#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#include "FolderFixtures.h"
#include "db/AtomicFile.h"
#include "posix/Directories.h"
#include "posix/UniqueFd.h"

using namespace storetest;
using testkit::ReadFile;
using testkit::WriteFile;

namespace
{
// Large enough that one write takes a good number of system calls.
FolderConfig LargeConfig(const char* variant)
{
    FolderConfig config = FullFolderConfig();
    config.setting.SetDescription(variant);
    for (int i = 0; i < 1200; ++i)
    {
        const wxString value = wxString::Format("%s value %d with some padding text", variant, i);
        config.job.SaveProperty(wxString::Format("Key%05d", i), value, value, value);
    }
    return config;
}

bool Write(const std::string& path, const std::string& bytes, wxString* reason = nullptr)
{
    return db::AtomicFile::Write(Wx(path), bytes, reason);
}
} // namespace

TEST(AtomicWrite, KilledWriterLeavesOneWholeVersion)
{
    testkit::ScratchDir dir;
    const FolderConfig versions[2] = {LargeConfig("A"), LargeConfig("B")};
    const std::string bytes[2] = {versions[0].Bytes(), versions[1].Bytes()};
    ASSERT_NE(bytes[0], bytes[1]);
    ASSERT_GT(bytes[0].size(), 150000u);
    const std::string target = dir.File("Folder.cfg");
    const auto started = std::chrono::steady_clock::now();
    ASSERT_EQ(versions[0].Write(target), 0);
    // Kill moments range from microseconds to a few whole writes; a disk
    // whose fsync takes seconds caps them, or the rounds would take minutes.
    const long writeMicroseconds =
        std::clamp<long>(std::chrono::duration_cast<std::chrono::microseconds>(
                             std::chrono::steady_clock::now() - started)
                             .count(),
                         1000, 100000);
    std::mt19937 random(12345);
    int current = 0, changes = 0;
    for (int round = 0; round < 80; ++round)
    {
        // The writer says when it has started and after every whole write,
        // so a slow start (a loaded machine, a sanitizer build) does not eat
        // the delay, and every fourth round surely kills after a change.
        int report[2];
        ASSERT_EQ(pipe(report), 0);
        const pid_t writer = fork();
        ASSERT_NE(writer, -1);
        if (writer == 0)
        {
            close(report[0]);
            // Each writer starts with the version the file does not hold.
            for (unsigned i = 0; write(report[1], i ? "W" : "S", 1) == 1; ++i)
                versions[(i % 2 == 0) != current].Write(target);
            _exit(1);
        }
        close(report[1]);
        char heard = 0;
        ASSERT_EQ(read(report[0], &heard, 1), 1);
        if (round % 4 == 3)
        {
            ASSERT_EQ(read(report[0], &heard, 1), 1);
        }
        const long maxDelay[] = {50, writeMicroseconds / 4, writeMicroseconds,
                                 2 * writeMicroseconds};
        const long delay = std::uniform_int_distribution<long>(
            1, round % 4 == 3 ? 50 : maxDelay[random() % 4])(random);
        timespec pause{delay / 1000000, (delay % 1000000) * 1000};
        while (nanosleep(&pause, &pause) != 0)
        {
        }
        ASSERT_EQ(kill(writer, SIGKILL), 0);
        int status = 0;
        ASSERT_EQ(waitpid(writer, &status, 0), writer);
        close(report[0]);
        ASSERT_TRUE(WIFSIGNALED(status));

        const std::string now = ReadFile(target);
        ASSERT_TRUE(now == bytes[0] || now == bytes[1])
            << "round " << round << ": " << now.size() << " bytes";
        changes += (now == bytes[1]) != current;
        current = now == bytes[1];
        db::Setting setting;
        ASSERT_EQ(db::HFDatabase::ReadSetting(Wx(target), setting), 1);
    }
    EXPECT_GT(changes, 0) << "the writer never finished a write: the test proved nothing";
}

TEST(AtomicWrite, ReplacementKeepsPermissionsAndReplacesALinksTarget)
{
    testkit::ScratchDir dir;
    const std::string path = dir.File("real.cfg");
    WriteFile(path, "old");
    ASSERT_EQ(chmod(path.c_str(), 0664), 0);
    ASSERT_EQ(symlink(path.c_str(), dir.File("link.cfg").c_str()), 0);
    ASSERT_TRUE(Write(dir.File("link.cfg"), "new"));
    struct stat info;
    ASSERT_EQ(lstat(dir.File("link.cfg").c_str(), &info), 0);
    EXPECT_TRUE(S_ISLNK(info.st_mode));
    ASSERT_EQ(stat(path.c_str(), &info), 0);
    EXPECT_EQ(info.st_mode & 07777, 0664u);
    EXPECT_EQ(ReadFile(path), "new");
}

TEST(AtomicWrite, FailureSaysWhyAndLeavesNoTemporaryFile)
{
    for (const testkit::CaseFields& c : testkit::Cases("store/atomic-write-failures.txt", 3))
    {
        SCOPED_TRACE(c[0] + " | " + c[1]);
        testkit::ScratchDir dir;
        if (c[0].rfind("mkdir ", 0) == 0)
            ASSERT_EQ(mkdir(dir.File(c[0].substr(6)).c_str(), 0755), 0);
        else if (c[0].rfind("touch ", 0) == 0)
            WriteFile(dir.File(c[0].substr(6)), "");
        wxString reason;
        EXPECT_FALSE(Write(dir.File(c[1]), "x", &reason));
        EXPECT_EQ(reason, wxString::FromUTF8(c[2]));
        // Hidden names too: a temporary file starts with a dot.
        EXPECT_EQ(testkit::RunProgram({"ls", "-A", dir.Path()}).out,
                  c[0] == "nothing" ? "" : c[0].substr(6) + "\n");
    }
}

// A service started without standard input gets descriptor 0 for the first
// file it opens: that is a file like any other, and none is left open.
TEST(AtomicWrite, DescriptorZeroIsAnOrdinaryDescriptor)
{
    testkit::ScratchDir dir;
    const pid_t child = fork();
    ASSERT_NE(child, -1);
    if (child == 0)
    {
        close(0);
        wxString reason;
        int failures = Write(dir.File("Folder.cfg"), "whole") ? 0 : 1;
        failures |= ReadFile(dir.File("Folder.cfg")) == "whole" ? 0 : 2;
        failures |= fcntl(0, F_GETFD) == -1 ? 0 : 4; // nothing left open
        failures |= !Write(dir.File("missing/Folder.cfg"), "x", &reason) &&
                            reason == "No such file or directory"
                        ? 0
                        : 8;
        failures |= fcntl(0, F_GETFD) == -1 ? 0 : 16;
        // An empty holder that takes a descriptor closes nothing else.
        const int zero = open("/dev/null", O_RDONLY);
        posix::UniqueFd holder;
        holder.Reset(dup(zero));
        failures |= zero == 0 && fcntl(0, F_GETFD) != -1 ? 0 : 32;
        _exit(failures);
    }
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 0) << "bits: 1 write, 2 content, 4 descriptor kept, "
                                         "8 failure reason, 16 descriptor kept after failure, "
                                         "32 an empty holder closed descriptor 0";
}

TEST(AtomicWrite, TempFilesOfKilledWritersAreRemovedOnceStale)
{
    testkit::ScratchDir dir;
    WriteFile(dir.File(".Folder.cfg.0badf00d.tmp"), "stale");
    WriteFile(dir.File(".Folder.cfg.12345678.tmp"), "recent, maybe a live writer");
    WriteFile(dir.File(".Other.cfg.0badf00d.tmp"), "another file's");
    const timespec old[2] = {{time(nullptr) - 3600, 0}, {time(nullptr) - 3600, 0}};
    for (const char* name : {".Folder.cfg.0badf00d.tmp", ".Other.cfg.0badf00d.tmp"})
        ASSERT_EQ(utimensat(AT_FDCWD, dir.File(name).c_str(), old, 0), 0);
    ASSERT_TRUE(Write(dir.File("Folder.cfg"), "x"));
    EXPECT_FALSE(testkit::Exists(dir.File(".Folder.cfg.0badf00d.tmp")));
    EXPECT_TRUE(testkit::Exists(dir.File(".Folder.cfg.12345678.tmp")));
    EXPECT_TRUE(testkit::Exists(dir.File(".Other.cfg.0badf00d.tmp")));
}

// A tree goes whole: files first, then the folders that held them.
TEST(RemoveTree, RemovesNestedFoldersAndFiles)
{
    testkit::ScratchDir dir;
    dir.Sub("tree/a/b");
    testkit::WriteFile(dir.File("tree/a/b/file"), "x");
    testkit::WriteFile(dir.File("tree/top"), "x");
    EXPECT_EQ(posix::RemoveTree(dir.File("tree")), 0);
    EXPECT_FALSE(testkit::Exists(dir.File("tree")));
}
