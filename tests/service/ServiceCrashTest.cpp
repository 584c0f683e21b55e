// The service killed with SIGKILL at seeded random moments while files flow
// through two folders, one of them printing, restarted each time: afterwards
// every original is kept once and has exactly one whole output, the printing
// folder's originals are each one completed job at the scheduler, and
// nothing is left behind.
#include <random>

#include "CupsJobs.h"
#include "PrivateCupsd.h"
#include "ServiceTestSupport.h"

using namespace service_test;

static const std::string kTrailer = "%%Trailer\r\n%%EOF\r\n";

TEST_F(ServiceTest, KilledAtAnyMomentEveryFileIsDeliveredExactlyOnce)
{
    const std::vector<std::string> folders = {MakePostScriptFolder("A4", "a"),
                                              MakePostScriptFolder("Letter", "b")};
    // Folder a prints on a raw queue of a scheduler of the test's own.
    std::unique_ptr<cups_test::PrivateCupsd> cups;
    if (cups_test::PrivateCupsd::Installed())
    {
        std::string problem;
        cups = cups_test::PrivateCupsd::StartWithQueue(scratch, "press", "", "/dev/null", problem);
        ASSERT_TRUE(cups) << problem;
        WriteFile(Container(folders[0]) + "/PrinterQueue.txt", "press\n");
    }
    const int kKills = 100, kFilesPerFolderAndRound = 5;
    std::mt19937 random(20240515);
    std::uniform_int_distribution<int> delayMs(0, 25);
    std::set<std::string> dropped;
    int kills = 0, interrupted = 0; // kills that left a job in hand
    const auto started = std::chrono::steady_clock::now();
    for (; kills < kKills; ++kills)
    {
        // Files arrive complete (renamed in), some while the service is down.
        for (const std::string& folder : folders)
            for (int i = 0; i < kFilesPerFolderAndRound; ++i)
            {
                const std::string name = "f" + std::to_string(kills) + "-" + std::to_string(i);
                WriteFile(scratch + "/.incoming", label);
                ASSERT_EQ(rename((scratch + "/.incoming").c_str(),
                                 (folder + "/" + name + ".eps").c_str()),
                          0);
                dropped.insert(folder + "/" + name);
            }
        {
            BackgroundHost host({"serve", "--settle", "100"}, scratch);
            ASSERT_TRUE(host.Started());
            // Mostly timed from the start of serving, so a slow start
            // (sanitizers) does not swallow the kills, half of those from the
            // moment a job is in hand, so that this machine's speed does not
            // decide what is hit; sometimes from the spawn, to catch the
            // replay of the work folders too.
            const bool fromSpawn = random() % 4 == 0, inHand = random() % 2 == 0;
            for (int waited = 0; !fromSpawn && waited < 10000 &&
                                 host.Err().find("serving " + folders[1]) == std::string::npos;
                 ++waited)
                std::this_thread::sleep_for(std::chrono::milliseconds(1));
            for (int waited = 0;
                 !fromSpawn && inHand && waited < 8000 && AllEntries(Work(folders[0])).empty() &&
                 AllEntries(Work(folders[1])).empty();
                 ++waited)
                std::this_thread::sleep_for(std::chrono::microseconds(250));
            const int delay = delayMs(random);
            if (!fromSpawn && inHand)
                std::this_thread::sleep_for(std::chrono::microseconds(delay * 40));
            else
                std::this_thread::sleep_for(std::chrono::milliseconds(delay * (fromSpawn ? 3 : 1)));
            // The destructor kills it with SIGKILL.
        }
        for (const std::string& folder : folders)
            interrupted += !AllEntries(Work(folder)).empty();
    }
    // A last service runs until everything is through.
    {
        BackgroundHost host({"serve", "--settle", "100"}, scratch);
        ASSERT_TRUE(WaitFor(
            [&]
            {
                for (const std::string& folder : folders)
                    if (!ListDirectory(Work(folder)).empty() ||
                        ListDirectory(folder).size() != 2) // the container and Output
                        return false;
                // and every output of the printing folder is at the scheduler
                return Count(Host({"status", "--json"}).out, "\"printing\": 0,") == 2;
            },
            60000))
            << host.Err() << Host({"status", "--json"}).out
            << ::testing::PrintToString(AllEntries(Work(folders[0])))
            << ::testing::PrintToString(AllEntries(Work(folders[1])))
            << ::testing::PrintToString(AllEntries(folders[0]))
            << ::testing::PrintToString(AllEntries(folders[1]));
        EXPECT_EQ(Host({"stop"}).exitCode, 0);
        EXPECT_EQ(host.Wait(10000), 0) << host.Err();
    }
    const double seconds =
        std::chrono::duration<double>(std::chrono::steady_clock::now() - started).count();
    std::printf("%d kills (%d with a job in hand), %zu files in %.1f s\n", kills, interrupted,
                dropped.size(), seconds);
    EXPECT_GE(interrupted, kKills / 10) << "the kills missed the jobs";

    for (const std::string& folder : folders)
    {
        std::set<std::string> expectedKept, expectedOutput;
        for (const std::string& path : dropped)
            if (path.compare(0, folder.size() + 1, folder + "/") == 0)
            {
                const std::string name = path.substr(folder.size() + 1);
                expectedKept.insert(name + ".eps");
                expectedOutput.insert(name + ".ps");
                expectedOutput.insert(name + ".ps.Folder.cfg");
            }
        const std::vector<std::string> outputs = AllEntries(folder + "/Output");
        // Same sets: nothing lost, no "(2)" copies, no staged leftovers.
        EXPECT_EQ(ListDirectory(Kept(folder)),
                  std::vector<std::string>(expectedKept.begin(), expectedKept.end()));
        EXPECT_EQ(outputs, std::vector<std::string>(expectedOutput.begin(), expectedOutput.end()));
        for (const std::string& name : outputs)
            EXPECT_TRUE(!EndsWith(name, ".ps") ||
                        EndsWith(ReadFile(folder + "/Output/" + name), kTrailer))
                << name;
        EXPECT_EQ(AllEntries(Work(folder)), std::vector<std::string>()) << folder;
        EXPECT_EQ(ListDirectory(Failed(folder)), std::vector<std::string>()) << folder;
    }
    if (!cups)
        return;
    // Each original of the printing folder is one completed job, by name;
    // none is left waiting at the scheduler.
    std::map<std::string, std::vector<printing::JobState>> jobs;
    printing::CupsError error;
    std::map<std::string, int> completed;
    int open = 0;
    ASSERT_TRUE(WaitFor(
        [&]
        {
            std::this_thread::sleep_for(std::chrono::milliseconds(200));
            completed.clear();
            open = 0;
            if (!printing::ListMarkedJobs("press", jobs, error))
                return false;
            for (const auto& marked : jobs)
                for (const printing::JobState& job : marked.second)
                {
                    completed[job.name] += job.end == printing::JobEnd::Completed;
                    open += job.end == printing::JobEnd::Open;
                }
            return open == 0;
        },
        60000))
        << error.reason << open;
    size_t printed = 0;
    for (const std::string& path : dropped)
        if (path.compare(0, folders[0].size() + 1, folders[0] + "/") == 0)
        {
            ++printed;
            const std::string name = path.substr(folders[0].size() + 1) + ".eps";
            EXPECT_EQ(completed[name], 1) << name;
        }
    EXPECT_EQ(completed.size(), printed);
    unsetenv("CUPS_SERVER");
}
