// Renders the manager's window (two folders of a scratch warehouse, one
// printing on a queue of a scheduler of its own with the service running,
// one output only, and a printed job's page) and its folder dialog to PNG
// files for the documentation (scripts/screenshots.sh).
// Usage: manager_screenshots <dir> <en|de>
#include <clocale>
#include <cstdio>
#include <memory>

#include <wx/app.h>
#include <wx/dcmemory.h>
#include <wx/dcscreen.h>
#include <wx/image.h>
#include <wx/stopwatch.h>
#include <wx/timer.h>

#include <hotfolder/HFTranslations.h>

#include "GermanClient.h"
#include "PrivateCupsd.h"
#include "TestKit.h"
#include "ui/FolderDialog.h"
#include "ui/LiveList.h"
#include "ui/ManagerFrame.h"
#include "ui/PreviewPanel.h"

namespace
{
const std::string kExamples = HF_SOURCE_DIR "/examples";

testkit::ScratchDir& Scratch()
{
    static testkit::ScratchDir scratch("hf-manager-shots");
    return scratch;
}

bool Host(const std::vector<std::string>& args)
{
    std::vector<std::string> command{HF_HOTFOLDER_EXE};
    command.insert(command.end(), args.begin(), args.end());
    return testkit::RunProgram(command).exitCode == 0;
}

// A scheduler of the pictures' own with one queue printing into a file,
// and the service running over the warehouse: what an operator sees.
struct Machine
{
    std::unique_ptr<cups_test::PrivateCupsd> cups;
    testkit::BackgroundProgram service; // ended before the scheduler
};

bool StartMachine(Machine& machine)
{
    std::string problem;
    machine.cups = cups_test::PrivateCupsd::StartWithQueue(
        Scratch().Path(), "office", HF_TEST_DATA_DIR "/ppd/test-postscript.ppd",
        Scratch().File("printed.ps"), problem);
    if (!machine.cups)
    {
        std::fprintf(stderr, "manager_screenshots: %s\n", problem.c_str());
        return false;
    }
    machine.service.pid = testkit::StartProgram({HF_HOTFOLDER_EXE, "serve"}, "/dev/null",
                                                Scratch().File("serve.txt"));
    return machine.service.pid > 0;
}

// Two folders, the first printing on the scheduler's queue, the second
// keeping EPS outputs.
bool MakeFolders(std::string& posters)
{
    posters = Scratch().Sub("Posters");
    const std::string proofs = Scratch().Sub("Proofs");
    return Host({"init", posters, "--printer", "office", "--name", "Posters A4"}) &&
           Host({"settings", posters, "--set", "OUTPUTFILETYPEEPS=0", "OUTPUTFILETYPEPS=1",
                 "DEFAULTPAGESIZE=A4"}) &&
           Host({"init", proofs, "--name", "Proofs"});
}

// Drops the example label into the folder the way a file manager's copy
// lands: written aside, then renamed in.
bool DropLabel(const std::string& folder)
{
    const std::string aside = folder + "/.label.eps.part";
    return testkit::WriteFile(aside, testkit::ReadFile(kExamples + "/eps/label.eps")) &&
           rename(aside.c_str(), (folder + "/label.eps").c_str()) == 0;
}

bool Wait(const std::function<bool()>& condition)
{
    for (wxStopWatch watch; !condition(); wxMilliSleep(10))
    {
        if (watch.Time() > 60000)
            return false;
        wxTheApp->ProcessPendingEvents();
        wxYield();
    }
    return true;
}

// The screen as it is now, cut to each window. The screen is read back in
// one snapshot: the screen device keeps the first picture it took.
bool Save(const std::vector<std::pair<wxWindow*, wxString>>& windows)
{
    for (int i = 0; i < 50; ++i, wxMilliSleep(10))
        wxYield();
    wxScreenDC screen;
    wxBitmap whole(screen.GetSize());
    wxMemoryDC memory(whole);
    memory.Blit(wxPoint(0, 0), screen.GetSize(), &screen, wxPoint(0, 0));
    memory.SelectObject(wxNullBitmap);
    bool saved = true;
    for (const auto& [window, file] : windows)
        saved =
            whole.GetSubBitmap(window->GetScreenRect()).SaveFile(file, wxBITMAP_TYPE_PNG) && saved;
    return saved;
}

class ScreenshotApp : public wxApp
{
public:
    bool OnInit() override
    {
        if (argc < 3)
            return false;
        const wxString prefix = argv[1] + "/manager", suffix = "-" + argv[2] + ".png";
        wxInitAllImageHandlers();
        std::setlocale(LC_MESSAGES, ""); // as the manager does
        HFTranslations::GetInstance()->SelectLanguage(argv[2]);
        std::string posters;
        if (!StartMachine(m_machine) || !MakeFolders(posters))
            return false;

        auto* frame = new ManagerFrame(HF_MODULE_PATH);
        frame->SetNoticeSink([](const Notice&) {});
        frame->SetSize(wxRect(0, 0, 1960, 680));
        frame->Show();
        const wxString folder = wxString::FromUTF8(posters);
        m_ok = Wait([&] { return frame->Folders().GetItemCount() == 2; });
        frame->Folders().SelectKey(folder);
        m_ok = m_ok && DropLabel(posters) &&
               Wait(
                   [&]
                   {
                       const auto& jobs = frame->ShownJobs();
                       return !jobs.empty() && jobs.front().outcome == JobOutcome::Printed;
                   });
        if (m_ok)
        {
            frame->Jobs().SelectKey(frame->Jobs().Keys().front());
            frame->ShowSelectedOutput();
        }
        m_ok = m_ok && Wait([&] { return frame->Preview().Delivered() > 0; });

        auto* dialog = new FolderDialog(frame, HF_MODULE_PATH, folder, "Posters A4");
        dialog->Move(frame->GetRect().GetRight() + 10, 0); // beside: nothing stacks them
        // A dialog is drawn for sure only inside its own modal loop.
        wxTimer timer;
        timer.Bind(wxEVT_TIMER,
                   [&](wxTimerEvent&)
                   {
                       m_ok = m_ok && Save({{frame, prefix + suffix},
                                            {dialog, prefix + "-folder-dialog" + suffix}});
                       dialog->EndModal(wxID_CANCEL);
                   });
        timer.StartOnce(500);
        dialog->ShowModal();
        dialog->Destroy();
        frame->Destroy();
        return true;
    }
    int OnRun() override { return m_ok ? 0 : 1; }

private:
    bool m_ok = false;
    Machine m_machine;
};
} // namespace

wxIMPLEMENT_APP_NO_MAIN(ScreenshotApp);

int main(int argc, char** argv)
{
    setenv("HOTFOLDER_WAREHOUSE_ROOT", Scratch().Sub("machine").c_str(), 1);
    if (argc >= 3 && std::string(argv[2]) == "de")
        UseGermanClientConfiguration();
    return wxEntry(argc, argv);
}
