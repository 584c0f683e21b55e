// What droppers may try on a served folder: names that carry line ends or
// PostScript.
#include "OutsideNames.h"
#include "ServiceTestSupport.h"

#include <grp.h>
#include <sys/stat.h>
#include <utility>

using namespace service_test;

namespace
{
size_t Outputs(const std::string& folder)
{
    size_t outputs = 0;
    for (const std::string& name : ListDirectory(folder + "/Output"))
        outputs += !EndsWith(name, ".Folder.cfg");
    return outputs;
}
} // namespace

TEST_F(ServiceTest, NamesReachTheJournalOnlyAsShownText)
{
    const std::vector<DroppedName> names = DroppedNames();
    const std::string folder = MakePostScriptFolder();
    auto host = Serve(1);
    DropUnderEachName(names, folder, label);
    EXPECT_TRUE(WaitFor([&] { return Outputs(folder) == names.size(); }, 20000)) << host->Err();
    host->Signal(SIGTERM);
    EXPECT_EQ(host->Wait(20000), 0);
    EXPECT_EQ(LinesWithControls(host->Err()), std::vector<std::string>()) << host->Err();
    for (const DroppedName& name : names)
        EXPECT_NE(host->Err().find("<6>" + posix::ShownText(name.raw) + " -> "), std::string::npos)
            << name.line << "\n"
            << host->Err();
}

namespace
{
constexpr uid_t kOwner = 65534, kDropper = 65533;

// A child process of the dropper's user that writes part of bytes to path
// and holds it open until it is told to go on (its standard input closes),
// then writes the rest.
class OtherUsersWriter
{
public:
    OtherUsersWriter(const std::string& path, const std::string& bytes)
    {
        int go[2];
        if (pipe(go) != 0)
            return;
        m_pid = fork();
        if (m_pid == 0)
        {
            close(go[1]);
            if (setgroups(0, nullptr) != 0 || setgid(kDropper) != 0 || setuid(kDropper) != 0)
                _exit(2);
            const int fd = open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL, 0644);
            const size_t half = bytes.size() / 2;
            if (fd < 0 || write(fd, bytes.data(), half) != static_cast<ssize_t>(half))
                _exit(3);
            char ignored;
            while (read(go[0], &ignored, 1) > 0)
                ;
            const bool whole = write(fd, bytes.data() + half, bytes.size() - half) ==
                               static_cast<ssize_t>(bytes.size() - half);
            _exit(whole && close(fd) == 0 ? 0 : 4);
        }
        close(go[0]);
        m_go = go[1];
    }
    ~OtherUsersWriter() { Finish(); }
    int Finish()
    {
        if (m_go >= 0)
            close(m_go);
        m_go = -1;
        return m_pid > 0 ? testkit::WaitProgram(std::exchange(m_pid, -1)) : -1;
    }

private:
    pid_t m_pid = -1;
    int m_go = -1;
};

uid_t OwnerOf(const std::string& path)
{
    struct stat info;
    return lstat(path.c_str(), &info) == 0 ? info.st_uid : static_cast<uid_t>(-1);
}
} // namespace

TEST_F(ServiceTest, AFoldersWorkIsDoneWithItsOwnersRights)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "needs root, as the service runs";
    ASSERT_EQ(chmod(scratch.c_str(), 0755), 0);
    const std::string folder = MakePostScriptFolder("A4", "user");
    const std::string steered = MakePostScriptFolder("A4", "steered");
    const std::string shared = MakePostScriptFolder("A4", "shared");
    for (const std::string& hot : {folder, steered, shared})
    {
        ASSERT_EQ(testkit::RunProgram({"chown", "-R", "65534:65534", hot}).exitCode, 0);
        ASSERT_EQ(chmod(hot.c_str(), 01777), 0); // anyone drops, no one renames another's file
    }
    const std::string rootOnly = scratch + "/root-only";
    ASSERT_EQ(mkdir(rootOnly.c_str(), 0700), 0);
    WriteFile(rootOnly + "/private.eps", label);
    WriteFile(scratch + "/public.eps", label);
    const std::string config = Container(steered) + "/Folder.cfg";
    std::string text = ReadFile(config);
    const std::string failedTag = "[FailedFolder]";
    text.replace(text.find(Container(steered) + "/" + failedTag),
                 (Container(steered) + "/" + failedTag).size(), rootOnly + "/failed");
    WriteFile(config, text);
    ASSERT_EQ(chmod(Container(shared).c_str(), 0775), 0);

    auto host = Serve(1);
    for (const testkit::CaseFields& row : testkit::Cases("service/drops.txt", 2, 7))
    {
        const std::string &kind = row[0], &line = row.back();
        if (kind == "owned-output")
        {
            WriteFile(folder + "/mine.eps", label);
            EXPECT_TRUE(WaitFor([&] { return Exists(folder + "/Output/mine.ps"); }, 10000))
                << line << host->Err();
            EXPECT_EQ(OwnerOf(folder + "/Output/mine.ps"), kOwner) << line;
        }
        else if (kind == "unreadable")
        {
            const std::string path = folder + "/secret.eps";
            WriteFile(path, label);
            ASSERT_EQ(chown(path.c_str(), kDropper, kDropper), 0);
            ASSERT_EQ(chmod(path.c_str(), 0600), 0);
            EXPECT_TRUE(WaitFor(
                [&] { return host->Err().find("/secret.eps") != std::string::npos; }, 10000))
                << line << host->Err();
            EXPECT_FALSE(Exists(folder + "/Output/secret.ps")) << line;
        }
        else if (kind == "link-readable" || kind == "link-private")
        {
            const std::string target =
                kind == "link-readable" ? scratch + "/public.eps" : rootOnly + "/private.eps";
            const std::string link = folder + "/" + kind + ".eps";
            ASSERT_EQ(symlink(target.c_str(), link.c_str()), 0);
            const std::string reason =
                kind + ".eps is a symbolic link; the hot folder takes files only";
            EXPECT_TRUE(WaitFor([&] { return Count(host->Err(), reason) == 1; }, 10000))
                << line << host->Err();
            std::this_thread::sleep_for(std::chrono::milliseconds(600)); // rescans pass
            EXPECT_EQ(Count(host->Err(), reason), 1u) << line;
            EXPECT_TRUE(Exists(link)) << line;
            EXPECT_FALSE(Exists(folder + "/Output/" + kind + ".ps")) << line;
            EXPECT_EQ(ReadFile(target), label) << line;
        }
        else if (kind == "other-writer")
        {
            const std::string path = folder + "/slow.eps";
            OtherUsersWriter writer(path, label);
            ASSERT_TRUE(WaitFor([&] { return Exists(path); }, 5000)) << line;
            std::this_thread::sleep_for(std::chrono::milliseconds(800)); // > settle time
            EXPECT_TRUE(Exists(path)) << line << ": taken while open for writing";
            EXPECT_EQ(writer.Finish(), 0) << line;
            EXPECT_TRUE(WaitFor([&] { return Exists(folder + "/Output/slow.ps"); }, 10000))
                << line << host->Err();
        }
        else if (kind == "steered-config")
        {
            EXPECT_NE(host->Err().find("<3>cannot serve " + steered), std::string::npos)
                << line << host->Err();
            EXPECT_FALSE(Exists(rootOnly + "/failed")) << line;
        }
        else if (kind == "writable-container")
        {
            EXPECT_NE(
                host->Err().find(Container(shared) + " can be written by others than its owner"),
                std::string::npos)
                << line << host->Err();
            EXPECT_NE(host->Err().find("chmod go-w '" + Container(shared) + "'"), std::string::npos)
                << line;
            ASSERT_EQ(chmod(Container(shared).c_str(), 0755), 0);
            EXPECT_TRUE(
                WaitFor([&] { return Count(host->Err(), "<6>serving " + shared) == 1; }, 15000))
                << line << host->Err();
        }
        else
            ADD_FAILURE() << "unknown case " << kind;
    }
}
