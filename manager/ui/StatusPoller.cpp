#include "ui/StatusPoller.h"

StatusPoller::StatusPoller(wxEvtHandler& receiver, Deliver deliver)
    : m_receiver(receiver), m_deliver(std::move(deliver)), m_thread([this] { Run(); })
{
}

StatusPoller::~StatusPoller()
{
    {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_stop = true;
    }
    m_wake.notify_one();
    m_thread.join();
}

void StatusPoller::Request(const wxString& jobsFolder)
{
    {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_pending = true;
        m_folder = jobsFolder.Clone(); // this thread's string never reaches the other one
    }
    m_wake.notify_one();
}

void StatusPoller::Run()
{
    for (;;)
    {
        wxString folder;
        {
            std::unique_lock<std::mutex> lock(m_mutex);
            m_wake.wait(lock, [this] { return m_pending || m_stop; });
            if (m_stop)
                return;
            m_pending = false;
            folder = m_folder.Clone();
        }
        StatusSnapshot snapshot;
        snapshot.service = ReadServiceState();
        snapshot.rows = ReadFolderRows();
        snapshot.jobsFolder = folder;
        if (!folder.empty())
            snapshot.jobs = ReadRecentJobs(folder, kJobsShown);
        m_receiver.CallAfter([this, snapshot] { m_deliver(snapshot); });
    }
}
