// The service prints: each delivered output of a folder bound to a queue is
// one job at a scheduler of the test's own, named after the original,
// followed to its verdict; a scheduler that goes away holds the printing
// and nothing is lost or printed twice; status tells the queue's state.
#include "CupsJobs.h"
#include "PrivateCupsd.h"
#include <sys/stat.h>

#include "ServiceTestSupport.h"

using namespace service_test;

namespace
{
class ServicePrinting : public ServiceTest
{
protected:
    void SetUp() override
    {
        ServiceTest::SetUp();
        if (!cups_test::PrivateCupsd::Installed())
            GTEST_SKIP() << cups_test::PrivateCupsd::kMissing;
        std::string problem;
        cups = cups_test::PrivateCupsd::StartWithQueue(scratch, "office",
                                                       HF_TEST_DATA_DIR "/ppd/test-postscript.ppd",
                                                       scratch + "/device.ps", problem);
        ASSERT_TRUE(cups) << problem;
    }
    void TearDown() override { unsetenv("CUPS_SERVER"); }

    std::string BoundFolder(const std::string& name, const std::string& queue = "office")
    {
        const std::string folder = MakePostScriptFolder("A4", name);
        WriteFile(Container(folder) + "/PrinterQueue.txt", queue + "\n");
        return folder;
    }

    // The scheduler's jobs of a queue by name: how many ended completed,
    // how many did not end yet.
    std::map<std::string, std::pair<int, int>> Jobs(const std::string& queue = "office")
    {
        std::map<std::string, std::vector<printing::JobState>> marked;
        printing::CupsError error;
        EXPECT_TRUE(printing::ListMarkedJobs(queue, marked, error)) << error.reason;
        std::map<std::string, std::pair<int, int>> byName;
        for (const auto& entry : marked)
            for (const printing::JobState& job : entry.second)
            {
                byName[job.name].first += job.end == printing::JobEnd::Completed;
                byName[job.name].second += job.end == printing::JobEnd::Open;
            }
        return byName;
    }

    bool AllPrintedOnce(const std::set<std::string>& names, const std::string& queue = "office")
    {
        // Asked a few times a second, not to keep the scheduler from printing.
        std::this_thread::sleep_for(std::chrono::milliseconds(200));
        const auto jobs = Jobs(queue);
        if (jobs.size() != names.size())
            return false;
        for (const std::string& name : names)
            if (!jobs.count(name) || jobs.at(name) != std::make_pair(1, 0))
                return false;
        return true;
    }

    std::string Json() { return Host({"status", "--json"}).out; }

    void Drop(const std::string& folder, const std::string& name)
    {
        WriteFile(scratch + "/.incoming", label);
        ASSERT_EQ(rename((scratch + "/.incoming").c_str(), (folder + "/" + name).c_str()), 0);
    }

    std::unique_ptr<cups_test::PrivateCupsd> cups;
};
} // namespace

TEST_F(ServicePrinting, EveryDropIsOneCompletedJobNamedAfterItsOriginal)
{
    const std::string folder = BoundFolder("hot");
    auto host = Serve(1);
    std::set<std::string> names;
    for (int i = 0; i < 20; ++i)
    {
        names.insert("art" + std::to_string(i) + ".eps");
        Drop(folder, "art" + std::to_string(i) + ".eps");
    }
    ASSERT_TRUE(WaitFor([&] { return AllPrintedOnce(names); }, 20000)) << host->Err();
    ASSERT_TRUE(
        WaitFor([&] { return Json().find("\"printed_total\": 20") != std::string::npos; }, 5000))
        << Json();
    for (const char* part :
         {"\"queue\": \"office\"", "\"queue_state\": \"idle\"", "\"queue_reasons\": []",
          "\"printing\": 0, \"printed_today\": 20, \"printed_total\": 20, "
          "\"print_failed_today\": 0",
          "\"last_print_failure\": null"})
        EXPECT_NE(Json().find(part), std::string::npos) << part << "\n" << Json();
    EXPECT_NE(Host({"status"})
                  .out.find("  Printer:     office, idle\n  Printing:    0 now, 20 "
                            "printed today, 20 in total, 0 printer failure(s) today\n"),
              std::string::npos)
        << Host({"status"}).out;
    // The paper travels with the job to the queue's filter.
    EXPECT_NE(ReadFile(scratch + "/device.ps").find("*PageSize A4"), std::string::npos);
    EXPECT_EQ(Count(host->Err(), "<3>"), 0u) << host->Err();
}

TEST_F(ServicePrinting, AUsersFolderPrintsAsThatUser)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "needs root, as the service runs";
    ASSERT_EQ(chmod(scratch.c_str(), 0755), 0);
    const std::string folder = BoundFolder("user");
    ASSERT_EQ(testkit::RunProgram({"chown", "-R", "65534:65534", folder}).exitCode, 0);
    const std::string root = BoundFolder("admin");
    auto host = Serve(2);
    Drop(folder, "theirs.eps");
    Drop(root, "ours.eps");
    ASSERT_TRUE(WaitFor(
        [&] {
            return AllPrintedOnce({"theirs.eps", "ours.eps"});
        },
        20000))
        << host->Err();
    std::map<std::string, std::vector<printing::JobState>> marked;
    printing::CupsError error;
    ASSERT_TRUE(printing::ListMarkedJobs("office", marked, error)) << error.reason;
    std::map<std::string, std::string> users;
    for (const auto& entry : marked)
        for (const printing::JobState& job : entry.second)
            users[job.name] = job.user;
    EXPECT_EQ(users["theirs.eps"], "nobody");
    EXPECT_EQ(users["ours.eps"], "root");
}

TEST_F(ServicePrinting, AStoppedQueueAndACancelledJobShowAsTheSchedulerSaysThem)
{
    const std::string folder = BoundFolder("hot");
    ASSERT_EQ(testkit::RunProgram(
                  {cups_test::PrivateCupsd::Find("cupsdisable"), "-h", cups->Server(), "office"})
                  .exitCode,
              0);
    auto host = Serve(1);
    Drop(folder, "held.eps");
    ASSERT_TRUE(WaitFor([&] { return Jobs().count("held.eps"); }, 10000)) << host->Err();
    // The job waits at the stopped queue: one of its open jobs.
    std::map<std::string, std::vector<printing::JobState>> marked;
    std::set<int> open;
    printing::CupsError error;
    ASSERT_TRUE(printing::ListMarkedJobs("office", marked, error)) << error.reason;
    ASSERT_TRUE(printing::OpenJobIds("office", open, error)) << error.reason;
    ASSERT_EQ(marked.size(), 1u);
    EXPECT_EQ(open, std::set<int>{marked.begin()->second.at(0).id});
    const std::string json = Json();
    for (const char* part :
         {"\"queue_state\": \"stopped\"", "\"queue_reasons\": [\"paused\"]", "\"printing\": 1"})
        EXPECT_NE(json.find(part), std::string::npos) << part << "\n" << json;
    // Cancelled at the scheduler: a printer failure, the output and original stay.
    ASSERT_EQ(testkit::RunProgram(
                  {cups_test::PrivateCupsd::Find("cancel"), "-h", cups->Server(), "-a", "office"})
                  .exitCode,
              0);
    ASSERT_TRUE(WaitFor(
        [&]
        {
            return ReadFile(Failed(folder) + "/failed-jobs.log")
                       .find("held.eps\tprinter: CUPS "
                             "job") != std::string::npos;
        },
        10000))
        << host->Err();
    EXPECT_NE(ReadFile(Failed(folder) + "/failed-jobs.log").find("on office cancelled"),
              std::string::npos);
    EXPECT_TRUE(Exists(folder + "/Output/held.ps"));
    EXPECT_TRUE(Exists(Kept(folder) + "/held.eps"));
    EXPECT_NE(Json().find("\"printing\": 0, \"printed_today\": 0, \"printed_total\": 0, "
                          "\"print_failed_today\": 1"),
              std::string::npos)
        << Json();
    EXPECT_NE(Json().find("\"last_print_failure\": \"held.eps: cancelled on office"),
              std::string::npos)
        << Json();

    // Retried, the cancelled original and one the filter failed print; a
    // name that is no failed original is said so.
    ASSERT_EQ(testkit::RunProgram(
                  {cups_test::PrivateCupsd::Find("cupsenable"), "-h", cups->Server(), "office"})
                  .exitCode,
              0);
    WriteFile(Failed(folder) + "/refused.eps", label);
    const testkit::ProcessResult named = Host({"retry", folder, "held.eps", "nothing.eps"});
    EXPECT_EQ(named.exitCode, 1);
    EXPECT_NE(named.err.find("nothing.eps is not a failed original of " + folder),
              std::string::npos)
        << named.err;
    EXPECT_NE(named.out.find("held.eps: back in the hot folder as " + folder +
                             "/held.eps\n1 "
                             "retried"),
              std::string::npos)
        << named.out;
    const testkit::ProcessResult all = Host({"retry", folder});
    EXPECT_EQ(all.exitCode, 0);
    EXPECT_EQ(all.out,
              "refused.eps: back in the hot folder as " + folder + "/refused.eps\n1 retried\n");
    EXPECT_TRUE(WaitFor(
        [&] {
            return AllPrintedOnce({"held.eps", "refused.eps"});
        },
        20000))
        << host->Err();
    EXPECT_NE(ReadFile(Failed(folder) + "/failed-jobs.log")
                  .find("held.eps\tretried: moved back into the hot folder"),
              std::string::npos);
    EXPECT_EQ(Host({"retry", folder}).out, "0 retried\n");
    EXPECT_NE(Json().find("\"printed_today\": 2, \"printed_total\": 2, \"print_failed_today\": 1"),
              std::string::npos)
        << Json();
}

TEST_F(ServicePrinting, SettingsBindAServedFolderToAQueueAndToNone)
{
    const std::string folder = MakePostScriptFolder("A4", "hot");
    auto host = Serve(1);
    const testkit::ProcessResult unknown = Host({"settings", folder, "--printer", "nosuch"});
    EXPECT_EQ(unknown.exitCode, 3);
    EXPECT_NE(unknown.err.find("has no queue \"nosuch\""), std::string::npos) << unknown.err;
    EXPECT_FALSE(Exists(Container(folder) + "/PrinterQueue.txt"));

    EXPECT_EQ(Host({"settings", folder, "--printer", "office"}).out,
              folder + " prints on office\n");
    EXPECT_EQ(ReadFile(Container(folder) + "/PrinterQueue.txt"), "office\n");
    EXPECT_NE(ReadFile(Container(folder) + "/server.ppd").find("*PCFileName"), std::string::npos);
    ASSERT_TRUE(WaitFor(
        [&] { return Count(host->Err(), "<6>serving " + folder + " (printing on office)\n"); },
        10000))
        << host->Err();
    Drop(folder, "bound.eps");
    EXPECT_TRUE(WaitFor([&] { return AllPrintedOnce({"bound.eps"}); }, 20000)) << host->Err();

    const size_t unboundBefore = Count(host->Err(), "<6>serving " + folder + "\n");
    EXPECT_EQ(Host({"settings", folder, "--printer", "none"}).exitCode, 0);
    EXPECT_FALSE(Exists(Container(folder) + "/PrinterQueue.txt"));
    ASSERT_TRUE(WaitFor(
        [&] { return Count(host->Err(), "<6>serving " + folder + "\n") > unboundBefore; }, 10000))
        << host->Err();
    Drop(folder, "unbound.eps");
    ASSERT_TRUE(WaitFor([&] { return Exists(Kept(folder) + "/unbound.eps"); }, 10000));
    std::this_thread::sleep_for(std::chrono::milliseconds(300));
    EXPECT_EQ(Jobs().count("unbound.eps"), 0u);
    EXPECT_TRUE(Exists(folder + "/Output/unbound.ps"));
    EXPECT_NE(Json().find("\"queue\": null"), std::string::npos) << Json();
}

TEST_F(ServicePrinting, ASchedulerAwayHoldsThePrintingAndNothingIsLostOrTwice)
{
    const std::string folder = BoundFolder("hot");
    auto host = Serve(1);
    std::set<std::string> names;
    for (int i = 0; i < 10; ++i)
    {
        names.insert("a" + std::to_string(i) + ".eps");
        Drop(folder, "a" + std::to_string(i) + ".eps");
        if (i == 4)
            cups->Stop();
    }
    ASSERT_TRUE(WaitFor([&] { return ListDirectory(Kept(folder)).size() == 10; }, 20000));
    ASSERT_TRUE(
        WaitFor([&] { return Count(host->Err(), "<3>printing on office held: ") == 1; }, 10000))
        << host->Err();
    EXPECT_NE(Json().find("\"problem\": \"printing on office held: "), std::string::npos) << Json();
    std::string problem;
    ASSERT_TRUE(cups->Start(problem)) << problem;
    EXPECT_TRUE(WaitFor([&] { return AllPrintedOnce(names); }, 30000)) << host->Err();
    EXPECT_TRUE(WaitFor([&] { return Count(host->Err(), "<6>printing resumed") == 1; }, 10000))
        << host->Err();
    EXPECT_NE(Json().find("\"problem\": null"), std::string::npos) << Json();
    EXPECT_EQ(Count(host->Err(), "held"), 1u) << "reported once: " << host->Err();
}
