#pragma once
// Runs the built hotfolder program on scratch folders. Every test gets its own
// scratch directory and its own warehouse (HOTFOLDER_WAREHOUSE_ROOT), so
// nothing touches the machine-wide store.
#include <dirent.h>
#include <fcntl.h>
#include <ftw.h>
#include <signal.h>
#include <spawn.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "GhostscriptOracle.h"

extern char** environ;

namespace host_test
{
inline const std::string kHost = HF_HOTFOLDER_EXE;
inline const std::string kExamples = std::string(HF_SOURCE_DIR) + "/examples";
inline const std::string kServer = kExamples + "/server-description.xml";
inline const std::string kContainer = "[_Orv_HotFolder_]";

inline std::string ReadFile(const std::string& path)
{
    return testkit::ReadFile(path);
}

inline void WriteFile(const std::string& path, const std::string& bytes)
{
    std::ofstream(path, std::ios::binary) << bytes;
}

inline bool Exists(const std::string& path)
{
    struct stat info;
    return lstat(path.c_str(), &info) == 0;
}

// Names of the entries of a directory, sorted; hidden ones left out.
inline std::vector<std::string> ListDirectory(const std::string& directory)
{
    std::vector<std::string> names;
    if (DIR* dir = opendir(directory.c_str()))
    {
        while (dirent* entry = readdir(dir))
            if (entry->d_name[0] != '.')
                names.push_back(entry->d_name);
        closedir(dir);
    }
    std::sort(names.begin(), names.end());
    return names;
}

inline int RemoveEntry(const char* path, const struct stat*, int type, struct FTW*)
{
    return type == FTW_DP ? rmdir(path) : unlink(path);
}

inline bool WaitFor(const std::function<bool()>& condition, int timeoutMs)
{
    for (int waited = 0; waited < timeoutMs; waited += 50)
    {
        if (condition())
            return true;
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
    }
    return condition();
}

// A hotfolder process left running (watch mode, delayed jobs); its output
// goes to files so the test can read it while it runs.
class BackgroundHost
{
public:
    BackgroundHost(const std::vector<std::string>& args, const std::string& scratch)
        : m_out(scratch + "/host-out.txt"), m_err(scratch + "/host-err.txt")
    {
        std::vector<std::string> all = {kHost};
        all.insert(all.end(), args.begin(), args.end());
        std::vector<char*> argv;
        for (std::string& arg : all)
            argv.push_back(arg.data());
        argv.push_back(nullptr);
        posix_spawn_file_actions_t actions;
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_addopen(&actions, 0, "/dev/null", O_RDONLY, 0);
        posix_spawn_file_actions_addopen(&actions, 1, m_out.c_str(), O_WRONLY | O_CREAT | O_TRUNC,
                                         0644);
        posix_spawn_file_actions_addopen(&actions, 2, m_err.c_str(), O_WRONLY | O_CREAT | O_TRUNC,
                                         0644);
        if (posix_spawn(&m_pid, argv[0], &actions, nullptr, argv.data(), environ) != 0)
            m_pid = -1;
        posix_spawn_file_actions_destroy(&actions);
    }
    ~BackgroundHost()
    {
        if (m_pid > 0)
        {
            kill(m_pid, SIGKILL);
            waitpid(m_pid, nullptr, 0);
        }
    }

    bool Started() const { return m_pid > 0; }
    std::string Out() const { return ReadFile(m_out); }
    std::string Err() const { return ReadFile(m_err); }

    // Exit status once it ended by itself within timeoutMs; -1 otherwise.
    int Wait(int timeoutMs)
    {
        int status = 0;
        bool ended = WaitFor([&] { return waitpid(m_pid, &status, WNOHANG) == m_pid; }, timeoutMs);
        if (!ended)
            return -1;
        m_pid = -1;
        return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    }
    void Signal(int signal) { kill(m_pid, signal); }

private:
    pid_t m_pid = -1;
    std::string m_out, m_err;
};

// A fresh scratch directory with its own warehouse for every test.
class HostTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        char pattern[] = "/tmp/hf-host-test-XXXXXX";
        ASSERT_NE(mkdtemp(pattern), nullptr);
        scratch = pattern;
        setenv("HOTFOLDER_WAREHOUSE_ROOT", (scratch + "/machine").c_str(), 1);
        unsetenv("HOTFOLDER_MODULE");
    }
    void TearDown() override { nftw(scratch.c_str(), RemoveEntry, 16, FTW_DEPTH | FTW_PHYS); }

    testkit::ProcessResult Host(std::vector<std::string> args)
    {
        args.insert(args.begin(), kHost);
        return testkit::RunProgram(args);
    }

    std::string Container(const std::string& folder) { return folder + "/" + kContainer; }
    std::string Kept(const std::string& folder) { return Container(folder) + "/[MoveFolder]"; }
    std::string Failed(const std::string& folder) { return Container(folder) + "/[FailedFolder]"; }
    std::string Warehouse() { return scratch + "/machine/HotFolders"; }

    void CopyExample(const std::string& name, const std::string& folder)
    {
        WriteFile(folder + "/" + name, ReadFile(kExamples + "/eps/" + name));
    }

    // A hot folder bound to the example server, converting to PostScript on
    // the given paper.
    std::string MakePostScriptFolder(const std::string& paper = "A4")
    {
        std::string folder = scratch + "/hot";
        testkit::ProcessResult init = Host({"init", folder, "--server", kServer});
        EXPECT_EQ(init.exitCode, 0) << init.err;
        testkit::ProcessResult set = Host({"settings", folder, "--set", "OUTPUTFILETYPEEPS=0",
                                           "OUTPUTFILETYPEPS=1", "DEFAULTPAGESIZE=" + paper});
        EXPECT_EQ(set.exitCode, 0) << set.err;
        return folder;
    }

    std::string scratch;
};
} // namespace host_test
