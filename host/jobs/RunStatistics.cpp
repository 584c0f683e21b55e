#include "jobs/RunStatistics.h"

#include <cstdio>

void RunStatistics::Add(const RunStatistics& other)
{
    done += other.done;
    failed += other.failed;
    refused += other.refused;
    notPrinted += other.notPrinted;
    sniffSeconds += other.sniffSeconds;
    processSeconds += other.processSeconds;
}

double RunStatistics::ElapsedSeconds() const
{
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - m_started).count();
}

// Numbers go out through printf in the C locale the host never leaves, so
// they always carry ".".
void RunStatistics::PrintSummary() const
{
    std::printf("Summary: %zu done, %zu failed, %zu refused", done, failed, refused);
    if (notPrinted)
        std::printf(", %zu not printed", notPrinted);
    std::printf(" in %.2f s\n", ElapsedSeconds());
    std::fflush(stdout);
}

void RunStatistics::PrintTiming() const
{
    double total = ElapsedSeconds();
    double outside = total - processSeconds;
    double share = total > 0 ? outside / total : 0;
    size_t jobs = done + failed;
    std::printf("Timing: total %.3f s, sniffing %.3f s, inside Process %.3f s, outside Process "
                "%.3f s (%.1f%% of the total)\n",
                total, sniffSeconds, processSeconds, outside, share * 100);
    std::printf("Throughput: %zu jobs, %.1f jobs per second\n", jobs,
                total > 0 ? jobs / total : 0.0);
    std::fflush(stdout);
}
