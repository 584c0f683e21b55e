#pragma once
#include <condition_variable>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

#include <wx/event.h>

#include "core/FolderRows.h"
#include "core/JobHistory.h"
#include "core/ServiceControl.h"

// One rescan: the service, the listed folders, and the recent jobs of the
// folder the user looks at (jobsFolder; none when it is empty).
struct StatusSnapshot
{
    ServiceState service = ServiceState::Stopped;
    std::vector<FolderRow> rows;
    wxString jobsFolder;
    std::vector<JobEntry> jobs;
};

// Reads the status on its own thread, since a folder bound to a printer
// asks the scheduler, which may keep it waiting; the window stays answering.
// Each snapshot reaches `deliver` on the window's thread (through receiver's
// event queue). A request while a read runs is kept (only the newest) and
// served when that read ends. The destructor waits for a running read.
class StatusPoller
{
public:
    using Deliver = std::function<void(const StatusSnapshot&)>;
    StatusPoller(wxEvtHandler& receiver, Deliver deliver);
    ~StatusPoller();
    StatusPoller(const StatusPoller&) = delete;
    StatusPoller& operator=(const StatusPoller&) = delete;

    void Request(const wxString& jobsFolder);

    // How many jobs of a folder a snapshot holds.
    static constexpr size_t kJobsShown = 1000;

private:
    void Run();

    wxEvtHandler& m_receiver;
    Deliver m_deliver;
    std::mutex m_mutex;
    std::condition_variable m_wake;
    bool m_pending = false;
    bool m_stop = false;
    wxString m_folder;
    std::thread m_thread;
};
