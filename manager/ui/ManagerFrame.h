#pragma once
#include <functional>
#include <memory>
#include <vector>

#include <wx/frame.h>
#include <wx/timer.h>

#include "core/JobHistory.h"
#include "core/NoticeTracker.h"
#include "ui/StatusPoller.h"

class LiveList;
class PreviewPanel;
class ServiceBar;
class wxButton;

// The manager's window: the service bar, the machine's hot folders (live),
// the selected folder's recent jobs and, at the right, the preview of an
// output. Rescans run on the poller's thread twice a second.
class ManagerFrame : public wxFrame
{
public:
    explicit ManagerFrame(const wxString& modulePath);
    ~ManagerFrame() override;

    // Rescans now (F5) instead of at the next tick.
    void RescanNow();
    // A notice goes to the desktop unless something else takes it.
    void SetNoticeSink(std::function<void(const Notice&)> sink) { m_noticeSink = std::move(sink); }

    void AddFolder();
    void EditSelectedFolder();
    void RemoveSelectedFolder();
    void RetrySelectedJob();
    void ShowSelectedOutput();
    void OpenSelectedFolder();

    ServiceBar& Service() const { return *m_service; }
    LiveList& Folders() const { return *m_folders; }
    LiveList& Jobs() const { return *m_jobs; }
    PreviewPanel& Preview() const { return *m_preview; }
    wxString SelectedFolder() const;
    // Rescans shown so far.
    size_t Rescans() const { return m_rescans; }
    const std::vector<JobEntry>& ShownJobs() const { return m_shownJobs; }

private:
    wxWindow* MakeFolderSide(wxWindow* parent);
    void ShowSnapshot(const StatusSnapshot& snapshot);
    void ShowJobs(const StatusSnapshot& snapshot);
    void OnFolderSelected();
    void UpdateButtons();
    const JobEntry* SelectedJob() const;
    void ShowError(const wxString& message, const wxString& title);

    wxString m_modulePath;
    ServiceBar* m_service = nullptr;
    LiveList* m_folders = nullptr;
    LiveList* m_jobs = nullptr;
    PreviewPanel* m_preview = nullptr;
    wxButton* m_settings = nullptr;
    wxButton* m_remove = nullptr;
    wxButton* m_retry = nullptr;
    wxButton* m_showOutput = nullptr;
    wxButton* m_openFolder = nullptr;
    std::vector<FolderRow> m_rows;
    std::vector<JobEntry> m_shownJobs;
    NoticeTracker m_notices;
    std::function<void(const Notice&)> m_noticeSink;
    size_t m_rescans = 0;
    wxString m_selectWhenListed; // a folder just added
    wxTimer m_timer;
    // Joined before the window's parts go.
    std::unique_ptr<StatusPoller> m_poller;
};
