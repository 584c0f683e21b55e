// Side-by-side timings of the conversion engine against plain copies (cat,
// dd, cp), other ways of copying the body it could use, and epstool;
// detection cost on small and huge files, and the memory a conversion needs
// above the process's baseline.
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

#include "CopyCandidates.h"
#include "EPStoPS.h"
#include "TestKit.h"

namespace
{
constexpr long long kMegabyte = 1 << 20;

const char kEpsHeader[] = "%!PS-Adobe-3.0 EPSF-3.0\n"
                          "%%BoundingBox: 0 0 612 792\n"
                          "%%EndComments\n";

// Runs a helper program to its end, its standard error discarded; the
// timings take exactly this start and wait.
int RunAndWait(const std::vector<std::string>& args, const std::string& stdoutPath = "")
{
    return testkit::WaitProgram(testkit::StartProgram(args, stdoutPath, "/dev/null"));
}

double Seconds(const std::function<void()>& work)
{
    const auto start = std::chrono::steady_clock::now();
    work();
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

struct Contender
{
    const char* name;
    std::string output; // removed before each run, outside the timing
    std::function<void()> work;
    std::vector<double> times;
};

// Runs the contenders in turns, so that a slow moment of the machine hits
// all of them alike; reports best and median per contender.
void RunInTurns(std::vector<Contender>& contenders, int rounds)
{
    for (int round = 0; round < rounds; ++round)
        for (Contender& c : contenders)
        {
            // Each run starts with no dirty pages left by the ones before
            // (removed files need not be written back).
            for (const Contender& any : contenders)
                unlink(any.output.c_str());
            sync();
            c.times.push_back(Seconds(c.work));
        }
    for (Contender& c : contenders)
        std::sort(c.times.begin(), c.times.end());
}

double Best(const Contender& c)
{
    return c.times.front();
}
double MedianOf(const Contender& c)
{
    return c.times[c.times.size() / 2];
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

// Splits a conversion's output of the plain file into the wrapper's header
// and trailer, so the candidates write the same bytes.
bool WrapperAround(const std::string& output, long long inputSize, std::string& header,
                   std::string& trailer)
{
    std::ifstream in(output, std::ios::binary);
    std::string head(65536, '\0');
    in.read(&head[0], static_cast<std::streamsize>(head.size()));
    head.resize(static_cast<size_t>(in.gcount()));
    const size_t body = head.find(kEpsHeader);
    struct stat st;
    if (body == std::string::npos || stat(output.c_str(), &st) != 0)
        return false;
    header = head.substr(0, body);
    const long long trailerSize = st.st_size - static_cast<long long>(body) - inputSize;
    if (trailerSize < 0)
        return false;
    trailer.resize(static_cast<size_t>(trailerSize));
    in.clear();
    in.seekg(-trailerSize, std::ios::end);
    in.read(&trailer[0], trailerSize);
    return in.good();
}

void PrintTimes(const std::vector<Contender>& contenders)
{
    for (const Contender& c : contenders)
        std::printf("  %-26s best %7.3f s  median %7.3f s\n", c.name, Best(c), MedianOf(c));
}

// Conversion of the plain file against plain copies of the same bytes and
// against the other ways of copying the body; every figure is a median
// divided by the best median of the plain copies.
void BenchPlain(const std::string& plain, long long size, const std::string& output,
                const std::string& copy, int runs)
{
    std::string header, trailer;
    if (!Convert(plain, output) || !WrapperAround(output, size, header, trailer))
    {
        std::printf("conversion of the plain file failed\n");
        return;
    }
    std::vector<Contender> contenders = {
        {"convert", output, [&] { Convert(plain, output); }, {}},
        {"cat",
         copy,
         [&] {
             RunAndWait({"cat", plain}, copy);
         },
         {}},
        {"dd_1m",
         copy,
         [&] {
             RunAndWait({"dd", "if=" + plain, "of=" + copy, "bs=1M", "status=none"});
         },
         {}},
        {"cp",
         copy,
         [&] {
             RunAndWait({"cp", plain, copy});
         },
         {}},
    };
    const size_t floors = contenders.size();
    for (const CopyCandidate& candidate : CopyCandidates())
        contenders.push_back({candidate.name,
                              copy,
                              [&, candidate]
                              {
                                  if (!CopyAsConversion(candidate, plain, 0,
                                                        static_cast<size_t>(size), header, trailer,
                                                        copy))
                                      std::printf("  %s failed\n", candidate.name);
                              },
                              {}});
    RunInTurns(contenders, runs);
    double floor = MedianOf(contenders[1]);
    for (size_t i = 2; i < floors; ++i)
        floor = std::min(floor, MedianOf(contenders[i]));
    std::printf("\n%lld MB plain EPS (%d runs in turns; best and median)\n", size / kMegabyte,
                runs);
    PrintTimes(contenders);
    std::printf("Medians against the best plain copy's median:\n");
    std::printf("ratio convert/best_copy %.3f (target <= 1)\n", MedianOf(contenders[0]) / floor);
    for (size_t i = 1; i < contenders.size(); ++i)
        std::printf("ratio %s/best_copy %.3f\n", contenders[i].name,
                    MedianOf(contenders[i]) / floor);
}

void BenchDos(const std::string& dos, const std::string& output, const std::string& copy, int runs)
{
    std::vector<Contender> contenders = {
        {"convert", output, [&] { Convert(dos, output); }, {}},
    };
    if (testkit::ProgramAvailable("epstool"))
        contenders.push_back(
            {"epstool -p",
             copy,
             [&] {
                 RunAndWait({"epstool", "--extract-postscript", dos, copy}, "/dev/null");
             },
             {}});
    RunInTurns(contenders, runs);
    std::printf("\nDOS EPS binary\n");
    PrintTimes(contenders);
    if (contenders.size() == 1)
        std::printf("  epstool not installed: comparison skipped\n");
    else
        std::printf("ratio convert_dos/epstool %.3f (target < 1)\n",
                    MedianOf(contenders[0]) / MedianOf(contenders[1]));
}
} // namespace

int main(int argc, char** argv)
{
    const int runs = argc > 1 ? std::max(1, std::atoi(argv[1])) : 5;
    const long long size = (argc > 2 ? std::max(1, std::atoi(argv[2])) : 200) * kMegabyte;
    const testkit::ScratchDir scratch("hf-bench-engine");
    if (scratch.Path().empty())
        return 1;
    const std::string plain = scratch.File("big.eps");
    const std::string dos = scratch.File("big-dos.eps");
    const std::string output = scratch.File("out.ps");
    const std::string copy = scratch.File("copy.out");

    std::printf("Preparing %lld MB EPS files in %s ...\n", size / kMegabyte,
                scratch.Path().c_str());
    WriteEps(plain, size, "");
    const std::string preview(4096, '\x49');
    WriteEps(dos, size, DosHeader(static_cast<uint32_t>(size), preview.size()));
    {
        std::ofstream tail(dos, std::ios::binary | std::ios::app);
        tail.write(preview.data(), static_cast<std::streamsize>(preview.size()));
    }
    // Every side reads from the page cache.
    RunAndWait({"cat", plain, dos}, "/dev/null");

    BenchPlain(plain, size, output, copy, runs);
    BenchDos(dos, output, copy, runs);
    unlink(copy.c_str());

    std::printf("\nIsThisEPS\n");
    const std::string small = scratch.File("small.eps");
    WriteEps(small, 1024, "");
    std::printf("  1 KB file           %8.1f us per call\n", DetectionMicroseconds(small, 2000));
    const std::string huge = scratch.File("huge.eps");
    WriteEps(huge, 4096, "");
    if (truncate(huge.c_str(), 1024 * kMegabyte) == 0)
        std::printf("  1 GB file (sparse)  %8.1f us per call\n", DetectionMicroseconds(huge, 2000));

    const long peakKb = PeakKbAboveBaseline(plain, output);
    if (peakKb < 0)
    {
        std::printf("\nPeak memory: the measuring child failed\n");
        return 1;
    }
    std::printf("\nPeak memory of one %lld MB conversion above baseline: %ld KB\n",
                size / kMegabyte, peakKb);
    std::printf("ratio peak_kb/4096_kb %.3f (target < 1)\n", peakKb / 4096.0);
    return 0;
}
