// bench_host [files] [runs]: makes a hot folder with `files` small EPS files
// (default 1000), runs `hotfolder run --stats` on it `runs` times (default 3,
// a fresh folder each time) and prints jobs per second and the share of the
// time spent outside the filter's Process (target: under a third).
#include <fcntl.h>
#include <spawn.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "posix/Directories.h"

extern char** environ;

namespace
{
const std::string kHost = HF_HOTFOLDER_EXE;

// Runs the host with an argument vector; its standard output goes to outFile.
int RunHost(const std::vector<std::string>& args, const std::string& outFile)
{
    std::vector<std::string> all = {kHost};
    all.insert(all.end(), args.begin(), args.end());
    std::vector<char*> argv;
    for (std::string& arg : all)
        argv.push_back(arg.data());
    argv.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, 1, outFile.c_str(), O_WRONLY | O_CREAT | O_TRUNC,
                                     0644);
    pid_t pid = 0;
    int spawned = posix_spawn(&pid, argv[0], &actions, nullptr, argv.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    if (spawned != 0)
        return -1;
    int status = 0;
    waitpid(pid, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

std::string SmallEps(int index)
{
    std::ostringstream eps;
    eps << "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 144 72\n%%Title: bench " << index
        << "\n%%EndComments\n0.5 setgray 0 0 144 72 rectfill\n0 setgray 10 10 moveto "
           "/Helvetica findfont 12 scalefont setfont (job "
        << index << ") show\n%%EOF\n";
    return eps.str();
}

struct Figures
{
    double total = 0, sniff = 0, inside = 0, outside = 0, share = 0, wall = 0;
    size_t jobs = 0;
};

bool OneRun(const std::string& scratch, int files, Figures& figures)
{
    const std::string folder = scratch + "/hot";
    const std::string log = scratch + "/out.txt";
    if (RunHost({"init", folder, "--server", HF_EXAMPLE_SERVER}, log) != 0 ||
        RunHost({"settings", folder, "--set", "OUTPUTFILETYPEEPS=0", "OUTPUTFILETYPEPS=1",
                 "DEFAULTPAGESIZE=Letter"},
                log) != 0)
        return false;
    for (int i = 0; i < files; ++i)
    {
        char name[64];
        std::snprintf(name, sizeof(name), "/job%05d.eps", i);
        std::ofstream(folder + name) << SmallEps(i);
    }
    auto started = std::chrono::steady_clock::now();
    int status = RunHost({"run", folder, "--stats"}, log);
    figures.wall =
        std::chrono::duration<double>(std::chrono::steady_clock::now() - started).count();
    std::ifstream in(log);
    std::string line;
    bool timed = false;
    while (std::getline(in, line))
    {
        if (std::sscanf(line.c_str(),
                        "Timing: total %lf s, sniffing %lf s, inside Process %lf s, outside "
                        "Process %lf s (%lf%%",
                        &figures.total, &figures.sniff, &figures.inside, &figures.outside,
                        &figures.share) == 5)
            timed = true;
        std::sscanf(line.c_str(), "Throughput: %zu jobs", &figures.jobs);
    }
    return status == 0 && timed && figures.jobs == static_cast<size_t>(files);
}
} // namespace

int main(int argc, char** argv)
{
    const int files = argc > 1 ? std::atoi(argv[1]) : 1000;
    const int runs = argc > 2 ? std::atoi(argv[2]) : 3;
    std::vector<Figures> results;
    for (int run = 0; run < runs; ++run)
    {
        char pattern[] = "/tmp/hf-bench-host-XXXXXX";
        if (!mkdtemp(pattern))
            return 1;
        const std::string scratch = pattern;
        setenv("HOTFOLDER_WAREHOUSE_ROOT", (scratch + "/machine").c_str(), 1);
        Figures figures;
        bool ok = OneRun(scratch, files, figures);
        posix::RemoveTree(scratch);
        if (!ok)
        {
            std::fprintf(stderr, "bench_host: run %d failed (see hotfolder's output)\n", run + 1);
            return 1;
        }
        std::printf("run %d: %zu jobs in %.3f s (wall %.3f s): %.1f jobs/s; inside Process "
                    "%.3f s, outside %.3f s = %.1f%%\n",
                    run + 1, figures.jobs, figures.total, figures.wall,
                    figures.jobs / figures.total, figures.inside, figures.outside, figures.share);
        results.push_back(figures);
    }
    std::sort(results.begin(), results.end(),
              [](const Figures& a, const Figures& b) { return a.total < b.total; });
    const Figures& median = results[results.size() / 2];
    std::printf("median: %.1f jobs/s, %.1f%% of the time outside Process (target < 33.3%%): %s\n",
                median.jobs / median.total, median.share,
                median.share < 100.0 / 3 ? "met" : "NOT met");
    return 0;
}
