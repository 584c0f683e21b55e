#pragma once
// Starts the service on a thread of its own: systemctl may take a minute and
// the service a few seconds to come up, and the window answers all the
// while. Going away ends the wait (the service may still come up) and joins
// at once, and nothing is reported after.
#include <functional>
#include <mutex>
#include <thread>

#include <wx/event.h>

#include "posix/UniqueFd.h"

class ServiceStarter
{
public:
    using Done = std::function<void(bool started, const wxString& error)>;
    // done runs on the window's thread, through receiver's event queue.
    ServiceStarter(wxEvtHandler& receiver, Done done);
    ~ServiceStarter();
    ServiceStarter(const ServiceStarter&) = delete;
    ServiceStarter& operator=(const ServiceStarter&) = delete;

private:
    void Run();

    wxEvtHandler& m_receiver;
    Done m_done;
    std::mutex m_mutex;
    bool m_leaving = false;
    posix::UniqueFd m_stopRead, m_stopWrite; // closing the write end ends the wait
    std::thread m_thread;
};
