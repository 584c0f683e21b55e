// bench_service [latency-files] [burst-files-per-folder] [preflight-files]
// (defaults 1000, 1000 and 20): hotfolder serve on scratch folders.
//  1. Latency: files dropped one at a time into one folder, written in place
//     (open, write, close, as cp does) and renamed in; the time from the
//     drop to the output's appearance (its rename into the output folder),
//     p50 and p99.
//  2. Burst: 8 folders x N files renamed in at once; jobs per second and the
//     service's own share of its busy time spent outside Process.
//  3. The service's resident memory before and after two bursts.
//  4. Printing: a folder bound to a raw file-device queue of a scheduler of
//     its own. Latency from the drop to the job created at the scheduler
//     with its document sent (the service's "queued" line), p50 and p99;
//     then a burst, in jobs per second from the drop to "completed".
//  5. Preflight: two folders of one service, one with the preflight on;
//     files dropped one at a time into each in turn, the median time from
//     the drop to the output's appearance of each, side by side.
#include <poll.h>
#include <signal.h>
#include <sys/inotify.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include "CupsJobs.h"
#include "PrivateCupsd.h"
#include "TestKit.h"

namespace
{
using Clock = std::chrono::steady_clock;

long ResidentKilobytes(pid_t pid)
{
    std::string status = testkit::ReadFile("/proc/" + std::to_string(pid) + "/status");
    size_t at = status.find("VmRSS:");
    return at == std::string::npos ? -1 : std::atol(status.c_str() + at + 6);
}

// Waits for the output name to be renamed into the watched output folder.
bool AwaitOutput(int inotify, const std::string& name, int timeoutMs)
{
    alignas(struct inotify_event) char buffer[1 << 14];
    const auto deadline = Clock::now() + std::chrono::milliseconds(timeoutMs);
    while (Clock::now() < deadline)
    {
        struct pollfd fd = {inotify, POLLIN, 0};
        if (poll(&fd, 1, 100) <= 0)
            continue;
        ssize_t got = read(inotify, buffer, sizeof(buffer));
        for (char* at = buffer; got > 0 && at < buffer + got;)
        {
            auto* event = reinterpret_cast<struct inotify_event*>(at);
            at += sizeof(struct inotify_event) + event->len;
            if (event->len && name == event->name)
                return true;
        }
    }
    return false;
}

double Percentile(std::vector<double> values, double fraction)
{
    std::sort(values.begin(), values.end());
    return values[std::min(values.size() - 1, static_cast<size_t>(fraction * values.size()))];
}
} // namespace

int BenchPrinting(const testkit::ScratchDir& scratch, const std::string& host,
                  const std::string& eps, int latencyFiles, int burstFiles);
int BenchPreflight(const testkit::ScratchDir& scratch, const std::string& host,
                   const std::string& eps, int files);

int main(int argc, char** argv)
{
    const int latencyFiles = argc > 1 ? std::atoi(argv[1]) : 1000;
    const int burstFiles = argc > 2 ? std::atoi(argv[2]) : 1000;
    const int preflightFiles = argc > 3 ? std::atoi(argv[3]) : 20;
    const int kBurstFolders = 8;
    const testkit::ScratchDir scratch("hf-bench-service");
    if (scratch.Path().empty())
        return 1;
    setenv("HOTFOLDER_WAREHOUSE_ROOT", scratch.File("machine").c_str(), 1);
    const std::string host = HF_HOTFOLDER_EXE;
    const std::string eps = testkit::ReadFile(HF_EXAMPLE_EPS);

    std::vector<std::string> folders;
    for (int i = 0; i <= kBurstFolders; ++i)
    {
        folders.push_back(scratch.File(i == 0 ? "latency" : "burst" + std::to_string(i)));
        const testkit::ProcessResult made =
            testkit::RunProgram({host, "init", folders.back(), "--server", HF_EXAMPLE_SERVER});
        if (made.exitCode != 0 ||
            testkit::RunProgram({host, "settings", folders.back(), "--set", "OUTPUTFILETYPEEPS=0",
                                 "OUTPUTFILETYPEPS=1", "DEFAULTPAGESIZE=A4"})
                    .exitCode != 0)
        {
            std::fprintf(stderr, "bench_service: cannot make the hot folders\n%s",
                         made.err.c_str());
            return 1;
        }
    }
    const std::string log = scratch.File("serve-err.txt");
    const std::string statsOut = scratch.File("serve-out.txt");
    testkit::BackgroundProgram service;
    service.pid = testkit::StartProgram({host, "serve", "--stats"}, statsOut, log);
    const auto waitServing = [&]
    {
        return testkit::WaitFor(
            [&]
            {
                const std::string text = testkit::ReadFile(log);
                size_t count = 0;
                for (size_t at = text.find("serving "); at != std::string::npos;
                     at = text.find("serving ", at + 1))
                    ++count;
                return count >= folders.size();
            },
            10000);
    };
    if (!waitServing())
    {
        std::fprintf(stderr, "bench_service: the service did not start\n%s",
                     testkit::ReadFile(log).c_str());
        return 1;
    }

    // 1. Latency.
    const std::string latency = folders[0];
    int inotify = inotify_init1(IN_CLOEXEC);
    inotify_add_watch(inotify, (latency + "/Output").c_str(), IN_MOVED_TO);
    for (const char* way : {"cp", "rename"})
    {
        std::vector<double> millis;
        for (int i = 0; i < latencyFiles; ++i)
        {
            const std::string name = std::string(way) + std::to_string(i);
            const std::string target = latency + "/" + name + ".eps";
            Clock::time_point dropped;
            if (std::strcmp(way, "cp") == 0)
            {
                testkit::WriteFile(target, eps);
                dropped = Clock::now();
            }
            else
            {
                testkit::WriteFile(scratch.File("staging.eps"), eps);
                rename(scratch.File("staging.eps").c_str(), target.c_str());
                dropped = Clock::now();
            }
            if (!AwaitOutput(inotify, name + ".ps", 10000))
            {
                std::fprintf(stderr, "bench_service: no output for %s\n", target.c_str());
                return 1;
            }
            millis.push_back(
                std::chrono::duration<double, std::milli>(Clock::now() - dropped).count());
        }
        const double p50 = Percentile(millis, 0.50), p99 = Percentile(millis, 0.99);
        const bool met = p50 <= 20 && p99 <= 100;
        std::printf("latency by %s over %d files: p50 %.2f ms, p99 %.2f ms, max %.2f ms "
                    "(wanted: p50 <= 20 ms, p99 <= 100 ms): %s\n",
                    way, latencyFiles, p50, p99, Percentile(millis, 1.0), met ? "met" : "MISSED");
        std::printf("ratio p50_%s_per_20ms %.3f (target <= 1)\n", way, p50 / 20);
        std::printf("ratio p99_%s_per_100ms %.3f (target <= 1)\n", way, p99 / 100);
    }
    close(inotify);

    // The bursts get a service of their own, so its figures are theirs alone.
    testkit::RunProgram({host, "stop"});
    testkit::WaitProgram(service.pid);
    service.pid = testkit::StartProgram({host, "serve", "--stats"}, statsOut, log);
    if (!waitServing())
    {
        std::fprintf(stderr, "bench_service: the service did not start again\n");
        return 1;
    }

    // 2. and 3. Two bursts, memory before and after each.
    const long before = ResidentKilobytes(service.pid);
    std::vector<long> after;
    double firstBurstJobsPerSecond = 0;
    for (int burst = 1; burst <= 2; ++burst)
    {
        // Staged beside the folders, then renamed in as fast as possible.
        for (int f = 1; f <= kBurstFolders; ++f)
            for (int i = 0; i < burstFiles; ++i)
                testkit::WriteFile(scratch.File("s" + std::to_string(f) + "-" + std::to_string(i)),
                                   eps);
        const auto started = Clock::now();
        for (int i = 0; i < burstFiles; ++i)
            for (int f = 1; f <= kBurstFolders; ++f)
                rename(
                    scratch.File("s" + std::to_string(f) + "-" + std::to_string(i)).c_str(),
                    (folders[f] + "/b" + std::to_string(burst) + "-" + std::to_string(i) + ".eps")
                        .c_str());
        const bool done = testkit::WaitFor(
            [&]
            {
                for (int f = 1; f <= kBurstFolders; ++f)
                    if (testkit::ListDirectory(folders[f] + "/Output").size() !=
                        size_t(2 * burstFiles * burst))
                        return false;
                return true;
            },
            10 * 60 * 1000);
        const double seconds = std::chrono::duration<double>(Clock::now() - started).count();
        if (!done)
        {
            std::fprintf(stderr, "bench_service: burst %d did not finish\n", burst);
            return 1;
        }
        const double rate = kBurstFolders * burstFiles / seconds;
        if (burst == 1)
            firstBurstJobsPerSecond = rate;
        after.push_back(ResidentKilobytes(service.pid));
        std::printf("burst %d: %d folders x %d files in %.2f s: %.1f jobs/s\n", burst,
                    kBurstFolders, burstFiles, seconds, rate);
    }
    std::printf("memory (VmRSS): %.1f MB before, %.1f MB after burst 1, %.1f MB after burst 2; "
                "growth over burst 2: %.1f bytes per job\n",
                before / 1024.0, after[0] / 1024.0, after[1] / 1024.0,
                (after[1] - after[0]) * 1024.0 / (kBurstFolders * burstFiles));
    // The second burst finds every pool the first one grew: it may not grow
    // by a kilobyte a job (a page or two the allocator keeps is no leak).
    std::printf("ratio rss_growth_per_job/1kb %.3f (target < 1)\n",
                (after[1] - after[0]) / double(kBurstFolders * burstFiles));

    testkit::RunProgram({host, "stop"});
    testkit::WaitProgram(service.pid);
    service.pid = -1;
    const std::string stats = testkit::ReadFile(statsOut);
    std::printf("%s", stats.c_str());
    const size_t share = stats.find("share outside ");
    if (share != std::string::npos)
        std::printf("ratio outside_process %.3f (target < 0.333)\n",
                    std::atof(stats.c_str() + share + 14));
    std::printf("burst jobs per second (first burst): %.1f\n", firstBurstJobsPerSecond);
    if (BenchPreflight(scratch, host, eps, preflightFiles) != 0)
        return 1;
    return BenchPrinting(scratch, host, eps, latencyFiles / 5 + 1, burstFiles / 2 + 1);
}

// 5. The preflight's cost per job: a folder with it on beside one without,
// in a warehouse of their own, so that the service serves these two only.
int BenchPreflight(const testkit::ScratchDir& scratch, const std::string& host,
                   const std::string& eps, int files)
{
    if (!testkit::ProgramAvailable("gs"))
    {
        std::printf("preflight: skipped (Ghostscript is not installed)\n");
        return 0;
    }
    const std::string warehouse = std::getenv("HOTFOLDER_WAREHOUSE_ROOT");
    setenv("HOTFOLDER_WAREHOUSE_ROOT", scratch.File("machine-preflight").c_str(), 1);
    const std::string folders[] = {scratch.File("unchecked"), scratch.File("checked")};
    for (const std::string& folder : folders)
    {
        testkit::RunProgram({host, "init", folder, "--server", HF_EXAMPLE_SERVER});
        testkit::RunProgram({host, "settings", folder, "--set", "OUTPUTFILETYPEEPS=0",
                             "OUTPUTFILETYPEPS=1", "DEFAULTPAGESIZE=A4"});
    }
    testkit::RunProgram({host, "settings", folders[1], "--preflight", "on"});
    const std::string log = scratch.File("preflight-err.txt");
    testkit::BackgroundProgram service;
    service.pid = testkit::StartProgram({host, "serve"}, "", log);
    const bool serving = testkit::WaitFor(
        [&]
        {
            const std::string text = testkit::ReadFile(log);
            return text.find("serving " + folders[0]) != std::string::npos &&
                   text.find("serving " + folders[1]) != std::string::npos;
        },
        10000);
    int inotify = inotify_init1(IN_CLOEXEC);
    for (const std::string& folder : folders) // made by the service
        inotify_add_watch(inotify, (folder + "/Output").c_str(), IN_MOVED_TO);
    std::vector<double> millis[2];
    for (int i = 0; serving && i < files; ++i)
        for (int f = 0; f < 2; ++f) // in turns, so that load weighs on both alike
        {
            const std::string name = "p" + std::to_string(i);
            testkit::WriteFile(scratch.File("staging.eps"), eps);
            rename(scratch.File("staging.eps").c_str(), (folders[f] + "/" + name + ".eps").c_str());
            const auto dropped = Clock::now();
            if (!AwaitOutput(inotify, name + ".ps", 120000))
            {
                std::fprintf(stderr, "bench_service: no output for %s in %s\n%s", name.c_str(),
                             folders[f].c_str(), testkit::ReadFile(log).c_str());
                close(inotify);
                return 1;
            }
            millis[f].push_back(
                std::chrono::duration<double, std::milli>(Clock::now() - dropped).count());
        }
    close(inotify);
    testkit::RunProgram({host, "stop"});
    testkit::WaitProgram(service.pid);
    service.pid = -1;
    setenv("HOTFOLDER_WAREHOUSE_ROOT", warehouse.c_str(), 1);
    if (!serving)
    {
        std::fprintf(stderr, "bench_service: the preflight service did not start\n");
        return 1;
    }
    const double off = Percentile(millis[0], 0.5), on = Percentile(millis[1], 0.5);
    std::printf("preflight, drop to output, median over %d files each: off %.2f ms, on %.2f ms, "
                "%.2f ms more per job (no target: it is the price of a Ghostscript run)\n",
                files, off, on, on - off);
    std::printf("ratio preflight_on_per_off %.3f\n", on / off);
    return 0;
}

// 4. Printing through a private scheduler.
int BenchPrinting(const testkit::ScratchDir& scratch, const std::string& host,
                  const std::string& eps, int latencyFiles, int burstFiles)
{
    if (!cups_test::PrivateCupsd::Installed())
    {
        std::printf("printing: skipped (%s)\n", cups_test::PrivateCupsd::kMissing);
        return 0;
    }
    chmod(scratch.Path().c_str(), 0755);
    mkdir(scratch.File("cups").c_str(), 0755);
    cups_test::PrivateCupsd cups(scratch.File("cups"));
    std::string problem;
    if (!cups.Start(problem) || !cups.AddFileQueue("press", "", "/dev/null", problem))
    {
        std::fprintf(stderr, "bench_service: no scheduler: %s\n", problem.c_str());
        return 1;
    }
    setenv("CUPS_SERVER", cups.Server().c_str(), 1);
    const std::string folder = scratch.File("printing");
    // A raw queue offers no papers to describe: the example server's, bound by hand.
    testkit::RunProgram({host, "init", folder, "--server", HF_EXAMPLE_SERVER});
    testkit::WriteFile(folder + "/[_Orv_HotFolder_]/PrinterQueue.txt", "press\n");
    testkit::RunProgram(
        {host, "settings", folder, "--set", "OUTPUTFILETYPEEPS=0", "OUTPUTFILETYPEPS=1"});
    const std::string log = scratch.File("print-err.txt");
    testkit::BackgroundProgram service;
    service.pid = testkit::StartProgram({host, "serve"}, "", log);
    if (!testkit::WaitFor(
            [&] { return testkit::ReadFile(log).find("<6>serving ") != std::string::npos; }, 10000))
        return 1;
    std::vector<double> millis;
    for (int i = 0; i < latencyFiles; ++i)
    {
        const std::string name = "p" + std::to_string(i) + ".eps";
        testkit::WriteFile(scratch.File("staging.eps"), eps);
        rename(scratch.File("staging.eps").c_str(), (folder + "/" + name).c_str());
        const auto dropped = Clock::now();
        if (!testkit::WaitFor(
                [&]
                { return testkit::ReadFile(log).find(name + ": queued on") != std::string::npos; },
                10000))
        {
            std::fprintf(stderr, "bench_service: %s was not queued\n%s", name.c_str(),
                         testkit::ReadFile(log).c_str());
            return 1;
        }
        millis.push_back(std::chrono::duration<double, std::milli>(Clock::now() - dropped).count());
    }
    const double p50 = Percentile(millis, 0.50), p99 = Percentile(millis, 0.99);
    std::printf("printing latency, drop to job at the scheduler, over %d files: p50 %.2f ms, "
                "p99 %.2f ms (wanted: p50 <= 50 ms): %s\n",
                latencyFiles, p50, p99, p50 <= 50 ? "met" : "MISSED");
    std::printf("ratio p50_print_per_50ms %.3f (target <= 1)\n", p50 / 50);

    for (int i = 0; i < burstFiles; ++i)
        testkit::WriteFile(scratch.File("q" + std::to_string(i)), eps);
    const auto started = Clock::now();
    for (int i = 0; i < burstFiles; ++i)
        rename(scratch.File("q" + std::to_string(i)).c_str(),
               (folder + "/q" + std::to_string(i) + ".eps").c_str());
    const size_t expected = size_t(latencyFiles + burstFiles);
    // Done when the service has seen every file printed and the scheduler
    // holds no job still to print. (The scheduler lists at most 500 jobs,
    // so its completed ones cannot be counted beyond that.)
    const std::string printedLine = ": printed on press";
    const bool printed = testkit::WaitFor(
        [&]
        {
            const std::string said = testkit::ReadFile(log);
            size_t seen = 0;
            for (size_t at = said.find(printedLine); at != std::string::npos;
                 at = said.find(printedLine, at + 1))
                ++seen;
            std::set<int> open;
            printing::CupsError error;
            const bool done =
                seen >= expected && printing::OpenJobIds("press", open, error) && open.empty();
            if (!done)
                std::this_thread::sleep_for(std::chrono::milliseconds(20));
            return done;
        },
        10 * 60 * 1000);
    const double seconds = std::chrono::duration<double>(Clock::now() - started).count();
    testkit::RunProgram({host, "stop"});
    testkit::WaitProgram(service.pid);
    service.pid = -1;
    if (!printed)
    {
        std::fprintf(stderr, "bench_service: the printing burst did not finish\n");
        return 1;
    }
    std::printf("printing burst: %d files from drop to completed at the scheduler in %.2f s: "
                "%.1f jobs/s\n",
                burstFiles, seconds, burstFiles / seconds);
    return 0; // a missed target is a figure to read, not a failed run
}
