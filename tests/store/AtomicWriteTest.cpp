// A configuration file is replaced whole or not at all, even when the
// writing process is killed at an arbitrary moment.
#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <random>

#include <signal.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#include <wx/log.h>

#include "CaseTable.h"
#include "FolderFixtures.h"
#include "StoreTestSupport.h"
#include "db/AtomicFile.h"

using namespace storetest;

namespace
{
// Large enough that one write takes a good number of system calls.
FolderConfig LargeConfig(const char* variant)
{
    FolderConfig config = FullFolderConfig();
    config.setting.SetDescription(variant);
    for (int i = 0; i < 1200; ++i)
    {
        const wxString key = wxString::Format("Key%05d", i);
        const wxString value = wxString::Format("%s value %d with some padding text", variant, i);
        config.job.SaveProperty(key, value, value, value);
    }
    return config;
}

void SleepMicroseconds(long microseconds)
{
    timespec pause{microseconds / 1000000, (microseconds % 1000000) * 1000};
    while (nanosleep(&pause, &pause) != 0)
    {
    }
}
} // namespace

TEST(AtomicWrite, KilledWriterLeavesOneWholeVersion)
{
    TempDir dir;
    const FolderConfig versionA = LargeConfig("A");
    const FolderConfig versionB = LargeConfig("B");
    ASSERT_EQ(versionA.Write(dir.wx("a.cfg")), 0);
    ASSERT_EQ(versionB.Write(dir.wx("b.cfg")), 0);
    const std::string bytesA = ReadFile(dir / "a.cfg");
    const std::string bytesB = ReadFile(dir / "b.cfg");
    ASSERT_NE(bytesA, bytesB);
    ASSERT_GT(bytesA.size(), 150000u);
    const wxString target = dir.wx("Folder.cfg");
    const auto started = std::chrono::steady_clock::now();
    ASSERT_EQ(versionA.Write(target), 0);
    // Kill moments range from microseconds to a few whole writes.
    const long writeMicroseconds =
        std::max<long>(1000, std::chrono::duration_cast<std::chrono::microseconds>(
                                 std::chrono::steady_clock::now() - started)
                                 .count());
    RecordProperty("writeMicroseconds", static_cast<int>(writeMicroseconds));

    std::mt19937 random(12345);
    std::uniform_int_distribution<int> scale(0, 3);
    int sawA = 0, sawB = 0, changes = 0;
    bool currentIsA = true;
    const int kills = 80;
    for (int round = 0; round < kills; ++round)
    {
        // The writer says when it has started and after every whole write,
        // so that a slow start (a loaded machine, a sanitizer build) does not
        // eat the delay, and every fourth round surely kills after a change.
        int report[2];
        ASSERT_EQ(pipe(report), 0);
        const pid_t writer = fork();
        ASSERT_NE(writer, -1);
        if (writer == 0)
        {
            close(report[0]);
            const char started = 'S', written = 'W';
            if (write(report[1], &started, 1) != 1)
                _exit(1);
            // Each writer starts with the version the file does not hold.
            for (unsigned i = 0;; ++i)
            {
                ((i % 2 == 0) == currentIsA ? versionB : versionA).Write(target);
                if (write(report[1], &written, 1) != 1)
                    _exit(1);
            }
        }
        close(report[1]);
        char heard = 0;
        ASSERT_EQ(read(report[0], &heard, 1), 1);
        ASSERT_EQ(heard, 'S');
        if (round % 4 == 3)
        {
            ASSERT_EQ(read(report[0], &heard, 1), 1);
            ASSERT_EQ(heard, 'W');
        }
        const long maxDelay[] = {50, writeMicroseconds / 4, writeMicroseconds,
                                 2 * writeMicroseconds};
        SleepMicroseconds(std::uniform_int_distribution<long>(
            1, round % 4 == 3 ? 50 : maxDelay[scale(random)])(random));
        ASSERT_EQ(kill(writer, SIGKILL), 0);
        int status = 0;
        ASSERT_EQ(waitpid(writer, &status, 0), writer);
        close(report[0]);
        ASSERT_TRUE(WIFSIGNALED(status));

        const std::string now = ReadFile(dir / "Folder.cfg");
        const bool isA = now == bytesA, isB = now == bytesB;
        ASSERT_TRUE(isA || isB) << "round " << round << ": " << now.size() << " bytes";
        sawA += isA;
        sawB += isB;
        changes += isA != currentIsA;
        currentIsA = isA;
        db::Setting setting;
        ASSERT_EQ(db::HFDatabase::ReadSetting(target, setting), 1);
    }
    RecordProperty("versionA", sawA);
    RecordProperty("versionB", sawB);
    RecordProperty("changes", changes);
    EXPECT_GT(changes, 0) << "the writer never finished a write: the test proved nothing";
}

TEST(AtomicWrite, ReplacementKeepsThePermissionsOfTheOldFile)
{
    TempDir dir;
    const std::string path = dir / "Folder.cfg";
    WriteFile(path, "old");
    ASSERT_EQ(chmod(path.c_str(), 0664), 0);
    ASSERT_TRUE(db::AtomicFile::Write(wxString::FromUTF8(path), std::string("new")));
    struct stat info;
    ASSERT_EQ(stat(path.c_str(), &info), 0);
    EXPECT_EQ(info.st_mode & 07777, 0664u);
    EXPECT_EQ(ReadFile(path), "new");
}

TEST(AtomicWrite, SymbolicLinkTargetIsReplacedNotTheLink)
{
    TempDir dir;
    WriteFile(dir / "real.cfg", "old");
    ASSERT_EQ(symlink((dir / "real.cfg").c_str(), (dir / "link.cfg").c_str()), 0);
    ASSERT_TRUE(db::AtomicFile::Write(dir.wx("link.cfg"), std::string("new")));
    struct stat info;
    ASSERT_EQ(lstat((dir / "link.cfg").c_str(), &info), 0);
    EXPECT_TRUE(S_ISLNK(info.st_mode));
    EXPECT_EQ(ReadFile(dir / "real.cfg"), "new");
}

TEST(AtomicWrite, FailedWriteLeavesNoTemporaryFileBehind)
{
    TempDir dir;
    ASSERT_EQ(mkdir((dir / "Folder.cfg").c_str(), 0755), 0);
    EXPECT_FALSE(db::AtomicFile::Write(dir.wx("Folder.cfg"), std::string("x")));
    std::string listing;
    ASSERT_EQ(storetest::Run({"ls", "-A", dir.path()}, &listing), 0);
    EXPECT_EQ(listing, "Folder.cfg\n");
    EXPECT_FALSE(db::AtomicFile::Write(dir.wx("missing-dir/Folder.cfg"), std::string("x")));
}

TEST(AtomicWrite, FailureSaysWhy)
{
    const std::vector<testkit::CaseFields> cases =
        testkit::ReadCaseTable("store/atomic-write-failures.txt");
    ASSERT_FALSE(cases.empty());
    for (const testkit::CaseFields& c : cases)
    {
        ASSERT_EQ(c.size(), 3u);
        SCOPED_TRACE(c[0] + " | " + c[1]);
        TempDir dir;
        if (c[0].rfind("mkdir ", 0) == 0)
            ASSERT_EQ(mkdir((dir / c[0].substr(6)).c_str(), 0755), 0);
        else if (c[0].rfind("touch ", 0) == 0)
            WriteFile(dir / c[0].substr(6), "");
        wxString reason;
        EXPECT_FALSE(db::AtomicFile::Write(dir.wx(c[1]), std::string("x"), &reason));
        EXPECT_EQ(reason, wxString::FromUTF8(c[2]));
    }
}

TEST(AtomicWrite, TempFilesOfKilledWritersAreRemovedOnceStale)
{
    TempDir dir;
    WriteFile(dir / ".Folder.cfg.0badf00d.tmp", "stale");
    WriteFile(dir / ".Folder.cfg.12345678.tmp", "recent, maybe a live writer");
    WriteFile(dir / ".Other.cfg.0badf00d.tmp", "another file's");
    const timespec old[2] = {{time(nullptr) - 3600, 0}, {time(nullptr) - 3600, 0}};
    for (const char* name : {".Folder.cfg.0badf00d.tmp", ".Other.cfg.0badf00d.tmp"})
        ASSERT_EQ(utimensat(AT_FDCWD, (dir / name).c_str(), old, 0), 0);
    ASSERT_TRUE(db::AtomicFile::Write(dir.wx("Folder.cfg"), std::string("x")));
    std::string listing;
    ASSERT_EQ(storetest::Run({"ls", "-A", dir.path()}, &listing), 0);
    EXPECT_EQ(listing, ".Folder.cfg.12345678.tmp\n.Other.cfg.0badf00d.tmp\nFolder.cfg\n");
}
