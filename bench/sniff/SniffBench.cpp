// Sniffing a folder of many EPS files through the filter, against the least
// any sniffer must do: list the folder, open every file and read its first
// 64 KB. Optionally the reference host's whole run over a smaller folder,
// against copying the same files.
//
// usage: bench_sniff [files] [bytes-per-file] [runs] [host-files]
//        defaults 10000, 8192, 5, 500 (host-files 0 skips the host run)
#include <dirent.h>
#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include <wx/init.h>
#include <wx/log.h>

#include "EPS.h"
#include "TestKit.h"

namespace
{
constexpr size_t kFloorRead = 64 * 1024;

double Seconds(const std::function<void()>& work)
{
    const auto start = std::chrono::steady_clock::now();
    work();
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

double Median(std::vector<double> times)
{
    std::sort(times.begin(), times.end());
    return times[times.size() / 2];
}

// Writes count EPS files named "<n>.eps" of about bytesEach bytes into
// folder: a header with a bounding box, then drawing lines.
bool WriteEpsFiles(const std::string& folder, int count, long bytesEach)
{
    std::string content = "%!PS-Adobe-3.0 EPSF-3.0\n"
                          "%%BoundingBox: 0 0 612 792\n"
                          "%%Title: benchmark sample\n"
                          "%%EndComments\n";
    while (static_cast<long>(content.size()) < bytesEach)
        content += "0 0 moveto 612 792 lineto stroke % a line of drawing\n";
    content += "%%EOF\n";
    for (int i = 0; i < count; ++i)
        if (!testkit::WriteFile(folder + "/" + std::to_string(i) + ".eps", content))
            return false;
    return true;
}

// The number after marker on the first line holding it, or -1.
double NumberAfter(const std::string& text, const std::string& marker)
{
    const size_t at = text.find(marker);
    return at == std::string::npos ? -1 : std::atof(text.c_str() + at + marker.size());
}

// The listing the floors below take as part of their work, kept as it is
// so that the figures stay comparable.
std::vector<std::string> ListFiles(const std::string& folder)
{
    std::vector<std::string> files;
    if (DIR* dir = opendir(folder.c_str()))
    {
        while (const dirent* entry = readdir(dir))
            if (entry->d_type == DT_REG)
                files.push_back(folder + "/" + entry->d_name);
        closedir(dir);
    }
    return files;
}

// The floor: list, open, read up to 64 KB, close. Returns the files read.
size_t ReadHeads(const std::string& folder, std::vector<char>& buffer)
{
    size_t count = 0;
    for (const std::string& path : ListFiles(folder))
    {
        const int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
        if (fd < 0)
            continue;
        if (read(fd, buffer.data(), kFloorRead) >= 0)
            ++count;
        close(fd);
    }
    return count;
}

// The host run's floor: read every file whole and write a copy.
void CopyAll(const std::string& from, const std::string& to, std::vector<char>& buffer)
{
    for (const std::string& path : ListFiles(from))
    {
        const int in = open(path.c_str(), O_RDONLY | O_CLOEXEC);
        const std::string target = to + path.substr(path.rfind('/'));
        const int out = open(target.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
        ssize_t got = 0;
        while (in >= 0 && out >= 0 && (got = read(in, buffer.data(), buffer.size())) > 0)
            if (write(out, buffer.data(), static_cast<size_t>(got)) != got)
                break;
        if (in >= 0)
            close(in);
        if (out >= 0)
            close(out);
    }
}

int Argument(int argc, char** argv, int index, int fallback)
{
    return argc > index ? std::atoi(argv[index]) : fallback;
}

struct HostRunResult
{
    bool ran = false;
    double wallSeconds = 0;
    double sniffSeconds = 0; // the host's "sniffing" figure
    double jobsPerSecond = 0;
};

// Makes folder a hot folder in a private warehouse, fills it with count EPS
// files and runs "hotfolder run --stats" over it, timed from outside. ran is
// false when the host or the module is not built or a step fails.
HostRunResult RunHost(const std::string& folder, int count, long bytesEach)
{
    const std::string host = std::string(HF_BUILD_DIR) + "/bin/hotfolder";
    const std::string server = std::string(HF_SOURCE_DIR) + "/examples/server-description.xml";
    HostRunResult result;
    if (access(host.c_str(), X_OK) != 0)
        return result;
    const testkit::ScratchDir warehouse("hf-bench-warehouse");
    setenv("HOTFOLDER_WAREHOUSE_ROOT", warehouse.Path().c_str(), 1);
    const std::string log = warehouse.File("host.out");
    const auto run = [&](const std::vector<std::string>& args)
    { return testkit::WaitProgram(testkit::StartProgram(args, log, "")); };

    if (run({host, "init", folder, "--server", server}) != 0 ||
        !WriteEpsFiles(folder, count, bytesEach))
        return result;
    const auto start = std::chrono::steady_clock::now();
    const int status = run({host, "run", folder, "--stats", "--out", warehouse.File("out")});
    result.wallSeconds =
        std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();

    const std::string text = testkit::ReadFile(log);
    result.sniffSeconds = NumberAfter(text, "sniffing ");
    result.jobsPerSecond = NumberAfter(text, " jobs, ");
    result.ran = status == 0 && result.jobsPerSecond > 0;
    return result;
}

void BenchHost(int hostFiles, long bytesEach, std::vector<char>& buffer)
{
    const testkit::ScratchDir folder("hf-bench-host");
    const HostRunResult host = RunHost(folder.Path(), hostFiles, bytesEach);
    // The host moved the originals away; write them again for the floor.
    const testkit::ScratchDir copies("hf-bench-copies");
    if (!host.ran || !WriteEpsFiles(folder.Path(), hostFiles, bytesEach))
    {
        std::printf("\nhotfolder run: host or module not built, or the run failed; skipped\n");
        return;
    }
    const double copy = Seconds([&] { CopyAll(folder.Path(), copies.Path(), buffer); });
    std::printf("\nhotfolder run --stats over %d files\n", hostFiles);
    std::printf("  whole run           %8.3f s   %.1f jobs per second\n", host.wallSeconds,
                host.jobsPerSecond);
    std::printf("  host's sniffing     %8.3f s\n", host.sniffSeconds);
    std::printf("  copy every file     %8.3f s   ratio run/copy %.3f\n", copy,
                host.wallSeconds / copy);
}

// Sniffs a folder of files against the floor; false when sniffing lost
// files (which is no benchmark result) or the folder could not be written.
bool BenchSniff(int files, long bytesEach, int runs, std::vector<char>& buffer)
{
    const testkit::ScratchDir scratch("hf-bench-sniff");
    const std::string& folder = scratch.Path();
    std::printf("Writing %d EPS files of %ld bytes in %s ...\n", files, bytesEach, folder.c_str());
    if (folder.empty() || !WriteEpsFiles(folder, files, bytesEach))
        return false;

    const size_t warmed = ReadHeads(folder, buffer); // page cache warm for both sides
    EPS filter("EPS");
    size_t accepted = 0;
    // The results are dropped outside the timing: releasing them is the
    // host's work, not the sniffer's.
    wxArrayString rejected;
    JobInfoCollection jobs;
    auto dropResults = [&]
    {
        accepted = jobs.size();
        jobs.Clear();
        rejected.Clear();
    };
    std::pair<std::vector<double>, std::vector<double>> times;
    for (int i = 0; i < runs; ++i)
    {
        times.first.push_back(Seconds([&] { filter.SniffFolder(folder, rejected, jobs); }));
        dropResults();
        times.second.push_back(Seconds([&] { ReadHeads(folder, buffer); }));
    }
    const double sniff = Median(times.first), floor = Median(times.second);
    const double bestSniff = *std::min_element(times.first.begin(), times.first.end());
    const double bestFloor = *std::min_element(times.second.begin(), times.second.end());

    // Both sides run in turns, so that whatever else the machine does weighs
    // on both alike.
    std::printf("\nSniffing %d files (median of %d runs, taken in turns)\n", files, runs);
    std::printf("  EPS::SniffFolder    %8.3f s   %zu jobs\n", sniff, accepted);
    std::printf("  open + read 64 KB   %8.3f s   %zu files   ratio sniff/read %.3f "
                "(target <= 1.5)\n",
                floor, warmed, sniff / floor);
    std::printf("  best of each        %8.3f s / %.3f s   ratio best-sniff/best-read %.3f\n",
                bestSniff, bestFloor, bestSniff / bestFloor);
    return accepted == static_cast<size_t>(files);
}
} // namespace

int main(int argc, char** argv)
{
    const int files = Argument(argc, argv, 1, 10000);
    const long bytesEach = Argument(argc, argv, 2, 8192);
    const int runs = std::max(1, Argument(argc, argv, 3, 5));
    const int hostFiles = Argument(argc, argv, 4, 500);

    wxInitializer toolkit;
    wxLog::EnableLogging(false);
    std::vector<char> buffer(kFloorRead);
    const bool allSniffed = BenchSniff(files, bytesEach, runs, buffer);
    if (hostFiles > 0)
        BenchHost(hostFiles, bytesEach, buffer);
    return allSniffed ? 0 : 1;
}
