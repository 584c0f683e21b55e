// bench_service [latency-files] [burst-files-per-folder]
// (defaults 1000 and 1000): hotfolder serve on scratch folders.
//  1. Latency: files dropped one at a time into one folder, written in place
//     (open, write, close, as cp does) and renamed in; the time from the
//     drop to the output's appearance (its rename into the output folder),
//     p50 and p99.
//  2. Burst: 8 folders x N files renamed in at once; jobs per second and the
//     service's own share of its busy time spent outside Process.
//  3. The service's resident memory before and after two bursts.
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <dirent.h>
#include <fcntl.h>
#include <fstream>
#include <ftw.h>
#include <poll.h>
#include <signal.h>
#include <spawn.h>
#include <string>
#include <sys/inotify.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

extern char** environ;

namespace
{
using Clock = std::chrono::steady_clock;

std::string ReadFile(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(in), {});
}

pid_t Spawn(std::vector<std::string> args, const std::string& out, const std::string& err)
{
    std::vector<char*> argv;
    for (std::string& arg : args)
        argv.push_back(arg.data());
    argv.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, 1, out.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0644);
    posix_spawn_file_actions_addopen(&actions, 2, err.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0644);
    pid_t pid = -1;
    if (posix_spawn(&pid, argv[0], &actions, nullptr, argv.data(), environ) != 0)
        pid = -1;
    posix_spawn_file_actions_destroy(&actions);
    return pid;
}

int Run(const std::vector<std::string>& args, const std::string& scratch)
{
    pid_t pid = Spawn(args, scratch + "/cmd-out.txt", scratch + "/cmd-err.txt");
    int status = 0;
    waitpid(pid, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

void WriteWhole(const std::string& path, const std::string& bytes)
{
    int fd = open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0644);
    if (fd < 0 || write(fd, bytes.data(), bytes.size()) != static_cast<ssize_t>(bytes.size()))
        std::perror(path.c_str());
    close(fd);
}

size_t Entries(const std::string& directory)
{
    size_t count = 0;
    if (DIR* dir = opendir(directory.c_str()))
    {
        while (dirent* entry = readdir(dir))
            count += entry->d_name[0] != '.';
        closedir(dir);
    }
    return count;
}

long ResidentKilobytes(pid_t pid)
{
    std::string status = ReadFile("/proc/" + std::to_string(pid) + "/status");
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

int RemoveEntry(const char* path, const struct stat*, int type, struct FTW*)
{
    return type == FTW_DP ? rmdir(path) : unlink(path);
}
} // namespace

int main(int argc, char** argv)
{
    const int latencyFiles = argc > 1 ? std::atoi(argv[1]) : 1000;
    const int burstFiles = argc > 2 ? std::atoi(argv[2]) : 1000;
    const int kBurstFolders = 8;
    char pattern[] = "/tmp/hf-bench-service-XXXXXX";
    if (!mkdtemp(pattern))
        return 1;
    const std::string scratch = pattern;
    setenv("HOTFOLDER_WAREHOUSE_ROOT", (scratch + "/machine").c_str(), 1);
    const std::string host = HF_HOTFOLDER_EXE;
    const std::string eps = ReadFile(HF_EXAMPLE_EPS);

    std::vector<std::string> folders;
    for (int i = 0; i <= kBurstFolders; ++i)
    {
        folders.push_back(scratch +
                          (i == 0 ? std::string("/latency") : "/burst" + std::to_string(i)));
        if (Run({host, "init", folders.back(), "--server", HF_EXAMPLE_SERVER}, scratch) != 0 ||
            Run({host, "settings", folders.back(), "--set", "OUTPUTFILETYPEEPS=0",
                 "OUTPUTFILETYPEPS=1", "DEFAULTPAGESIZE=A4"},
                scratch) != 0)
        {
            std::fprintf(stderr, "bench_service: cannot make the hot folders\n");
            return 1;
        }
    }
    const std::string log = scratch + "/serve-err.txt";
    pid_t service = Spawn({host, "serve", "--stats"}, scratch + "/serve-out.txt", log);
    const auto waitServing = [&]
    {
        for (int i = 0; i < 200; ++i)
        {
            std::string text = ReadFile(log);
            size_t count = 0;
            for (size_t at = text.find("serving "); at != std::string::npos;
                 at = text.find("serving ", at + 1))
                ++count;
            if (count >= folders.size())
                return true;
            usleep(50000);
        }
        return false;
    };
    if (!waitServing())
    {
        std::fprintf(stderr, "bench_service: the service did not start\n%s", ReadFile(log).c_str());
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
                WriteWhole(target, eps);
                dropped = Clock::now();
            }
            else
            {
                WriteWhole(scratch + "/staging.eps", eps);
                rename((scratch + "/staging.eps").c_str(), target.c_str());
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
                    "(target p50 <= 20 ms, p99 <= 100 ms): %s\n",
                    way, latencyFiles, p50, p99, Percentile(millis, 1.0), met ? "met" : "MISSED");
        std::printf("ratio p50_%s_per_20ms %.3f (target <= 1)\n", way, p50 / 20);
        std::printf("ratio p99_%s_per_100ms %.3f (target <= 1)\n", way, p99 / 100);
    }
    close(inotify);

    // The bursts get a service of their own, so its figures are theirs alone.
    Run({host, "stop"}, scratch);
    waitpid(service, nullptr, 0);
    service = Spawn({host, "serve", "--stats"}, scratch + "/serve-out.txt", log);
    if (!waitServing())
    {
        std::fprintf(stderr, "bench_service: the service did not start again\n");
        return 1;
    }

    // 2. and 3. Two bursts, memory before and after each.
    const long before = ResidentKilobytes(service);
    std::vector<long> after;
    double firstBurstJobsPerSecond = 0;
    for (int burst = 1; burst <= 2; ++burst)
    {
        // Staged beside the folders, then renamed in as fast as possible.
        for (int f = 1; f <= kBurstFolders; ++f)
            for (int i = 0; i < burstFiles; ++i)
                WriteWhole(scratch + "/s" + std::to_string(f) + "-" + std::to_string(i), eps);
        const auto started = Clock::now();
        for (int i = 0; i < burstFiles; ++i)
            for (int f = 1; f <= kBurstFolders; ++f)
                rename(
                    (scratch + "/s" + std::to_string(f) + "-" + std::to_string(i)).c_str(),
                    (folders[f] + "/b" + std::to_string(burst) + "-" + std::to_string(i) + ".eps")
                        .c_str());
        bool done = false;
        while (!done && Clock::now() - started < std::chrono::minutes(10))
        {
            done = true;
            for (int f = 1; f <= kBurstFolders && done; ++f)
                done = Entries(folders[f] + "/Output") == size_t(2 * burstFiles * burst);
            if (!done)
                usleep(20000);
        }
        const double seconds = std::chrono::duration<double>(Clock::now() - started).count();
        if (!done)
        {
            std::fprintf(stderr, "bench_service: burst %d did not finish\n", burst);
            return 1;
        }
        const double rate = kBurstFolders * burstFiles / seconds;
        if (burst == 1)
            firstBurstJobsPerSecond = rate;
        after.push_back(ResidentKilobytes(service));
        std::printf("burst %d: %d folders x %d files in %.2f s: %.1f jobs/s\n", burst,
                    kBurstFolders, burstFiles, seconds, rate);
    }
    std::printf("memory (VmRSS): %.1f MB before, %.1f MB after burst 1, %.1f MB after burst 2; "
                "growth over burst 2: %.1f bytes per job (target: no growth per job)\n",
                before / 1024.0, after[0] / 1024.0, after[1] / 1024.0,
                (after[1] - after[0]) * 1024.0 / (kBurstFolders * burstFiles));

    Run({host, "stop"}, scratch);
    int status = 0;
    waitpid(service, &status, 0);
    const std::string stats = ReadFile(scratch + "/serve-out.txt");
    std::printf("%s", stats.c_str());
    const size_t share = stats.find("share outside ");
    if (share != std::string::npos)
        std::printf("ratio outside_process %.3f (target < 0.333)\n",
                    std::atof(stats.c_str() + share + 14));
    std::printf("burst jobs per second (first burst): %.1f\n", firstBurstJobsPerSecond);
    nftw(scratch.c_str(), RemoveEntry, 16, FTW_DEPTH | FTW_PHYS);
    return 0; // a missed target is a figure to read, not a failed run
}
