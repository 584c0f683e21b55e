#include "HostRun.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <vector>

#include "SampleFolder.h"

extern char** environ;

namespace sniffbench
{
namespace
{
const std::string kHost = std::string(HF_BUILD_DIR) + "/bin/hotfolder";
const std::string kServer = std::string(HF_SOURCE_DIR) + "/examples/server-description.xml";

// Runs args with standard output into outputPath; the exit status or -1.
int Run(const std::vector<std::string>& args, const std::string& outputPath)
{
    std::vector<char*> argv;
    for (const std::string& arg : args)
        argv.push_back(const_cast<char*>(arg.c_str()));
    argv.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, outputPath.c_str(),
                                     O_WRONLY | O_CREAT | O_TRUNC, 0644);
    pid_t child = 0;
    const int spawned = posix_spawn(&child, argv[0], &actions, nullptr, argv.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    int status = 0;
    if (spawned != 0 || waitpid(child, &status, 0) != child || !WIFEXITED(status))
        return -1;
    return WEXITSTATUS(status);
}

// The number after marker on the first line holding it, or -1.
double NumberAfter(const std::string& text, const std::string& marker)
{
    const size_t at = text.find(marker);
    return at == std::string::npos ? -1 : std::atof(text.c_str() + at + marker.size());
}
} // namespace

HostRunResult RunHost(const std::string& folder, int count, long bytesEach)
{
    HostRunResult result;
    if (access(kHost.c_str(), X_OK) != 0)
        return result;
    const std::string warehouse = MakeScratchDirectory("hf-bench-warehouse");
    setenv("HOTFOLDER_WAREHOUSE_ROOT", warehouse.c_str(), 1);
    const std::string log = warehouse + "/host.out";

    if (Run({kHost, "init", folder, "--server", kServer}, log) != 0)
    {
        RemoveTree(warehouse);
        return result;
    }
    WriteEpsFiles(folder, count, bytesEach);
    const std::string output = warehouse + "/out";
    const auto start = std::chrono::steady_clock::now();
    const int status = Run({kHost, "run", folder, "--stats", "--out", output}, log);
    result.wallSeconds =
        std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();

    std::ifstream in(log);
    std::stringstream text;
    text << in.rdbuf();
    result.sniffSeconds = NumberAfter(text.str(), "sniffing ");
    result.jobsPerSecond = NumberAfter(text.str(), " jobs, ");
    result.ran = status == 0 && result.jobsPerSecond > 0;
    RemoveTree(warehouse);
    return result;
}
} // namespace sniffbench
