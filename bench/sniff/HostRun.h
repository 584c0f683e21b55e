#pragma once
// One "hotfolder run --stats" over a prepared hot folder, timed from outside
// and with the host's own figures.
#include <string>

namespace sniffbench
{
struct HostRunResult
{
    bool ran = false;
    double wallSeconds = 0;
    double sniffSeconds = 0; // the host's "sniffing" figure
    double jobsPerSecond = 0;
};

// Makes folder a hot folder in a private warehouse, fills it with count EPS
// files and runs the host over it. ran is false when the host or the module
// is not built or a step fails.
HostRunResult RunHost(const std::string& folder, int count, long bytesEach);
} // namespace sniffbench
