// bench_manager [folders] [jobs] [drops] (defaults 20, 1000, 10): the
// desktop client's window on scratch hot folders.
//  1. Memory: the window's resident size once it lists the folders and the
//     first folder's jobs (that many kept originals), against the same
//     process showing a bare frame with an empty list (the toolkit's floor).
//  2. Arrival to row: files dropped one at a time into the first folder of
//     a running service; the time from the drop to the job's row in the
//     window (done), against the time to the output's appearance on disk.
// Runs under its own virtual display when there is none.
#include <signal.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

#include <wx/app.h>
#include <wx/frame.h>
#include <wx/listctrl.h>

#include "TestKit.h"
#include "folder/HotFolder.h"
#include "ui/LiveList.h"
#include "core/ServiceControl.h"
#include "ui/ManagerFrame.h"

namespace
{
using Clock = std::chrono::steady_clock;

class BenchApp : public wxApp
{
public:
    bool OnInit() override { return true; }
};

long ResidentKilobytes()
{
    const std::string status = testkit::ReadFile("/proc/self/status");
    const size_t at = status.find("VmRSS:");
    return at == std::string::npos ? -1 : std::atol(status.c_str() + at + 6);
}

// Lets the window work until condition holds or timeoutMs pass.
bool PumpUntil(const std::function<bool()>& condition, int timeoutMs)
{
    const auto deadline = Clock::now() + std::chrono::milliseconds(timeoutMs);
    while (!condition())
    {
        if (Clock::now() > deadline)
            return false;
        wxTheApp->ProcessPendingEvents();
        wxYield();
        wxMilliSleep(2);
    }
    return true;
}

double Median(std::vector<double> values)
{
    std::sort(values.begin(), values.end());
    return values.empty() ? 0 : values[values.size() / 2];
}

// Starts the program again under xvfb-run when there is no display.
int UnderVirtualDisplay(int argc, char** argv)
{
    std::vector<std::string> args = {"xvfb-run", "-a", "-s", "-screen 0 1280x1024x24"};
    for (int i = 0; i < argc; ++i)
        args.push_back(argv[i]);
    return testkit::WaitProgram(testkit::StartProgram(args, "", ""));
}

bool MakeFolders(const testkit::ScratchDir& scratch, int count, std::vector<std::string>& folders)
{
    for (int i = 0; i < count; ++i)
    {
        folders.push_back(scratch.File("folder" + std::to_string(i)));
        const testkit::ProcessResult made = testkit::RunProgram(
            {HF_HOTFOLDER_EXE, "init", folders.back(), "--server", HF_EXAMPLE_SERVER});
        if (made.exitCode != 0)
        {
            std::fprintf(stderr, "bench_manager: cannot make %s\n%s", folders.back().c_str(),
                         made.err.c_str());
            return false;
        }
    }
    return true;
}

// Jobs done before the window opens: kept originals of the first folder.
bool KeepOriginals(const std::string& folder, int jobs)
{
    HotFolder hotFolder;
    wxString error;
    if (!hotFolder.Open(wxString::FromUTF8(folder), error))
        return false;
    const std::string kept(hotFolder.GetKeptOriginalsFolder().utf8_str());
    const std::string eps = testkit::ReadFile(HF_EXAMPLE_EPS);
    for (int i = 0; i < jobs; ++i)
        if (!testkit::WriteFile(kept + "/earlier-" + std::to_string(i) + ".eps", eps))
            return false;
    return true;
}

bool Shows(const ManagerFrame& frame, const std::string& name)
{
    for (const JobEntry& job : frame.ShownJobs())
        if (job.name == wxString::FromUTF8(name) && job.outcome == JobOutcome::Done)
            return true;
    return false;
}

bool OutputOf(const std::string& outputFolder, const std::string& stem)
{
    for (const std::string& name : testkit::ListDirectory(outputFolder))
        if (name.compare(0, stem.size(), stem) == 0)
            return true;
    return false;
}
} // namespace

int main(int argc, char** argv)
{
    if (!std::getenv("DISPLAY"))
        return UnderVirtualDisplay(argc, argv);
    const int folderCount = argc > 1 ? std::atoi(argv[1]) : 20;
    const int jobCount = argc > 2 ? std::atoi(argv[2]) : 1000;
    const int drops = argc > 3 ? std::atoi(argv[3]) : 10;
    const testkit::ScratchDir scratch("hf-bench-manager");
    if (scratch.Path().empty())
        return 1;
    setenv("HOTFOLDER_WAREHOUSE_ROOT", scratch.File("machine").c_str(), 1);
    setenv("HOTFOLDER_MODULE", HF_MODULE_PATH, 1);
    std::vector<std::string> folders;
    if (!MakeFolders(scratch, folderCount, folders) || !KeepOriginals(folders[0], jobCount))
        return 1;

    wxApp::SetInstance(new BenchApp);
    int toolkitArgc = 1;
    char* toolkitArgv[] = {argv[0], nullptr};
    if (!wxEntryStart(toolkitArgc, toolkitArgv))
    {
        std::fprintf(stderr, "bench_manager: cannot open the display\n");
        return 1;
    }
    wxTheApp->CallOnInit();

    // The floor: the toolkit with a shown frame and an empty report list.
    auto* bare = new wxFrame(nullptr, wxID_ANY, "bare", wxDefaultPosition, wxSize(1100, 700));
    new wxListCtrl(bare, wxID_ANY, wxDefaultPosition, wxDefaultSize, wxLC_REPORT);
    bare->Show();
    PumpUntil([] { return false; }, 500);
    const long bareKb = ResidentKilobytes();
    bare->Destroy();
    PumpUntil([] { return false; }, 100);

    auto* frame = new ManagerFrame(HF_MODULE_PATH);
    frame->Show();
    const wxString first = wxString::FromUTF8(folders[0]);
    bool listed = PumpUntil([&] { return frame->Folders().GetItemCount() == folderCount; }, 30000);
    frame->Folders().SelectKey(first);
    listed = listed && PumpUntil([&] { return frame->Jobs().GetItemCount() > 0; }, 30000);
    PumpUntil([] { return false; }, 1500); // a few rescans more
    const long windowKb = ResidentKilobytes();
    std::printf("%d folders, %d jobs on record, %d job rows shown\n", folderCount, jobCount,
                frame->Jobs().GetItemCount());
    std::printf("resident: %.1f MB the bare frame, %.1f MB the manager's window\n", bareKb / 1024.0,
                windowKb / 1024.0);
    if (!listed)
        std::printf("the window did not list the folders and jobs\n");
    std::printf("ratio window_rss/bare_frame_rss %.3f (target < 2)\n",
                static_cast<double>(windowKb) / bareKb);

    // Arrival to row with a service running.
    HotFolder hotFolder;
    wxString error;
    hotFolder.Open(first, error);
    const std::string outputFolder(hotFolder.GetDefaultOutputFolder().utf8_str());
    const std::string log = scratch.File("serve-err.txt");
    testkit::BackgroundProgram service;
    service.pid = testkit::StartProgram({HF_HOTFOLDER_EXE, "serve"}, "", log);
    PumpUntil([] { return ReadServiceState() == ServiceState::Running; }, 10000);
    const std::string eps = testkit::ReadFile(HF_EXAMPLE_EPS);
    std::vector<double> toOutput, toRow;
    for (int i = 0; i < drops; ++i)
    {
        const std::string stem = "drop-" + std::to_string(i);
        const std::string temp = folders[0] + "/." + stem + ".part";
        testkit::WriteFile(temp, eps);
        const auto start = Clock::now();
        rename(temp.c_str(), (folders[0] + "/" + stem + ".eps").c_str());
        double outputMs = -1;
        const bool shown = PumpUntil(
            [&]
            {
                if (outputMs < 0 && OutputOf(outputFolder, stem))
                    outputMs =
                        std::chrono::duration<double, std::milli>(Clock::now() - start).count();
                return Shows(*frame, stem + ".eps");
            },
            20000);
        if (!shown || outputMs < 0)
        {
            std::printf("drop %d: %s\n", i, shown ? "no output seen" : "no row within 20 s");
            continue;
        }
        toOutput.push_back(outputMs);
        toRow.push_back(std::chrono::duration<double, std::milli>(Clock::now() - start).count());
    }
    std::printf("arrival to output %.1f ms, arrival to row %.1f ms (medians of %zu drops)\n",
                Median(toOutput), Median(toRow), toRow.size());
    std::printf("ratio arrival_to_row/1000_ms %.3f (target < 1)\n", Median(toRow) / 1000.0);
    std::printf("ratio arrival_to_row/arrival_to_output %.3f\n",
                Median(toRow) / std::max(Median(toOutput), 0.001));
    frame->Destroy();
    PumpUntil([] { return false; }, 100);
    wxEntryCleanup();
    return toRow.size() == static_cast<size_t>(drops) && listed ? 0 : 1;
}
