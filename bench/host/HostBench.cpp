// bench_host [files] [runs]: makes a hot folder with `files` small EPS files
// (default 1000), runs `hotfolder run --stats` on it `runs` times (default 3,
// a fresh folder each time) and prints jobs per second and the share of the
// time spent outside the filter's Process (target: under a third).
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <sstream>
#include <string>
#include <vector>

#include "TestKit.h"

namespace
{
const std::string kHost = HF_HOTFOLDER_EXE;

// Runs the host with an argument vector; its standard output goes to outFile.
int RunHost(const std::vector<std::string>& args, const std::string& outFile)
{
    std::vector<std::string> all = {kHost};
    all.insert(all.end(), args.begin(), args.end());
    return testkit::WaitProgram(testkit::StartProgram(all, outFile, ""));
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

bool OneRun(const testkit::ScratchDir& scratch, int files, Figures& figures)
{
    const std::string folder = scratch.File("hot");
    const std::string log = scratch.File("out.txt");
    if (RunHost({"init", folder, "--server", HF_EXAMPLE_SERVER}, log) != 0 ||
        RunHost({"settings", folder, "--set", "OUTPUTFILETYPEEPS=0", "OUTPUTFILETYPEPS=1",
                 "DEFAULTPAGESIZE=Letter"},
                log) != 0)
        return false;
    for (int i = 0; i < files; ++i)
    {
        char name[64];
        std::snprintf(name, sizeof(name), "/job%05d.eps", i);
        testkit::WriteFile(folder + name, SmallEps(i));
    }
    auto started = std::chrono::steady_clock::now();
    int status = RunHost({"run", folder, "--stats"}, log);
    figures.wall =
        std::chrono::duration<double>(std::chrono::steady_clock::now() - started).count();
    std::istringstream in(testkit::ReadFile(log));
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
        const testkit::ScratchDir scratch("hf-bench-host");
        if (scratch.Path().empty())
            return 1;
        setenv("HOTFOLDER_WAREHOUSE_ROOT", scratch.File("machine").c_str(), 1);
        Figures figures;
        if (!OneRun(scratch, files, figures))
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
    std::printf("median: %.1f jobs/s, %.1f%% of the time outside Process\n",
                median.jobs / median.total, median.share);
    std::printf("ratio outside_process %.3f (target < 0.333)\n", median.share / 100);
    return 0;
}
