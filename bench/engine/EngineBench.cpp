// Side-by-side timings of the conversion engine against plain copies (cat,
// dd) and epstool, detection cost on small and huge files, and the memory a
// conversion needs above the process's baseline.
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <functional>
#include <string>
#include <vector>

#include "BenchProcess.h"
#include "EPStoPS.h"

namespace
{
constexpr long long kMegabyte = 1 << 20;
constexpr long long kBigFile = 200 * kMegabyte;

const char kEpsHeader[] = "%!PS-Adobe-3.0 EPSF-3.0\n"
                          "%%BoundingBox: 0 0 612 792\n"
                          "%%EndComments\n";

double Seconds(const std::function<void()>& work)
{
    const auto start = std::chrono::steady_clock::now();
    work();
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

// Median of a few runs; the output is removed before each, outside the timing.
double Median(int runs, const std::string& output, const std::function<void()>& work)
{
    std::vector<double> times;
    for (int i = 0; i < runs; ++i)
    {
        unlink(output.c_str());
        times.push_back(Seconds(work));
    }
    std::sort(times.begin(), times.end());
    return times[times.size() / 2];
}

void WriteEps(const std::string& path, long long size, const std::string& prefix)
{
    FILE* out = fopen(path.c_str(), "wb");
    fwrite(prefix.data(), 1, prefix.size(), out);
    fputs(kEpsHeader, out);
    std::string block;
    while (block.size() < kMegabyte)
        block += "0 0 moveto 612 792 lineto stroke % a line of drawing\n";
    long long written = static_cast<long long>(prefix.size() + std::strlen(kEpsHeader));
    while (written < static_cast<long long>(prefix.size()) + size)
    {
        const long long chunk = std::min<long long>(
            block.size(), static_cast<long long>(prefix.size()) + size - written);
        fwrite(block.data(), 1, static_cast<size_t>(chunk), out);
        written += chunk;
    }
    fclose(out);
}

// A DOS EPS binary header for a section of the given length, with a small
// stand-in preview behind the section.
std::string DosHeader(uint32_t length, uint32_t previewLength)
{
    std::string header = "\xC5\xD0\xD3\xC6";
    for (uint32_t value : {30u, length, 0u, 0u, 30u + length, previewLength})
        for (int i = 0; i < 4; ++i)
            header += static_cast<char>((value >> (8 * i)) & 0xFF);
    return header + "\xFF\xFF";
}

bool Convert(const std::string& input, const std::string& output)
{
    EPStoPSparams_t params;
    std::memset(&params, 0, sizeof params);
    params.pageWidth = 612;
    params.pageHeight = 792;
    void* context = nullptr;
    return IsThisEPS(input.c_str(), &context) == 1 &&
           ConvertEPStoPS(&context, &params, output.c_str()) == 1;
}

long ProcStatusKb(const char* field)
{
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);)
        if (line.compare(0, std::strlen(field), field) == 0)
            return std::atol(line.c_str() + std::strlen(field) + 1);
    return -1;
}

// Peak resident memory of one conversion above the baseline, measured in a
// child so the parent's own history does not count.
long PeakKbAboveBaseline(const std::string& input, const std::string& output)
{
    int pipeFds[2];
    if (pipe(pipeFds) != 0)
        return -1;
    const pid_t child = fork();
    if (child == 0)
    {
        close(pipeFds[0]);
        // Resets the high-water mark to the current resident size.
        if (FILE* clear = fopen("/proc/self/clear_refs", "w"))
        {
            fputs("5", clear);
            fclose(clear);
        }
        const long baseline = ProcStatusKb("VmRSS:");
        Convert(input, output);
        const long peak = ProcStatusKb("VmHWM:");
        const long delta = peak - baseline;
        ssize_t ignored = write(pipeFds[1], &delta, sizeof delta);
        (void)ignored;
        _exit(0);
    }
    close(pipeFds[1]);
    long delta = -1;
    if (read(pipeFds[0], &delta, sizeof delta) != sizeof delta)
        delta = -1;
    close(pipeFds[0]);
    waitpid(child, nullptr, 0);
    return delta;
}

double DetectionMicroseconds(const std::string& path, int iterations)
{
    const double total = Seconds(
        [&]
        {
            for (int i = 0; i < iterations; ++i)
            {
                void* context = nullptr;
                if (IsThisEPS(path.c_str(), &context) == 1)
                    EPStoPSfreeMemory(&context);
            }
        });
    return total / iterations * 1e6;
}
} // namespace

int main(int argc, char** argv)
{
    const int runs = argc > 1 ? std::max(1, std::atoi(argv[1])) : 3;
    char folderName[] = "/tmp/hf-bench-engine-XXXXXX";
    if (!mkdtemp(folderName))
        return 1;
    const std::string folder = folderName;
    const std::string plain = folder + "/big.eps";
    const std::string dos = folder + "/big-dos.eps";
    const std::string output = folder + "/out.ps";
    const std::string copy = folder + "/copy.out";

    std::printf("Preparing 200 MB EPS files in %s ...\n", folder.c_str());
    WriteEps(plain, kBigFile, "");
    const std::string preview(4096, '\x49');
    WriteEps(dos, kBigFile, DosHeader(static_cast<uint32_t>(kBigFile), preview.size()));
    {
        std::ofstream tail(dos, std::ios::binary | std::ios::app);
        tail.write(preview.data(), static_cast<std::streamsize>(preview.size()));
    }
    // Both sides read from the page cache.
    RunAndWait({"cat", plain, dos}, "/dev/null");

    const double convert = Median(runs, output, [&] { Convert(plain, output); });
    const double cat = Median(runs, copy, [&] { RunAndWait({"cat", plain}, copy); });
    const double dd =
        Median(runs, copy,
               [&] {
                   RunAndWait({"dd", "if=" + plain, "of=" + copy, "bs=1M", "status=none"});
               });
    const double convertDos = Median(runs, output, [&] { Convert(dos, output); });

    std::printf("\n200 MB plain EPS (median of %d runs)\n", runs);
    std::printf("  ConvertEPStoPS      %8.3f s\n", convert);
    std::printf("  cat > file          %8.3f s   ratio convert/cat %.3f (target <= 1.15)\n", cat,
                convert / cat);
    std::printf("  dd bs=1M            %8.3f s   ratio convert/dd  %.3f\n", dd, convert / dd);

    std::printf("\n200 MB DOS EPS binary\n");
    std::printf("  ConvertEPStoPS      %8.3f s\n", convertDos);
    if (ProgramInPath("epstool"))
    {
        const double epstool =
            Median(runs, copy,
                   [&] {
                       RunAndWait({"epstool", "--extract-postscript", dos, copy}, "/dev/null");
                   });
        std::printf("  epstool -p          %8.3f s   ratio convert/epstool %.3f (target < 1)\n",
                    epstool, convertDos / epstool);
    }
    else
        std::printf("  epstool not installed: comparison skipped\n");
    unlink(copy.c_str());

    std::printf("\nIsThisEPS\n");
    const std::string small = folder + "/small.eps";
    WriteEps(small, 1024, "");
    std::printf("  1 KB file           %8.1f us per call\n", DetectionMicroseconds(small, 2000));
    const std::string huge = folder + "/huge.eps";
    WriteEps(huge, 4096, "");
    if (truncate(huge.c_str(), 1024 * kMegabyte) == 0)
        std::printf("  1 GB file (sparse)  %8.1f us per call\n", DetectionMicroseconds(huge, 2000));

    std::printf("\nPeak memory of one 200 MB conversion above baseline: %ld KB (target < 4096)\n",
                PeakKbAboveBaseline(plain, output));

    for (const std::string& file : {plain, dos, output, small, huge})
        unlink(file.c_str());
    rmdir(folder.c_str());
    return 0;
}
