// The service's folders: how files arrive, several folders each by its own
// settings, the list changing while it serves, bad input, status and stop,
// and the systemd unit.
#include "ServiceTestSupport.h"

using namespace service_test;

namespace
{
void WriteSome(int fd, const std::string& bytes)
{
    ASSERT_EQ(write(fd, bytes.data(), bytes.size()), static_cast<ssize_t>(bytes.size()));
}
} // namespace

TEST_F(ServiceTest, EveryWayOfArrivingIsTakenOnceAndWhole)
{
    const std::string folder = MakePostScriptFolder("A4", "hot");
    auto host = Serve(1);
    const std::string half = label.substr(0, label.size() / 2), rest = label.substr(half.size());
    const auto stillWaiting = [&](const std::string& path)
    {
        std::this_thread::sleep_for(std::chrono::milliseconds(500)); // > settle time
        EXPECT_TRUE(Exists(path)) << path << " was taken while open for writing";
    };
    const auto arrivals = testkit::ReadCaseTable("service/arrivals.txt");
    for (const testkit::CaseFields& row : arrivals)
    {
        const std::string &way = row[0], &line = row.back();
        const std::string path = folder + "/" + way + ".eps";
        const std::string outside = scratch + "/" + way + ".eps";
        if (way == "cp" || way == "rename" || way == "link")
            WriteFile(outside, label);
        if (way == "cp")
            ASSERT_EQ(testkit::RunProgram({"cp", outside, path}).exitCode, 0);
        else if (way == "rename")
            ASSERT_EQ(rename(outside.c_str(), path.c_str()), 0);
        else if (way == "link")
            ASSERT_EQ(link(outside.c_str(), path.c_str()), 0);
        else if (way == "two-writers")
        {
            int first = open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL, 0644);
            WriteSome(first, half);
            int second = open(path.c_str(), O_WRONLY | O_APPEND);
            close(first);
            stillWaiting(path);
            WriteSome(second, rest);
            close(second);
        }
        else if (way == "slow")
        {
            int fd = open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL, 0644);
            for (size_t at = 0; at < label.size(); at += label.size() / 3 + 1)
            {
                WriteSome(fd, label.substr(at, label.size() / 3 + 1));
                stillWaiting(path);
            }
            close(fd);
        }
        const std::string output = folder + "/Output/" + way + ".ps",
                          kept = Kept(folder) + "/" + way + ".eps";
        ASSERT_TRUE(WaitFor([&] { return Exists(output) && !Exists(path) && Exists(kept); }, 10000))
            << line << "\n"
            << host->Err();
        // The whole EPS program went into the job: its last line is in the output.
        const std::string body = label.substr(0, label.find_last_not_of("\r\n") + 1);
        const std::string lastLine = body.substr(body.find_last_of("\r\n") + 1);
        EXPECT_NE(ReadFile(output).find(lastLine), std::string::npos) << line;
        EXPECT_EQ(ReadFile(kept), label) << line;
    }
    EXPECT_EQ(ListDirectory(folder + "/Output").size(), 2 * arrivals.size());
    EXPECT_EQ(Count(host->Err(), "<3>"), 0u) << host->Err();
    // A file the filter does not take is left in place with a warning.
    CopyExample("not-really.eps", folder);
    EXPECT_TRUE(WaitFor(
        [&] { return Count(host->Err(), "<4>refused (left in place): " + folder) == 1; }, 5000))
        << host->Err();
}

TEST_F(ServiceTest, EachFolderByItsOwnSettingsAsTheListChanges)
{
    const std::vector<std::pair<std::string, std::string>> papers = {
        {"a4", "A4"}, {"letter", "Letter"}, {"a3", "A3"}};
    for (const auto& paper : papers)
        MakePostScriptFolder(paper.second, paper.first);
    auto host = Serve(papers.size());

    for (const auto& [name, paper] : papers)
        for (const char* file : {"/one.eps", "/two.eps"})
            WriteFile(scratch + "/" + name + file, label);
    for (const auto& [name, paper] : papers)
    {
        const std::string output = scratch + "/" + name + "/Output/";
        ASSERT_TRUE(WaitFor([&] { return ListDirectory(output).size() == 4; }, 10000)) << name;
        EXPECT_NE(ReadFile(output + "two.ps.Folder.cfg").find("Value=\"" + paper + "\""),
                  std::string::npos)
            << name;
    }

    // Added while serving: picked up. Removed: no longer watched.
    const std::string added = MakePostScriptFolder("A4", "added");
    ASSERT_TRUE(WaitFor([&] { return Count(host->Err(), "<6>serving " + added) >= 1; }, 10000));
    std::this_thread::sleep_for(std::chrono::milliseconds(300)); // its settings, made after init
    WriteFile(added + "/new.eps", label);
    EXPECT_TRUE(WaitFor([&] { return Exists(added + "/Output/new.ps"); }, 10000)) << host->Err();
    EXPECT_EQ(Host({"remove", scratch + "/a4"}).exitCode, 0);
    ASSERT_TRUE(WaitFor([&] { return Count(host->Err(), "no longer serving") == 1; }, 10000));
    WriteFile(scratch + "/a4/late.eps", label);
    std::this_thread::sleep_for(std::chrono::milliseconds(600));
    EXPECT_TRUE(Exists(scratch + "/a4/late.eps"));
}

TEST_F(ServiceTest, BadInputIsReportedAndTheOthersGoOn)
{
    const std::string good = MakePostScriptFolder("A4", "good");
    const std::string doomed = MakePostScriptFolder("A4", "doomed");
    std::string list = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<HotFolderList>\n";
    for (const std::string& path :
         {good, doomed, scratch + "/plain-file", scratch + "/loop", scratch + "/broken"})
        list += "  <HotFolder path=\"" + path + "\"/>\n";
    WriteFile(scratch + "/plain-file", "x");
    ASSERT_EQ(symlink((scratch + "/loop").c_str(), (scratch + "/loop").c_str()), 0);
    const std::string broken = MakePostScriptFolder("A4", "broken");
    const std::string brokenConfig = Container(broken) + "/Folder.cfg";
    const std::string sound = ReadFile(brokenConfig);
    WriteFile(brokenConfig, "<HotFolder");
    WriteFile(Warehouse() + "/HotFolderList.cfg", list + "</HotFolderList>\n");

    auto host = Serve(2);
    for (const testkit::CaseFields& row : testkit::ReadCaseTable("service/bad-input.txt"))
    {
        const std::string &kind = row[0], &line = row.back();
        if (kind == "list-file" || kind == "symlink-loop" || kind == "broken-config")
        {
            const std::string path = scratch + (kind == "list-file"      ? "/plain-file"
                                                : kind == "symlink-loop" ? "/loop"
                                                                         : "/broken");
            EXPECT_NE(host->Err().find("<3>cannot serve " + path), std::string::npos) << line;
        }
        else if (kind == "deleted")
        {
            testkit::RunProgram({"rm", "-rf", doomed});
            EXPECT_TRUE(WaitFor(
                [&] { return host->Err().find(doomed + " vanished") != std::string::npos; }, 5000))
                << host->Err();
        }
        else if (kind == "repaired")
        {
            WriteFile(brokenConfig, sound);
            EXPECT_TRUE(
                WaitFor([&] { return Count(host->Err(), "<6>serving " + broken) == 1; }, 15000))
                << host->Err();
            WriteFile(brokenConfig, "<HotFolder");
            EXPECT_TRUE(
                WaitFor([&] { return Count(host->Err(), "<3>cannot serve " + broken) == 2; }, 5000))
                << host->Err();
        }
        else if (kind == "fifo")
            ASSERT_EQ(mkfifo((good + "/x.eps").c_str(), 0644), 0);
        else if (kind == "vanishing")
            for (int i = 0; i < 20; ++i)
            {
                const std::string path = good + "/gone" + std::to_string(i) + ".eps";
                WriteFile(path, label);
                unlink(path.c_str());
            }
        else if (kind == "undeliverable")
        {
            // A file where the output folder was (the folder aside, hidden).
            ASSERT_EQ(rename((good + "/Output").c_str(), (good + "/.Output").c_str()), 0);
            WriteFile(good + "/Output", "no folder");
            WriteFile(good + "/late.eps", label);
            EXPECT_TRUE(WaitFor(
                [&]
                {
                    return host->Err().find("<3>late.eps: failed: cannot deliver the output: ") !=
                           std::string::npos;
                },
                5000))
                << host->Err();
            EXPECT_NE(host->Err().find("; moved to " + Failed(good) + "/late.eps"),
                      std::string::npos)
                << host->Err();
            EXPECT_EQ(host->Err().find("cannot write the failure log"), std::string::npos)
                << host->Err();
            unlink((good + "/Output").c_str());
            ASSERT_EQ(rename((good + "/.Output").c_str(), (good + "/Output").c_str()), 0);
        }
        else if (kind == "untakeable")
        {
            // An append-only folder: files come in, none goes out, not even
            // for root. Where the file system has no such flag, nothing to see.
            struct Undo
            {
                std::string path;
                ~Undo() { testkit::RunProgram({"chattr", "-a", path}); }
            } undo{good};
            if (testkit::RunProgram({"chattr", "+a", good}).exitCode != 0)
                continue;
            WriteFile(good + "/stuck.eps", label);
            EXPECT_TRUE(WaitFor(
                [&]
                {
                    return host->Err().find("<3>cannot take " + good +
                                            "/stuck.eps: Operation not permitted") !=
                           std::string::npos;
                },
                5000))
                << host->Err();
            testkit::RunProgram({"chattr", "-a", good});
            unlink((good + "/stuck.eps").c_str());
        }
        // The good folder is served after each.
        const std::string probe = good + "/after-" + kind + ".eps";
        WriteFile(probe, label);
        EXPECT_TRUE(WaitFor([&] { return !Exists(probe); }, 5000)) << line << "\n" << host->Err();
    }
    EXPECT_TRUE(Exists(good + "/x.eps"));
    EXPECT_EQ(host->Wait(0), -1) << "the service ended: " << host->Err();
}

TEST_F(ServiceTest, StatusRemoveAndStop)
{
    const std::string a4 = MakePostScriptFolder("A4", "a4");
    const std::string letter = MakePostScriptFolder("Letter", "letter");
    EXPECT_NE(Host({"status"}).out.find("not running"), std::string::npos);
    {
        auto host = Serve(2);
        WriteFile(a4 + "/one.eps", label);
        // What failed jobs leave: lines in the failure log, one of them old.
        char now[32];
        const time_t clock = time(nullptr);
        strftime(now, sizeof now, "%Y-%m-%d %H:%M:%S", localtime(&clock));
        WriteFile(Failed(a4) + "/failed-jobs.log",
                  "2001-01-01 10:00:00\told.eps\tInvalid input file (-1005)\n" + std::string(now) +
                      "\tbad.eps\tInvalid input file (-1005)\n");
        ASSERT_TRUE(WaitFor([&] { return ListDirectory(Kept(a4)).size() == 1; }, 10000))
            << host->Err();
        testkit::ProcessResult status = Host({"status", "--json"});
        EXPECT_EQ(status.exitCode, 0);
        for (const std::string& part : std::vector<std::string>{
                 "\"running\": true", "\"path\": \"" + a4 + "\"",
                 "\"server\": \"Example PostScript printer\"", "\"output_type\": \"PostScript\"",
                 "\"page\": \"A4\"", "\"page\": \"Letter\"",
                 "\"waiting\": 0, \"done_today\": 1, \"done_total\": 1, \"failed_today\": 1, "
                 "\"failed_total\": 2",
                 "\"last_failure\": \"bad.eps: Invalid input file (-1005)\""})
            EXPECT_NE(status.out.find(part), std::string::npos) << part << "\n" << status.out;
        // Killed, it leaves the marker but not the lock: not running.
        host->Signal(SIGKILL);
        host->Wait(5000);
    }
    EXPECT_TRUE(Exists(Warehouse() + "/Service/RunService"));
    EXPECT_NE(Host({"status"}).out.find("Service:       not running"), std::string::npos);

    auto host = Serve(2);
    // One service at a time.
    mkdir((scratch + "/second").c_str(), 0755);
    BackgroundHost second({"serve"}, scratch + "/second");
    EXPECT_EQ(second.Wait(5000), 3);
    EXPECT_EQ(second.Err(), "<3>a hot-folder service is running already\n");
    // StopHF pauses every folder until it goes.
    WriteFile(Warehouse() + "/StopHF", "");
    ASSERT_TRUE(WaitFor([&] { return host->Err().find("paused") != std::string::npos; }, 5000));
    WriteFile(letter + "/held.eps", label);
    std::this_thread::sleep_for(std::chrono::milliseconds(500));
    EXPECT_TRUE(Exists(letter + "/held.eps"));
    unlink((Warehouse() + "/StopHF").c_str());
    EXPECT_TRUE(WaitFor([&] { return Exists(letter + "/Output/held.ps"); }, 5000)) << host->Err();
    EXPECT_EQ(Host({"remove", letter}).exitCode, 0);
    EXPECT_EQ(Host({"remove", letter}).exitCode, 3);
    EXPECT_EQ(Host({"status", "--json"}).out.find(letter), std::string::npos);
    EXPECT_TRUE(Exists(letter + "/" + kContainer)); // the folder stays
    testkit::ProcessResult stop = Host({"stop"});
    EXPECT_EQ(stop.exitCode, 0) << stop.err;
    EXPECT_EQ(host->Wait(5000), 0);
    // SIGTERM ends it too (systemd's stop).
    host = Serve(1);
    host->Signal(SIGTERM);
    EXPECT_EQ(host->Wait(5000), 0);
    EXPECT_NE(Host({"serve", "--help"}).out.find("RunService"), std::string::npos);
}

TEST_F(ServiceTest, TheInstalledUnitVerifies)
{
    if (testkit::RunProgram({"systemd-analyze", "--version"}).exitCode != 0)
        GTEST_SKIP() << "systemd-analyze is not installed; the unit file is not verified";
    const std::string prefix = scratch + "/installed";
    testkit::ProcessResult install =
        testkit::RunProgram({HF_CMAKE_COMMAND, "--install", HF_BUILD_DIR, "--prefix", prefix});
    ASSERT_EQ(install.exitCode, 0) << install.err;
    const std::string unit = prefix + "/lib/systemd/system/hotfolder.service";
    EXPECT_NE(ReadFile(unit).find("ExecStart=" + prefix + "/bin/hotfolder serve"),
              std::string::npos);
    testkit::ProcessResult verify = testkit::RunProgram({"systemd-analyze", "verify", unit});
    EXPECT_EQ(verify.exitCode, 0) << verify.out << verify.err;
    EXPECT_EQ(verify.err, "");
}

TEST_F(ServiceTest, TheInstalledUnitIsSandboxed)
{
    if (testkit::RunProgram({"systemd-analyze", "--version"}).exitCode != 0)
        GTEST_SKIP() << "systemd-analyze is not installed; the sandbox is not rated";
    const std::string prefix = scratch + "/installed";
    ASSERT_EQ(testkit::RunProgram({HF_CMAKE_COMMAND, "--install", HF_BUILD_DIR, "--prefix", prefix})
                  .exitCode,
              0);
    const std::string unit = prefix + "/lib/systemd/system/hotfolder.service";
    const testkit::ProcessResult rating =
        testkit::RunProgram({"systemd-analyze", "security", "--offline=yes", unit});
    const std::string overall = "Overall exposure level for hotfolder.service: ";
    const size_t at = rating.out.find(overall);
    ASSERT_NE(at, std::string::npos) << rating.out << rating.err;
    const double exposure = std::strtod(rating.out.c_str() + at + overall.size(), nullptr);
    std::printf("systemd-analyze security: exposure %.1f of 10 (at most 3.0)\n", exposure);
    RecordProperty("exposure", std::to_string(exposure));
    EXPECT_GT(exposure, 0.0) << rating.out;
    EXPECT_LE(exposure, 3.0) << rating.out;
}

TEST_F(ServiceTest, RunWalksTheServicesRoadOneProcessAFolder)
{
    const std::string folder = MakePostScriptFolder("A4", "hot");
    for (int i = 0; i < 300; ++i)
        WriteFile(folder + "/f" + std::to_string(i) + ".eps", label);
    // Two runs at once: one works the folder, the other says who does.
    {
        BackgroundHost first({"run", folder}, scratch), second({"run", folder}, scratch);
        const int a = first.Wait(120000), b = second.Wait(120000);
        EXPECT_EQ(std::min(a, b), 0) << first.Err() << second.Err();
        EXPECT_EQ(std::max(a, b), 3) << first.Err() << second.Err();
        EXPECT_NE((a == 3 ? first : second).Err().find("the folder is worked by another run, pid "),
                  std::string::npos)
            << first.Err() << second.Err();
        EXPECT_NE((a == 0 ? first : second).Out().find("300 done, 0 failed"), std::string::npos);
    }
    const std::vector<std::string> outputs = ListDirectory(folder + "/Output");
    EXPECT_EQ(outputs.size(), 600u);
    EXPECT_EQ(std::count_if(outputs.begin(), outputs.end(),
                            [](const std::string& name) { return name.find("(2)") != name.npos; }),
              0);
    // A file its writer still holds open is left for later.
    const int writer = open((folder + "/open.eps").c_str(), O_WRONLY | O_CREAT | O_EXCL, 0644);
    WriteSome(writer, label);
    EXPECT_EQ(Host({"run", folder}).exitCode, 0);
    EXPECT_TRUE(Exists(folder + "/open.eps"));
    close(writer);
    EXPECT_EQ(Host({"run", folder}).exitCode, 0);
    EXPECT_FALSE(Exists(folder + "/open.eps"));
    // A folder the service serves is left to it.
    auto host = Serve(1);
    testkit::ProcessResult run = Host({"run", folder});
    EXPECT_EQ(run.exitCode, 3);
    EXPECT_NE(run.err.find("the folder is served by the hot-folder service, pid "),
              std::string::npos)
        << run.err;
}
