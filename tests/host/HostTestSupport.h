#pragma once
// Runs the built hotfolder program on scratch folders. Every test gets its own
// scratch directory and its own warehouse (HOTFOLDER_WAREHOUSE_ROOT), so
// nothing touches the machine-wide store.
#include <signal.h>
#include <sys/wait.h>

#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "TestKit.h"

namespace host_test
{
using testkit::Exists;
using testkit::ListDirectory;
using testkit::ReadFile;
using testkit::WaitFor;
using testkit::WriteFile;

inline const std::string kHost = HF_HOTFOLDER_EXE;
inline const std::string kExamples = std::string(HF_SOURCE_DIR) + "/examples";
inline const std::string kServer = kExamples + "/server-description.xml";
inline const std::string kContainer = "[_Orv_HotFolder_]";

// A hotfolder process left running (watch mode, delayed jobs, the service),
// killed when the object goes; its output goes to files the test reads
// while it runs.
class BackgroundHost
{
public:
    BackgroundHost(std::vector<std::string> args, const std::string& scratch)
        : m_out(scratch + "/host-out.txt"), m_err(scratch + "/host-err.txt")
    {
        args.insert(args.begin(), kHost);
        m_pid = testkit::StartProgram(args, m_out, m_err);
    }
    ~BackgroundHost() { Signal(SIGKILL), Wait(10000); }

    bool Started() const { return m_pid > 0; }
    std::string Out() const { return ReadFile(m_out); }
    std::string Err() const { return ReadFile(m_err); }
    void Signal(int signal) { m_pid > 0 && kill(m_pid, signal); }

    // Exit status once it ended within timeoutMs; -1 otherwise.
    int Wait(int timeoutMs)
    {
        int status = 0;
        if (m_pid <= 0 ||
            !WaitFor([&] { return waitpid(m_pid, &status, WNOHANG) == m_pid; }, timeoutMs))
            return -1;
        m_pid = -1;
        return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    }

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
        setenv("HOTFOLDER_WAREHOUSE_ROOT", (scratch + "/machine").c_str(), 1);
        unsetenv("HOTFOLDER_MODULE");
    }

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
    std::string MakePostScriptFolder(const std::string& paper = "A4",
                                     const std::string& name = "hot")
    {
        const std::string folder = scratch + "/" + name;
        EXPECT_EQ(Host({"init", folder, "--server", kServer}).exitCode, 0);
        EXPECT_EQ(Host({"settings", folder, "--set", "OUTPUTFILETYPEEPS=0", "OUTPUTFILETYPEPS=1",
                        "DEFAULTPAGESIZE=" + paper})
                      .exitCode,
                  0);
        return folder;
    }

    testkit::ScratchDir scratchDir{"hf-host-test"};
    const std::string scratch = scratchDir.Path();
};
} // namespace host_test
