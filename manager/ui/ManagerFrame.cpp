#include "ui/ManagerFrame.h"

#include <algorithm>

#include <wx/accel.h>
#include <wx/button.h>
#include <wx/msgdlg.h>
#include <wx/notifmsg.h>
#include <wx/panel.h>
#include <wx/sizer.h>
#include <wx/stattext.h>
#include <wx/utils.h>

#include "core/FolderSetup.h"
#include "posix/NativePath.h"
#include "ui/FolderColumns.h"
#include "ui/FolderDialog.h"
#include "ui/FolderDropTarget.h"
#include "ui/LiveList.h"
#include "ui/PreviewPanel.h"
#include "ui/ServiceBar.h"

namespace
{
const int kRescanMilliseconds = 500;

wxString JobKey(const JobEntry& job)
{
    return job.time.FormatISOCombined() + "|" + job.name;
}

wxButton* AddButton(wxWindow* parent, wxSizer* row, const wxString& label,
                    std::function<void()> action)
{
    auto* button = new wxButton(parent, wxID_ANY, label);
    button->Bind(wxEVT_BUTTON, [action](wxCommandEvent&) { action(); });
    row->Add(button, 0, wxRIGHT, 6);
    return button;
}
} // namespace

ManagerFrame::ManagerFrame(const wxString& modulePath)
    : wxFrame(nullptr, wxID_ANY, _("Hot folders"), wxDefaultPosition, wxSize(1180, 720)),
      m_modulePath(modulePath), m_timer(this)
{
    auto* root = new wxPanel(this);
    m_service = new ServiceBar(root, [this] { RescanNow(); });
    m_preview = new PreviewPanel(root, modulePath);
    wxWindow* folders = MakeFolderSide(root);

    auto* columns = new wxBoxSizer(wxHORIZONTAL);
    columns->Add(folders, 3, wxEXPAND | wxRIGHT, 10);
    columns->Add(m_preview, 1, wxEXPAND);
    auto* sizer = new wxBoxSizer(wxVERTICAL);
    sizer->Add(m_service, 0, wxEXPAND | wxALL, 10);
    sizer->Add(columns, 1, wxEXPAND | wxLEFT | wxRIGHT | wxBOTTOM, 10);
    root->SetSizer(sizer);
    m_preview->MoveAfterInTabOrder(folders);

    const int rescanId = wxWindow::NewControlId();
    wxAcceleratorEntry keys[] = {{wxACCEL_NORMAL, WXK_F5, rescanId}};
    SetAcceleratorTable(wxAcceleratorTable(1, keys));
    Bind(
        wxEVT_MENU, [this](wxCommandEvent&) { RescanNow(); }, rescanId);

    UpdateButtons();
    m_poller = std::make_unique<StatusPoller>(*this, [this](const StatusSnapshot& snapshot)
                                              { ShowSnapshot(snapshot); });
    Bind(wxEVT_TIMER, [this](wxTimerEvent&) { RescanNow(); });
    m_timer.Start(kRescanMilliseconds);
    RescanNow();
}

ManagerFrame::~ManagerFrame()
{
    m_timer.Stop();
    m_poller.reset();
}

wxWindow* ManagerFrame::MakeFolderSide(wxWindow* parent)
{
    auto* side = new wxPanel(parent);
    m_folders = new LiveList(side, FolderColumnHeadings());
    m_folders->SetDropTarget(new FolderDropTarget(
        *m_folders, [this](const wxString& problems)
        { CallAfter([this, problems] { ShowError(problems, _("Copy into the folder")); }); }));
    m_folders->Bind(wxEVT_LIST_ITEM_SELECTED, [this](wxListEvent&) { OnFolderSelected(); });
    m_folders->Bind(wxEVT_LIST_ITEM_DESELECTED, [this](wxListEvent&) { OnFolderSelected(); });
    m_folders->Bind(wxEVT_LIST_ITEM_ACTIVATED, [this](wxListEvent&) { EditSelectedFolder(); });
    m_folders->Bind(wxEVT_LIST_KEY_DOWN,
                    [this](wxListEvent& event)
                    {
                        if (event.GetKeyCode() == WXK_DELETE)
                            RemoveSelectedFolder();
                        else
                            event.Skip();
                    });
    auto* folderButtons = new wxBoxSizer(wxHORIZONTAL);
    AddButton(side, folderButtons, _(L"&Add…"), [this] { AddFolder(); });
    m_settings = AddButton(side, folderButtons, _(L"&Settings…"), [this] { EditSelectedFolder(); });
    m_remove = AddButton(side, folderButtons, _("&Remove"), [this] { RemoveSelectedFolder(); });

    m_jobs = new LiveList(side, JobColumnHeadings());
    m_jobs->Bind(wxEVT_LIST_ITEM_SELECTED, [this](wxListEvent&) { UpdateButtons(); });
    m_jobs->Bind(wxEVT_LIST_ITEM_DESELECTED, [this](wxListEvent&) { UpdateButtons(); });
    m_jobs->Bind(wxEVT_LIST_ITEM_ACTIVATED, [this](wxListEvent&) { ShowSelectedOutput(); });
    auto* jobButtons = new wxBoxSizer(wxHORIZONTAL);
    m_retry = AddButton(side, jobButtons, _("R&etry"), [this] { RetrySelectedJob(); });
    m_showOutput = AddButton(side, jobButtons, _("Show &output"), [this] { ShowSelectedOutput(); });
    m_openFolder = AddButton(side, jobButtons, _("Open &folder"), [this] { OpenSelectedFolder(); });

    auto* sizer = new wxBoxSizer(wxVERTICAL);
    sizer->Add(new wxStaticText(side, wxID_ANY, _("Hot folders (drop files on a row to add them)")),
               0, wxBOTTOM, 4);
    sizer->Add(m_folders, 3, wxEXPAND);
    sizer->Add(folderButtons, 0, wxTOP | wxBOTTOM, 6);
    sizer->Add(new wxStaticText(side, wxID_ANY, _("Recent jobs of the selected folder")), 0,
               wxTOP | wxBOTTOM, 4);
    sizer->Add(m_jobs, 2, wxEXPAND);
    sizer->Add(jobButtons, 0, wxTOP, 6);
    side->SetSizer(sizer);
    return side;
}

void ManagerFrame::RescanNow()
{
    m_poller->Request(SelectedFolder());
}

wxString ManagerFrame::SelectedFolder() const
{
    return m_folders->SelectedKey();
}

void ManagerFrame::ShowSnapshot(const StatusSnapshot& snapshot)
{
    ++m_rescans;
    m_service->ShowState(snapshot.service);
    m_rows = snapshot.rows;
    std::vector<std::vector<wxString>> texts;
    std::vector<wxString> keys;
    for (const FolderRow& row : m_rows)
    {
        texts.push_back(FolderColumnTexts(row));
        keys.push_back(row.path);
    }
    m_folders->ShowRows(texts, keys);
    if (!m_selectWhenListed.empty() &&
        std::find(keys.begin(), keys.end(), m_selectWhenListed) != keys.end())
    {
        m_folders->SelectKey(m_selectWhenListed);
        m_selectWhenListed.clear();
    }
    ShowJobs(snapshot);
    for (const Notice& notice : m_notices.Update(m_rows))
    {
        if (m_noticeSink)
        {
            m_noticeSink(notice);
            continue;
        }
        wxNotificationMessage message(notice.title, notice.message, this);
        message.Show();
    }
    UpdateButtons();
}

void ManagerFrame::ShowJobs(const StatusSnapshot& snapshot)
{
    if (snapshot.jobsFolder != SelectedFolder())
        return; // read for a folder no longer selected: the next rescan brings the right one
    m_shownJobs = snapshot.jobs;
    std::vector<std::vector<wxString>> texts;
    std::vector<wxString> keys;
    const wxDateTime now = wxDateTime::Now();
    for (const JobEntry& job : m_shownJobs)
    {
        texts.push_back(JobColumnTexts(job, now));
        keys.push_back(JobKey(job));
    }
    m_jobs->ShowRows(texts, keys);
}

void ManagerFrame::OnFolderSelected()
{
    const wxString folder = SelectedFolder();
    m_preview->SetFolder(folder);
    m_shownJobs.clear();
    m_jobs->ShowRows({}, {});
    UpdateButtons();
    RescanNow();
}

void ManagerFrame::UpdateButtons()
{
    const bool folder = !SelectedFolder().empty();
    const JobEntry* job = SelectedJob();
    m_settings->Enable(folder);
    m_remove->Enable(folder);
    m_openFolder->Enable(folder);
    m_retry->Enable(job && job->retryable);
    m_showOutput->Enable(job && !job->output.empty());
}

const JobEntry* ManagerFrame::SelectedJob() const
{
    const long index = m_jobs->SelectedIndex();
    return index >= 0 && index < static_cast<long>(m_shownJobs.size()) ? &m_shownJobs[index]
                                                                       : nullptr;
}

void ManagerFrame::ShowError(const wxString& message, const wxString& title)
{
    wxMessageBox(message, title, wxOK | wxICON_ERROR, this);
}

void ManagerFrame::AddFolder()
{
    FolderDialog dialog(this, m_modulePath);
    if (dialog.ShowModal() != wxID_OK)
        return;
    m_selectWhenListed = dialog.Folder(); // listed by the next rescan
    RescanNow();
}

void ManagerFrame::EditSelectedFolder()
{
    const long index = m_folders->SelectedIndex();
    if (index < 0 || index >= static_cast<long>(m_rows.size()))
        return;
    const FolderRow row = m_rows[static_cast<size_t>(index)];
    FolderDialog dialog(this, m_modulePath, row.path, row.name);
    if (dialog.ShowModal() == wxID_OK)
        RescanNow();
}

void ManagerFrame::RemoveSelectedFolder()
{
    const wxString folder = SelectedFolder();
    if (folder.empty())
        return;
    wxMessageDialog confirm(
        this,
        wxString::Format(_("Remove %s from the hot folders?\nThe folder and its files stay where "
                           "they are; the service stops watching it."),
                         posix::ShownLine(folder)),
        _("Remove hot folder"), wxYES_NO | wxNO_DEFAULT | wxICON_QUESTION);
    if (confirm.ShowModal() != wxID_YES)
        return;
    wxString error;
    if (!RemoveFolderFromList(folder, error))
        ShowError(error, _("Remove hot folder"));
    RescanNow();
}

void ManagerFrame::RetrySelectedJob()
{
    const JobEntry* job = SelectedJob();
    wxString error;
    if (job && !RetryJob(SelectedFolder(), *job, error))
        ShowError(error, _("Retry"));
    RescanNow();
}

void ManagerFrame::ShowSelectedOutput()
{
    const JobEntry* job = SelectedJob();
    if (job && !job->output.empty())
        m_preview->ShowOutput(job->output,
                              wxString::Format(_("Output of %s"), posix::ShownLine(job->name)));
}

void ManagerFrame::OpenSelectedFolder()
{
    const wxString folder = SelectedFolder();
    if (folder.empty())
        return;
    const wxScopedCharBuffer path = folder.utf8_str();
    const char* argv[] = {"xdg-open", path.data(), nullptr};
    if (wxExecute(argv, wxEXEC_ASYNC) <= 0)
        ShowError(_("The folder cannot be opened: xdg-open is missing."), _("Open folder"));
}
