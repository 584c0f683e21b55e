// hotfolder run where timing matters: files spoilt or deleted between
// sniffing and processing, the time statistics, and the progress bar on a
// terminal.
#include <poll.h>
#include <pty.h>

#include "HostTestSupport.h"

using namespace host_test;

namespace
{
// Runs the host with standard output and error on a new pseudo terminal;
// everything it wrote there.
std::string RunOnTerminal(const std::vector<std::string>& args)
{
    int master = -1, slave = -1;
    if (openpty(&master, &slave, nullptr, nullptr, nullptr) != 0)
        return "no pseudo terminal";
    std::vector<std::string> all = {kHost};
    all.insert(all.end(), args.begin(), args.end());
    const std::string terminal = ptsname(master);
    const pid_t pid = testkit::StartProgram(all, terminal, terminal);
    const bool spawned = pid > 0;
    close(slave);
    std::string text;
    char buffer[4096];
    pollfd wanted{master, POLLIN, 0};
    // Reading ends with EIO once the program and its terminal are gone.
    while (spawned && poll(&wanted, 1, 30000) > 0)
    {
        const ssize_t got = read(master, buffer, sizeof buffer);
        if (got <= 0)
            break;
        text.append(buffer, got);
    }
    close(master);
    testkit::WaitProgram(pid);
    return text;
}

class HostRun : public HostTest
{
protected:
    void SetUp() override
    {
        HostTest::SetUp();
        folder = MakePostScriptFolder();
        CopyExample("label.eps", folder);
        CopyExample("tiny.eps", folder);
    }
    std::string folder;
};
} // namespace

TEST_F(HostRun, AFileSpoiltAfterSniffingFailsIntoTheFailedFolderWithALogLine)
{
    BackgroundHost host({"run", folder, "--delay-jobs", "1500"}, scratch);
    ASSERT_TRUE(
        WaitFor([&] { return host.Out().find("found 2 job(s)") != std::string::npos; }, 10000));
    WriteFile(folder + "/label.eps", "no longer PostScript\n");
    EXPECT_EQ(host.Wait(20000), 1);
    EXPECT_EQ(ListDirectory(Failed(folder)),
              (std::vector<std::string>{"failed-jobs.log", "label.eps"}));
    EXPECT_EQ(ReadFile(Failed(folder) + "/label.eps"), "no longer PostScript\n");
    EXPECT_NE(ReadFile(Failed(folder) + "/failed-jobs.log")
                  .find("label.eps\tInvalid input file: not an EPS file: its first line is not "
                        "%!PS-Adobe-x.x EPSF-x.x (-1005)"),
              std::string::npos);
    EXPECT_NE(host.Err().find("Invalid input file"), std::string::npos);
    EXPECT_NE(host.Out().find("1 done, 1 failed, 0 refused"), std::string::npos) << host.Out();
    EXPECT_TRUE(Exists(folder + "/Output/tiny.ps"));
    EXPECT_FALSE(Exists(folder + "/Output/label.ps"));
}

TEST_F(HostRun, AFileDeletedAfterSniffingIsReportedAndTheOthersGoOn)
{
    BackgroundHost host({"run", folder, "--delay-jobs", "1500"}, scratch);
    ASSERT_TRUE(
        WaitFor([&] { return host.Out().find("found 2 job(s)") != std::string::npos; }, 10000));
    unlink((folder + "/label.eps").c_str());
    EXPECT_EQ(host.Wait(20000), 1);
    EXPECT_NE(host.Err().find(folder + "/label.eps vanished between sniffing and processing"),
              std::string::npos)
        << host.Err();
    EXPECT_TRUE(Exists(folder + "/Output/tiny.ps"));
    EXPECT_FALSE(Exists(Failed(folder) + "/label.eps"));
}

TEST_F(HostRun, AnOutputThatCannotBeDeliveredFailsTheJobAndKeepsTheOriginal)
{
    const std::string out = scratch + "/out";
    BackgroundHost host({"run", folder, "--out", out, "--delay-jobs", "1500"}, scratch);
    ASSERT_TRUE(
        WaitFor([&] { return host.Out().find("found 2 job(s)") != std::string::npos; }, 10000));
    ASSERT_EQ(rmdir(out.c_str()), 0);
    WriteFile(out, "a file where the output folder was");
    EXPECT_EQ(host.Wait(20000), 1);
    EXPECT_NE(host.Err().find("cannot deliver the output: "), std::string::npos) << host.Err();
    EXPECT_EQ(ListDirectory(Failed(folder)),
              (std::vector<std::string>{"failed-jobs.log", "label.eps", "tiny.eps"}));
}

TEST_F(HostRun, StatsReportTheTimeOutsideTheFilter)
{
    const testkit::ProcessResult run = Host({"run", folder, "--stats"});
    ASSERT_EQ(run.exitCode, 0);
    double total = -1, sniff = -1, inside = -1, outside = -1, share = -1;
    const size_t at = run.out.find("Timing:");
    ASSERT_NE(at, std::string::npos) << run.out;
    ASSERT_EQ(std::sscanf(run.out.c_str() + at,
                          "Timing: total %lf s, sniffing %lf s, inside Process %lf s, outside "
                          "Process %lf s (%lf%%",
                          &total, &sniff, &inside, &outside, &share),
              5);
    EXPECT_GT(inside, 0);
    EXPECT_NEAR(inside + outside, total, 0.002);
}

// On a terminal a bar runs up to 100 % (on a pipe each job gets a line
// instead, see run.txt).
TEST_F(HostRun, AProgressBarOnATerminal)
{
    const std::string shown = RunOnTerminal({"run", folder});
    EXPECT_NE(shown.find("\r\033[K[##"), std::string::npos) << shown;
    EXPECT_NE(shown.find("] 100%  2/2  "), std::string::npos) << shown;
    EXPECT_EQ(shown.find("[2/2]"), std::string::npos) << shown;
    EXPECT_NE(shown.find("2 done, 0 failed"), std::string::npos) << shown;
}
