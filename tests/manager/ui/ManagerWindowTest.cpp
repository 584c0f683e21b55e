// The manager's window over a scratch warehouse: the service bar, adding and
// changing folders through the dialog, drops, retries, the preview and its
// language, driven by the tables of tests/data/manager/ui-*.txt.
#include <sys/stat.h>

#include <wx/button.h>
#include <wx/checkbox.h>
#include <wx/filepicker.h>
#include <wx/radiobut.h>
#include <wx/stattext.h>
#include <wx/textctrl.h>
#include <wx/uiaction.h>

#include <hotfolder/HFTranslations.h>

#include "ManagerUiFixture.h"
#include "PrivateCupsd.h"
#include "db/PathResolver.h"
#include "ui/FolderDialog.h"
#include "ui/FolderDropTarget.h"
#include "ui/LiveList.h"
#include "ui/PreviewCanvas.h"
#include "ui/PreviewPanel.h"
#include "ui/PrinterChoiceCtrl.h"
#include "ui/ServiceBar.h"

using namespace manager_test;
using namespace host_test;
using testkit::Cases;

namespace
{
const std::string kData = HF_TEST_DATA_DIR;

// Every label the window shows: buttons, texts and column headings.
void CollectLabels(wxWindow* window, std::set<std::string>& labels)
{
    // dynamic_cast: the toolkit's cast converts before it checks, which the
    // undefined-behaviour sanitizer reports for every other kind of window.
    if (dynamic_cast<wxButton*>(window) || dynamic_cast<wxStaticText*>(window))
        labels.insert(window->GetLabel().utf8_string());
    if (auto* list = dynamic_cast<wxListCtrl*>(window))
        for (int column = 0; column < list->GetColumnCount(); ++column)
        {
            wxListItem heading;
            heading.SetMask(wxLIST_MASK_TEXT);
            list->GetColumn(column, heading);
            labels.insert(heading.GetText().utf8_string());
        }
    for (wxWindow* child : window->GetChildren())
        CollectLabels(child, labels);
}
// Gives the window (or the part of it that takes keys) the keyboard focus for real.
bool GiveFocus(wxWindow& window)
{
    window.SetFocus();
    return PumpUntil(
        [&]
        {
            const wxWindow* focus = wxWindow::FindFocus();
            return focus && (focus == &window || focus->GetParent() == &window);
        },
        5000);
}
} // namespace

class ManagerWindow : public ManagerTest
{
protected:
    // The row of a folder in the window's list; -1 when it is not shown.
    long RowOf(const std::string& folder)
    {
        const auto& keys = Frame().Folders().Keys();
        const auto found = std::find(keys.begin(), keys.end(), wxString::FromUTF8(folder));
        return found == keys.end() ? -1 : found - keys.begin();
    }
    // Drops files on the folder's row as the toolkit does.
    bool Drop(const std::string& folder, const std::vector<std::string>& files)
    {
        EXPECT_TRUE(PumpUntil([&] { return RowOf(folder) >= 0; })) << folder;
        wxRect row;
        Frame().Folders().GetItemRect(RowOf(folder), row);
        wxArrayString names;
        for (const std::string& file : files)
            names.Add(wxString::FromUTF8(file));
        auto* target = static_cast<FolderDropTarget*>(Frame().Folders().GetDropTarget());
        const wxPoint inside = row.GetTopLeft() + wxPoint(4, row.height / 2);
        return target->OnDropFiles(inside.x, inside.y, names);
    }
    // Waits until the selected folder's jobs list holds a job of that name
    // with that outcome.
    bool JobShown(const std::string& name, const std::string& outcome)
    {
        return PumpUntil(
            [&]
            {
                for (long row = 0; row < Frame().Jobs().GetItemCount(); ++row)
                    if (Cell(Frame().Jobs(), row, 1) == name &&
                        Cell(Frame().Jobs(), row, 2) == outcome)
                        return true;
                return false;
            },
            60000);
    }
    // A scheduler of the test's own, named by CUPS_SERVER for the window and
    // the programs it starts, with the queue "office" printing into a file.
    void StartScheduler(std::unique_ptr<cups_test::PrivateCupsd>& cups)
    {
        std::string problem;
        cups = cups_test::PrivateCupsd::StartWithQueue(
            scratch, "office", kData + "/ppd/test-postscript.ppd", scratch + "/device.ps", problem);
        ASSERT_TRUE(cups) << problem;
    }
    void Select(const std::string& folder)
    {
        ASSERT_TRUE(PumpUntil([&] { return RowOf(folder) >= 0; })) << folder;
        Frame().Folders().SelectKey(wxString::FromUTF8(folder));
        ASSERT_EQ(wxString::FromUTF8(folder), Frame().SelectedFolder());
    }
};

TEST_F(ManagerWindow, ALiveListKeepsTheSelectedRowAcrossRescans)
{
    auto rows = [](const std::string& keys, std::vector<std::vector<wxString>>& texts)
    {
        std::vector<wxString> list;
        texts.clear();
        for (const std::string& key :
             keys == "-" ? testkit::CaseFields{} : testkit::Split(keys, ","))
        {
            list.push_back(key);
            texts.push_back({key, "cell of " + key});
        }
        return list;
    };
    for (const auto& c : Cases("manager/ui-live-list.txt", 4, 6))
    {
        SCOPED_TRACE(c[0] + " | " + c[1] + " | " + c[2]);
        auto* list = new LiveList(&Frame(), {"key", "text"});
        std::vector<std::vector<wxString>> texts;
        std::vector<wxString> keys = rows(c[0], texts);
        list->ShowRows(texts, keys);
        if (c[1] != "-")
            list->SelectKey(c[1]);
        keys = rows(c[2], texts);
        list->ShowRows(texts, keys);
        EXPECT_EQ(c[3] == "-" ? "" : c[3], list->SelectedKey().utf8_string());
        EXPECT_EQ(c[3] == "-" ? -1 : std::find(keys.begin(), keys.end(), c[3]) - keys.begin(),
                  list->SelectedIndex());
        ASSERT_EQ(static_cast<int>(keys.size()), list->GetItemCount());
        for (size_t row = 0; row < keys.size(); ++row)
            EXPECT_EQ("cell of " + keys[row], list->GetItemText(static_cast<long>(row), 1));
        list->Destroy();
    }
}

TEST_F(ManagerWindow, ServiceBarFollowsTheService)
{
    std::unique_ptr<host_test::BackgroundHost> service;
    for (const auto& step : Cases("manager/ui-service-bar.txt", 3, 4))
    {
        SCOPED_TRACE(step[0] + " -> " + step[1]);
        wxButton& button = Frame().Service().ActionButton();
        if (step[0] == "serve")
            service = std::make_unique<host_test::BackgroundHost>(std::vector<std::string>{"serve"},
                                                                  scratch);
        else if (step[0] == "end")
            service.reset();
        else if (step[0] == "marker")
            WriteFile(db::PathResolver::GetStopAllHFFilePath().GetFullPath().utf8_string(), "");
        else if (step[0] == "click") // a real click where the button is
        {
            wxUIActionSimulator user;
            user.MouseMove(button.GetScreenRect().GetPosition() + button.GetSize() / 2);
            user.MouseClick();
        }
        const ServiceState expected = step[1] == "running"  ? ServiceState::Running
                                      : step[1] == "paused" ? ServiceState::Paused
                                                            : ServiceState::Stopped;
        EXPECT_TRUE(PumpUntil([&] { return Frame().Service().State() == expected; }))
            << service->Err();
        EXPECT_EQ(step[2], button.GetLabel().utf8_string());
    }
}

TEST_F(ManagerWindow, ShowsGermanTextsUnderAGermanLanguage)
{
    ASSERT_TRUE(HFTranslations::GetInstance()->SelectLanguage("de"));
    std::set<std::string> labels;
    CollectLabels(&Frame(), labels);
    // The status code's English words in a folder's row read German too.
    const std::string folder = scratch + "/Proofs";
    ASSERT_EQ(0, Host({"init", folder}).exitCode);
    EXPECT_TRUE(PumpUntil([&] { return RowOf(folder) >= 0; }));
    const std::string outputType =
        RowOf(folder) >= 0 ? Cell(Frame().Folders(), RowOf(folder), 4) : "";
    HFTranslations::GetInstance()->SelectLanguage("en");
    for (const auto& text : Cases("manager/ui-german.txt", 2, 5))
    {
        EXPECT_EQ(1u, labels.count(text[0])) << text[0];
        EXPECT_EQ(0u, labels.count(text[1])) << text[1];
    }
    EXPECT_EQ("EPS (unverändert weitergegeben)", outputType);
}

TEST_F(ManagerWindow, AddsFoldersBoundAsChosenAndStoresThePanelsSettings)
{
    std::unique_ptr<cups_test::PrivateCupsd> cups;
    ASSERT_NO_FATAL_FAILURE(StartScheduler(cups));
    // printer | its value | the file binding it in the container | a control of
    // the panel clicked | the setting Folder.cfg then holds
    for (const auto& c : Cases("manager/ui-add-folder.txt", 5, 3))
    {
        SCOPED_TRACE(c[0] + " " + c[1]);
        const std::string folder = scratch + "/added-" + c[0] + "-" + c[3];
        auto* dialog = new FolderDialog(&Frame(), HF_MODULE_PATH);
        dialog->FolderPicker().SetPath(folder);
        dialog->NameField().ChangeValue("Added " + c[0] + " " + c[3]);
        PrinterChoice choice;
        choice.kind = c[0] == "queue" ? PrinterChoice::Kind::Queue
                      : c[0] == "ppd" ? PrinterChoice::Kind::PpdFile
                                      : PrinterChoice::Kind::None;
        choice.value = c[0] == "ppd" ? kData + "/" + c[1] : c[1];
        dialog->Printer().SetValue(choice);
        dialog->RebuildFilterPanel();
        ASSERT_NE(nullptr, dialog->FilterPanel());
        if (c[3] != "-")
        {
            auto* radio =
                dynamic_cast<wxRadioButton*>(dialog->FilterPanel()->FindWindow(std::stoi(c[3])));
            ASSERT_NE(nullptr, radio) << c[3];
            radio->SetValue(true);
            wxCommandEvent clicked(wxEVT_RADIOBUTTON, radio->GetId());
            clicked.SetEventObject(radio);
            clicked.SetInt(1);
            radio->HandleWindowEvent(clicked);
        }
        EXPECT_TRUE(dialog->Accept());
        dialog->Destroy();
        if (c[2] != "-")
        {
            EXPECT_TRUE(Exists(Container(folder) + "/" + c[2]));
        }
        const auto shown = Host({"settings", folder, "--show"});
        EXPECT_TRUE(c[4] == "-" || shown.out.find(c[4] + "  #") != std::string::npos)
            << shown.out << shown.err;
        ASSERT_TRUE(PumpUntil([&] { return RowOf(folder) >= 0; }));
        EXPECT_EQ("Added " + c[0] + " " + c[3], Cell(Frame().Folders(), RowOf(folder), 0));
    }
    unsetenv("CUPS_SERVER");
}

TEST_F(ManagerWindow, AFileDroppedOnAPrintingFolderIsShownPrinted)
{
    std::unique_ptr<cups_test::PrivateCupsd> cups;
    ASSERT_NO_FATAL_FAILURE(StartScheduler(cups));
    const std::string folder = scratch + "/Office";
    ASSERT_EQ(0, Host({"init", folder, "--printer", "office"}).exitCode);
    auto service =
        std::make_unique<host_test::BackgroundHost>(std::vector<std::string>{"serve"}, scratch);
    Select(folder);
    ASSERT_TRUE(Drop(folder, {kExamples + "/eps/label.eps"}));
    EXPECT_TRUE(JobShown("label.eps", "printed")) << service->Err();
    // The folder's row counts it and says what the scheduler says of its queue.
    EXPECT_TRUE(PumpUntil([&] { return Cell(Frame().Folders(), RowOf(folder), 8) == "1"; }));
    EXPECT_EQ("office", Cell(Frame().Folders(), RowOf(folder), 2));
    EXPECT_FALSE(Cell(Frame().Folders(), RowOf(folder), 9).empty());
    unsetenv("CUPS_SERVER");
}

// Answers the folder dialog as a user who picks a folder and presses OK.
class AddFolderAs : public wxExpectModalBase<FolderDialog>
{
public:
    explicit AddFolderAs(const std::string& folder) : m_folder(folder) {}

protected:
    int OnInvoked(FolderDialog* dialog) const override
    {
        dialog->FolderPicker().SetPath(wxString::FromUTF8(m_folder));
        return dialog->Accept() ? wxID_OK : wxID_CANCEL;
    }

private:
    std::string m_folder;
};

TEST_F(ManagerWindow, AFolderAddedThroughTheWindowIsListedAndSelected)
{
    const std::string folder = scratch + "/new/Proofs";
    wxTEST_DIALOG(Frame().AddFolder(), AddFolderAs(folder));
    EXPECT_TRUE(PumpUntil([&] { return Frame().SelectedFolder() == wxString::FromUTF8(folder); }));
    EXPECT_EQ("Proofs", Cell(Frame().Folders(), RowOf(folder), 0)); // the folder's own name
}

TEST_F(ManagerWindow, DroppedFilesBecomeJobsAndAFailedOneCanBeRetried)
{
    const std::string folder = MakePostScriptFolder();
    auto service =
        std::make_unique<host_test::BackgroundHost>(std::vector<std::string>{"serve"}, scratch);
    Select(folder);
    ASSERT_TRUE(Drop(folder, {kExamples + "/eps/label.eps"}));
    EXPECT_TRUE(JobShown("label.eps", "done")) << service->Err();
    // Taken for EPS, but its bounding box is no box: the job fails.
    WriteFile(scratch + "/no-box.eps", "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 nan 792\n");
    ASSERT_TRUE(Drop(folder, {scratch + "/no-box.eps"}));
    ASSERT_TRUE(JobShown("no-box.eps", "failed")) << service->Err();
    // One desktop notice for the failure, however often the window rescans.
    EXPECT_TRUE(Rescanned());
    ASSERT_EQ(1u, notices.size());
    EXPECT_NE(wxNOT_FOUND, notices[0].title.Find("hot"));

    // Paused, the retried original waits in the folder where the list shows it.
    WriteFile(db::PathResolver::GetStopAllHFFilePath().GetFullPath().utf8_string(), "");
    ASSERT_TRUE(PumpUntil([&] { return Frame().Service().State() == ServiceState::Paused; }));
    const auto& jobs = Frame().ShownJobs();
    const auto failed = std::find_if(jobs.begin(), jobs.end(),
                                     [](const JobEntry& job) { return job.name == "no-box.eps"; });
    ASSERT_NE(jobs.end(), failed);
    EXPECT_TRUE(failed->retryable);
    Frame().Jobs().SelectKey(Frame().Jobs().Keys()[failed - jobs.begin()]);
    Frame().RetrySelectedJob();
    EXPECT_TRUE(Exists(folder + "/no-box.eps"));
    EXPECT_TRUE(PumpUntil([&] { return Cell(Frame().Folders(), RowOf(folder), 5) == "1"; }));

    // A drop beside the rows copies nothing and says so.
    wxTEST_DIALOG(
        {
            auto* target = static_cast<FolderDropTarget*>(Frame().Folders().GetDropTarget());
            EXPECT_FALSE(target->OnDropFiles(2, Frame().Folders().GetClientSize().y - 2,
                                             wxArrayString(1, kExamples + "/eps/tiny.eps")));
            wxTheApp->ProcessPendingEvents();
        },
        wxExpectModal<wxMessageDialog>(wxID_OK));
    EXPECT_FALSE(Exists(folder + "/tiny.eps"));
}

TEST_F(ManagerWindow, PreviewShowsTheArtWhereGhostscriptFindsTheMarks)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "no Ghostscript";
    const std::string folder = MakePostScriptFolder();
    auto service =
        std::make_unique<host_test::BackgroundHost>(std::vector<std::string>{"serve"}, scratch);
    Select(folder);
    ASSERT_TRUE(Drop(folder, {kExamples + "/eps/label.eps"}));
    ASSERT_TRUE(JobShown("label.eps", "done")) << service->Err();
    ASSERT_FALSE(Frame().ShownJobs().front().output.empty());
    Frame().Jobs().SelectKey(Frame().Jobs().Keys().front());
    Frame().ShowSelectedOutput();
    PreviewCanvas& canvas = Frame().Preview().Canvas();
    ASSERT_TRUE(PumpUntil([&] { return Frame().Preview().Delivered() > 0; }, 60000));
    ASSERT_TRUE(canvas.Page().ok) << canvas.Page().reason;
    ASSERT_FALSE(canvas.Page().marks.IsEmpty());

    const wxSize size(300, 420);
    const wxImage drawn = canvas.Render(size).ConvertToImage();
    const wxRect marks = canvas.PixelsOf(canvas.Page().marks, size);
    const wxRect page =
        canvas.PixelsOf({0, 0, canvas.Page().pageWidth, canvas.Page().pageHeight}, size);
    auto dark = [&](int x, int y)
    { return drawn.GetRed(x, y) + drawn.GetGreen(x, y) + drawn.GetBlue(x, y) < 600; };
    int inside = 0, outside = 0;
    for (int y = page.y + 4; y < page.GetBottom() - 4; ++y)
        for (int x = page.x + 4; x < page.GetRight() - 4; ++x)
            if (dark(x, y))
                (marks.Contains(x, y) ? inside : outside) += 1;
    EXPECT_GT(inside, 0);
    // Outside the marks only the imageable area's dashed outline is drawn.
    const wxRect imageable = canvas.PixelsOf(canvas.Page().imageable, size);
    EXPECT_LE(outside, 2 * (imageable.width + imageable.height) + 8);

    // A file tried with the folder's settings shows its page; the folder
    // gets no new job.
    const size_t delivered = Frame().Preview().Delivered();
    const auto outputs = ListDirectory(folder + "/Output"), entries = ListDirectory(folder);
    ASSERT_TRUE(Frame().Preview().TryFileNamed(kExamples + "/eps/banner-landscape.eps"));
    ASSERT_TRUE(PumpUntil([&] { return Frame().Preview().Delivered() > delivered; }, 60000));
    EXPECT_TRUE(canvas.Page().ok) << canvas.Page().reason;
    EXPECT_FALSE(canvas.Page().marks.IsEmpty());
    EXPECT_EQ(outputs, ListDirectory(folder + "/Output"));
    EXPECT_EQ(entries, ListDirectory(folder));
}

TEST_F(ManagerWindow, DeleteKeyRemovesTheFolderFromTheListButKeepsItsFiles)
{
    const std::string folder = MakePostScriptFolder();
    Select(folder);
    ASSERT_TRUE(GiveFocus(Frame().Folders()));
    wxTEST_DIALOG(
        {
            wxUIActionSimulator user;
            user.Char(WXK_DELETE);
            PumpUntil([&] { return RowOf(folder) < 0; }, 5000);
        },
        wxExpectModal<wxMessageDialog>(wxID_YES));
    EXPECT_TRUE(Rescanned());
    EXPECT_EQ(-1, RowOf(folder));
    EXPECT_TRUE(Exists(Container(folder) + "/Folder.cfg"));
}

TEST_F(ManagerWindow, AMissingOrHangingGhostscriptNeverHoldsTheWindow)
{
    const std::string sleeper = scratch + "/sleeping-gs";
    WriteFile(sleeper, "#!/bin/sh\nexec sleep 600\n");
    chmod(sleeper.c_str(), 0755);
    for (const auto& c : Cases("manager/ui-ghostscript.txt", 2, 2))
    {
        SCOPED_TRACE(c[0]);
        setenv("HOTFOLDER_GHOSTSCRIPT", (c[0] == "hanging" ? sleeper : c[1]).c_str(), 1);
        const size_t delivered = Frame().Preview().Delivered();
        Frame().Preview().ShowOutput(kExamples + "/eps/label.eps", "label");
        EXPECT_TRUE(Rescanned()); // the window still answers
        if (c[0] == "missing")
        {
            ASSERT_TRUE(PumpUntil([&] { return Frame().Preview().Delivered() > delivered; }));
            EXPECT_FALSE(Frame().Preview().Canvas().Page().ok);
            EXPECT_FALSE(Frame().Preview().Canvas().Page().reason.empty());
        }
        else
            EXPECT_EQ(delivered, Frame().Preview().Delivered());
    }
    unsetenv("HOTFOLDER_GHOSTSCRIPT");
}
