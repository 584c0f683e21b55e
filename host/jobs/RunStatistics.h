#pragma once
#include <chrono>
#include <cstddef>

// Counts and timings of one run, for the closing summary and --stats.
class RunStatistics
{
public:
    RunStatistics() : m_started(std::chrono::steady_clock::now()) {}

    size_t done = 0;
    size_t failed = 0;
    size_t refused = 0;
    size_t notPrinted = 0;     // delivered, but the printer refused, aborted or cancelled them
    double sniffSeconds = 0;   // inside SniffFolder
    double processSeconds = 0; // inside Process

    // Adds the counts and times of another run (not its start).
    void Add(const RunStatistics& other);
    double ElapsedSeconds() const;
    // "3 done, 1 failed, 2 refused in 1.23 s"
    void PrintSummary() const;
    // Where the time went: inside the filter's Process, or around it.
    void PrintTiming() const;

private:
    std::chrono::steady_clock::time_point m_started;
};

// Measures the time of a scope into a counter.
class ScopedSeconds
{
public:
    explicit ScopedSeconds(double& total)
        : m_total(total), m_started(std::chrono::steady_clock::now())
    {
    }
    ~ScopedSeconds()
    {
        m_total +=
            std::chrono::duration<double>(std::chrono::steady_clock::now() - m_started).count();
    }
    ScopedSeconds(const ScopedSeconds&) = delete;
    ScopedSeconds& operator=(const ScopedSeconds&) = delete;

private:
    double& m_total;
    std::chrono::steady_clock::time_point m_started;
};
