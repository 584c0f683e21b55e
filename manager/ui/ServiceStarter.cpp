#include "ui/ServiceStarter.h"

#include <fcntl.h>
#include <unistd.h>

#include "core/ServiceControl.h"

ServiceStarter::ServiceStarter(wxEvtHandler& receiver, Done done)
    : m_receiver(receiver), m_done(std::move(done))
{
    int ends[2];
    if (pipe2(ends, O_CLOEXEC | O_NONBLOCK) == 0)
    {
        m_stopRead.Reset(ends[0]);
        m_stopWrite.Reset(ends[1]);
    }
    m_thread = std::thread(&ServiceStarter::Run, this);
}

ServiceStarter::~ServiceStarter()
{
    {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_leaving = true;
    }
    m_stopWrite.Reset();
    m_thread.join();
}

void ServiceStarter::Run()
{
    wxString error;
    const bool started = StartService(error, m_stopRead.Get());
    std::lock_guard<std::mutex> lock(m_mutex);
    if (m_leaving)
        return;
    // Copies of their own for the window's thread; the handler, not this
    // object, carries them, so done may end this object.
    m_receiver.CallAfter([done = m_done, started, error = error.Clone()] { done(started, error); });
}
