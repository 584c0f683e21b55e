// The window's long work runs off its thread: starting the service and
// trying a file with a folder's settings. Each step is checked for the
// window answering meanwhile, for what shows after and for what is left
// behind, also when the window closes half-way; driven by the tables
// tests/data/manager/ui-service-start.txt and ui-trials.txt.
#include <dirent.h>
#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <thread>

#include <wx/button.h>
#include <wx/stattext.h>

#include "ManagerUiFixture.h"
#include "core/ServiceControl.h"
#include "ui/PreviewCanvas.h"
#include "ui/PreviewPanel.h"
#include "ui/ServiceBar.h"

using namespace manager_test;
using namespace host_test;
using testkit::Cases;

namespace
{
// "hotfolder" for the service's start: the real one beside it after a
// while, or, when the file "never" lies beside it, a process that never
// comes up. Either way its process id goes to the file "pid".
const char kHotfolderStandIn[] = "#!/bin/sh\n"
                                 "here=$(dirname \"$0\")\n"
                                 "echo $$ > \"$here/pid\"\n"
                                 "[ -e \"$here/never\" ] && exec sleep 30\n"
                                 "sleep 2\n"
                                 "exec \"$here/real-hotfolder\" \"$@\"\n";

// Ghostscript, or, when the file "hang" lies beside it, one that notes it
// started and never ends.
const char kGhostscriptStandIn[] = "#!/bin/sh\n"
                                   "here=$(dirname \"$0\")\n"
                                   "if [ -e \"$here/hang\" ]; then\n"
                                   "  : > \"$here/started\"\n"
                                   "  exec sleep 600\n"
                                   "fi\n"
                                   "exec gs \"$@\"\n";

// An environment variable set for one test, put back afterwards.
class ScopedEnv
{
public:
    ScopedEnv(const char* name, const std::string& value) : m_name(name)
    {
        const char* old = std::getenv(name);
        m_had = old != nullptr;
        m_old = old ? old : "";
        setenv(name, value.c_str(), 1);
    }
    ~ScopedEnv() { m_had ? setenv(m_name, m_old.c_str(), 1) : unsetenv(m_name); }

private:
    const char* m_name;
    bool m_had = false;
    std::string m_old;
};

// A filter module that is a pipe nobody writes to: loading it waits in
// open until Release (or a watchdog, so that a window whose own thread
// loads it fails the test instead of hanging), then fails.
class StallingModule
{
public:
    explicit StallingModule(const std::string& path) : m_path(path)
    {
        mkfifo(path.c_str(), 0600);
        m_watchdog = std::thread(
            [this]
            {
                testkit::WaitFor([this] { return m_released.load(); }, 20000);
                Release();
            });
    }
    ~StallingModule()
    {
        Release();
        m_watchdog.join();
    }
    const std::string& Path() const { return m_path; }
    void Release()
    {
        if (m_released.exchange(true))
            return;
        // A writer for a loader waiting in open, and a plain file for any later one.
        const int writer = open(m_path.c_str(), O_RDWR | O_NONBLOCK);
        testkit::WriteFile(m_path + ".plain", "no module\n");
        rename((m_path + ".plain").c_str(), m_path.c_str());
        if (writer >= 0)
            close(writer);
    }

private:
    std::string m_path;
    std::atomic<bool> m_released{false};
    std::thread m_watchdog;
};

std::string StateName(ServiceState state)
{
    return state == ServiceState::Running  ? "running"
           : state == ServiceState::Paused ? "paused"
                                           : "stopped";
}

// The scratch files and work folders of trials in folder.
size_t TrialFiles(const std::string& folder)
{
    size_t count = 0;
    if (DIR* dir = opendir(folder.c_str()))
    {
        while (const dirent* entry = readdir(dir))
        {
            const std::string name = entry->d_name;
            count += name.rfind("hf-trial", 0) == 0 || name.rfind(".hotfolder-trial-", 0) == 0;
        }
        closedir(dir);
    }
    return count;
}

std::string Executable(const std::string& path, const char* text)
{
    WriteFile(path, text);
    chmod(path.c_str(), 0755);
    return path;
}
} // namespace

class ManagerBackground : public ManagerTest
{
protected:
    // The button pressed as the toolkit does it: the handler runs before this returns.
    void Press(wxButton& button)
    {
        wxCommandEvent pressed(wxEVT_BUTTON, button.GetId());
        pressed.SetEventObject(&button);
        button.HandleWindowEvent(pressed);
    }
    void CloseWindow()
    {
        m_frame->Destroy();
        m_frame = nullptr;
        ASSERT_TRUE(PumpUntil([] { return wxTopLevelWindows.empty(); }));
    }
    // Ends what the service stand-in started, and waits until nothing runs.
    void EndStandIn(const std::string& bin)
    {
        const std::string pid = ReadFile(bin + "/pid");
        EXPECT_FALSE(pid.empty()) << "the start went past the stand-in";
        if (!pid.empty())
            kill(std::stoi(pid), SIGKILL);
        unlink((bin + "/pid").c_str());
        Host({"stop", "--wait", "30"}); // a service the stand-in did not start
        EXPECT_TRUE(WaitFor([] { return ReadServiceState() == ServiceState::Stopped; }, 20000));
    }
};

TEST_F(ManagerBackground, StartingTheServiceNeverHoldsTheWindow)
{
    if (Exists("/run/systemd/system"))
        GTEST_SKIP() << "systemd runs here: a start would go through it, not the stand-in";
    const std::string bin = scratch + "/bin";
    mkdir(bin.c_str(), 0755);
    ASSERT_EQ(0, symlink(HF_HOTFOLDER_EXE, (bin + "/real-hotfolder").c_str()));
    Executable(bin + "/hotfolder", kHotfolderStandIn);
    const char* path = std::getenv("PATH");
    ScopedEnv searched("PATH", bin + ":" + (path ? path : "/usr/bin:/bin"));
    for (const auto& c : Cases("manager/ui-service-start.txt", 5, 4))
    {
        SCOPED_TRACE(c[0] + " | " + c[1]);
        unlink((bin + "/never").c_str());
        if (c[0] == "never")
            WriteFile(bin + "/never", "");
        ServiceBar& bar = Frame().Service();
        ASSERT_TRUE(PumpUntil(
            [&]
            { return bar.State() == ServiceState::Stopped && bar.ActionButton().IsEnabled(); }));
        wxStopWatch watch;
        Press(bar.ActionButton());
        EXPECT_LT(watch.Time(), 1000) << "the click waited for the start";
        EXPECT_EQ(L"Starting the service…", bar.StateText().GetLabel());
        EXPECT_FALSE(bar.ActionButton().IsEnabled());
        if (c[1] == "yes")
        {
            watch.Start();
            ASSERT_NO_FATAL_FAILURE(CloseWindow());
            EXPECT_LT(watch.Time(), 2000) << "closing waited for the start";
            // Past the start's own time: nothing may report to the window gone.
            PumpUntil([&] { return watch.Time() > 7000; }, 10000);
        }
        else
        {
            const auto settled = [&]
            {
                return bar.ActionButton().IsEnabled() &&
                       bar.ActionButton().GetLabel().utf8_string() == c[3] &&
                       StateName(bar.State()) == c[2];
            };
            if (c[4] == "yes")
            {
                wxTEST_DIALOG(EXPECT_TRUE(PumpUntil(settled)),
                              wxExpectModal<wxMessageDialog>(wxID_OK));
            }
            else
                EXPECT_TRUE(PumpUntil(settled));
        }
        EXPECT_TRUE(WaitFor([&] { return StateName(ReadServiceState()) == c[2]; }, 20000));
        EndStandIn(bin);
    }
}

TEST_F(ManagerBackground, TrialsNeverHoldTheWindowAndLeaveNoScratchFiles)
{
    const std::string temp = scratch + "/temp", gs = scratch + "/gs";
    mkdir(temp.c_str(), 0755);
    mkdir(gs.c_str(), 0755);
    ScopedEnv scratchFiles("TMPDIR", temp);
    ScopedEnv ghostscript("HOTFOLDER_GHOSTSCRIPT", Executable(gs + "/gs", kGhostscriptStandIn));
    StallingModule stalling(scratch + "/stalling.so");
    const std::string folder = MakePostScriptFolder();
    WriteFile(scratch + "/notes.eps", "Just a note, no PostScript.\n");
    auto* stalled = new PreviewPanel(&Frame(), stalling.Path());
    ASSERT_TRUE(Rescanned());
    for (const auto& c : Cases("manager/ui-trials.txt", 5, 5))
    {
        SCOPED_TRACE(c[0] + " | " + c[1] + " | " + c[2]);
        if (c[3] == "page" && !testkit::ProgramAvailable("gs"))
            continue;
        unlink((gs + "/hang").c_str());
        unlink((gs + "/started").c_str());
        if (c[2] == "hanging")
            WriteFile(gs + "/hang", "");
        PreviewPanel& panel = c[1] == "stalling" ? *stalled : Frame().Preview();
        panel.SetFolder(folder);
        const size_t delivered = panel.Delivered();
        const std::string file =
            Exists(kExamples + "/" + c[0]) ? kExamples + "/" + c[0] : scratch + "/" + c[0];
        wxStopWatch watch;
        ASSERT_TRUE(panel.TryFileNamed(file));
        EXPECT_LT(watch.Time(), 2000) << "the trial held the window";
        EXPECT_TRUE(Rescanned());
        if (c[1] == "stalling")
        {
            EXPECT_EQ(delivered, panel.Delivered()) << "converted before the module was loaded";
            stalling.Release();
        }
        if (c[3] == "-")
        {
            ASSERT_TRUE(PumpUntil([&] { return Exists(gs + "/started"); }, 60000));
            EXPECT_TRUE(Rescanned());
            EXPECT_EQ(delivered, panel.Delivered());
        }
        else
        {
            ASSERT_TRUE(PumpUntil([&] { return panel.Delivered() > delivered; }, 60000));
            const PagePreview& page = panel.Canvas().Page();
            if (c[3] == "page")
            {
                EXPECT_TRUE(page.ok) << page.reason;
                EXPECT_FALSE(page.marks.IsEmpty());
            }
            else
            {
                EXPECT_FALSE(page.ok);
                EXPECT_NE(wxNOT_FOUND, page.reason.Find(wxString::FromUTF8(c[3]))) << page.reason;
            }
        }
        EXPECT_EQ(std::stoul(c[4]), TrialFiles(temp));
    }
    // The panel going takes the scratch file of a trial under way with it.
    ASSERT_NO_FATAL_FAILURE(CloseWindow());
    EXPECT_EQ(0u, TrialFiles(temp));
}
