// hotfolder run --watch: files arriving slowly or in bursts are each
// processed exactly once; the run stops cleanly on a signal or the marker.
#include <fstream>
#include <thread>

#include "HostTestSupport.h"

using namespace host_test;

class HostWatchTest : public HostTest
{
protected:
    size_t Outputs(const std::string& folder)
    {
        size_t count = 0;
        for (const std::string& name : ListDirectory(folder + "/Output"))
            count += name.size() > 3 && name.compare(name.size() - 3, 3, ".ps") == 0;
        return count;
    }
};

TEST_F(HostWatchTest, SlowWritersAndBurstsAreEachProcessedOnce)
{
    std::string folder = MakePostScriptFolder();
    BackgroundHost host({"run", folder, "--watch", "--settle", "400"}, scratch);
    ASSERT_TRUE(WaitFor([&] { return host.Out().find("watching") != std::string::npos; }, 10000));

    // A burst of eight files at once.
    const std::string label = ReadFile(kExamples + "/eps/label.eps");
    for (int i = 0; i < 8; ++i)
        WriteFile(folder + "/burst" + std::to_string(i) + ".eps", label);

    // A slow writer: the file grows in pieces over about 1.5 s. Taken early,
    // it would be refused or fail as a truncated EPS file.
    {
        std::ofstream slow(folder + "/slow.eps", std::ios::binary);
        for (size_t at = 0; at < label.size(); at += 40)
        {
            slow << label.substr(at, 40);
            slow.flush();
            std::this_thread::sleep_for(std::chrono::milliseconds(100));
        }
    }
    ASSERT_TRUE(WaitFor([&] { return Outputs(folder) == 9; }, 20000)) << host.Out() << host.Err();
    // A second burst after a pause.
    for (int i = 0; i < 3; ++i)
        WriteFile(folder + "/late" + std::to_string(i) + ".eps", label);
    ASSERT_TRUE(WaitFor([&] { return Outputs(folder) == 12; }, 20000)) << host.Out();
    std::this_thread::sleep_for(std::chrono::milliseconds(800));

    host.Signal(SIGTERM);
    EXPECT_EQ(host.Wait(10000), 0) << host.Err();
    EXPECT_EQ(Outputs(folder), 12u); // nothing twice: no "(2)" outputs
    EXPECT_EQ(ListDirectory(Kept(folder)).size(), 12u);
    EXPECT_EQ(ReadFile(Kept(folder) + "/slow.eps"), label);
    EXPECT_NE(host.Out().find("12 done, 0 failed, 0 refused"), std::string::npos) << host.Out();
    EXPECT_EQ(host.Err(), "");
}

TEST_F(HostWatchTest, TheStopMarkerEndsTheWatch)
{
    std::string folder = MakePostScriptFolder();
    CopyExample("tiny.eps", folder);
    CopyExample("not-really.eps", folder);
    BackgroundHost host({"run", folder, "--watch", "--settle", "100"}, scratch);
    ASSERT_TRUE(WaitFor([&] { return Exists(folder + "/Output/tiny.ps"); }, 10000));
    std::this_thread::sleep_for(std::chrono::milliseconds(500));
    WriteFile(Warehouse() + "/StopHF", "");
    EXPECT_EQ(host.Wait(10000), 0);
    EXPECT_NE(host.Out().find("the StopHF marker appeared"), std::string::npos);
    // The refused file was reported once, not on every look at the folder.
    std::string out = host.Out();
    EXPECT_EQ(out.find("refused"), out.rfind("refused (left in place)"));
    EXPECT_TRUE(Exists(folder + "/not-really.eps"));

    // While the marker stands, a run does nothing.
    CopyExample("label.eps", folder);
    testkit::ProcessResult run = Host({"run", folder});
    EXPECT_EQ(run.exitCode, 0);
    EXPECT_TRUE(Exists(folder + "/label.eps"));
}

// A refused file is reported with its reason once, and once more each time
// it changes; a file left as it is stays quiet while the folder is looked at
// again and again.
TEST_F(HostWatchTest, ARefusalIsReportedOncePerChangeOfTheFile)
{
    const std::string folder = MakePostScriptFolder();
    const std::string note = folder + "/note.eps", memo = folder + "/memo.eps";
    WriteFile(note, "Dear customer, your order is ready.\n");
    WriteFile(memo, "Memo\n");
    BackgroundHost host({"run", folder, "--watch", "--settle", "100"}, scratch);
    const auto reported = [&](const std::string& path, const std::string& reason)
    {
        const std::string line = "refused (left in place): " + path + ": " + reason + "\n";
        const std::string out = host.Out();
        size_t count = 0;
        for (size_t at = out.find(line); at != std::string::npos; at = out.find(line, at + 1))
            ++count;
        return count;
    };
    const std::string noSignature =
        "not an EPS file: its first line is not %!PS-Adobe-x.x EPSF-x.x";
    const std::string tooShort = "not an EPS file: it is shorter than 12 bytes";
    const std::string empty = "not an EPS file: it is empty";
    ASSERT_TRUE(WaitFor([&] { return reported(memo, tooShort) == 1; }, 10000)) << host.Out();

    // Emptied: a change, reported with its new reason.
    WriteFile(memo, "");
    ASSERT_TRUE(WaitFor([&] { return reported(memo, empty) == 1; }, 10000)) << host.Out();
    // Only its time changed, found by a later look at the folder: a change too.
    const timespec times[2] = {{1000000000, 0}, {1000000000, 0}};
    ASSERT_EQ(utimensat(AT_FDCWD, memo.c_str(), times, 0), 0);
    ASSERT_TRUE(WaitFor([&] { return reported(memo, empty) == 2; }, 10000)) << host.Out();
    // Made an EPS file at last, it is taken.
    WriteFile(memo, ReadFile(kExamples + "/eps/tiny.eps"));
    ASSERT_TRUE(WaitFor([&] { return Exists(folder + "/Output/memo.ps"); }, 10000)) << host.Out();

    host.Signal(SIGTERM);
    EXPECT_EQ(host.Wait(10000), 0) << host.Err();
    // The folder was looked at again all along: the note, unchanged, was
    // reported once, and so was each earlier state of the memo.
    EXPECT_EQ(reported(note, noSignature), 1u) << host.Out();
    EXPECT_EQ(reported(memo, tooShort), 1u);
    EXPECT_EQ(reported(memo, empty), 2u);
    EXPECT_TRUE(Exists(note));
    EXPECT_NE(host.Out().find("1 done, 0 failed, 4 refused"), std::string::npos) << host.Out();
}
