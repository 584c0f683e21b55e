#pragma once
// Renders previews one at a time on its own thread, so that the window
// never waits for Ghostscript or for a conversion. Only the newest request
// matters: a newer request supersedes an older one not yet done, whose
// Ghostscript is stopped and whose done is never called.
#include <condition_variable>
#include <functional>
#include <memory>
#include <mutex>
#include <thread>

#include "posix/UniqueFd.h"
#include "preview/PagePreview.h"

struct PreviewRequest
{
    wxString postscript;
    PreviewOptions options;
    // Runs on the worker before rendering, e.g. to make postscript; false
    // ends the request with the reason as the page's reason. It cannot be
    // stopped: a newer request waits for it, then its page is dropped.
    std::function<bool(wxString& reason)> prepare;
    // postscript is a scratch file of the request's own: removed once the
    // request is done with it, superseded or dropped by a closing worker.
    bool removeAfter = false;
};

class PreviewWorker
{
public:
    using Done = std::function<void(const PagePreview&)>; // called on the worker thread

    PreviewWorker();
    // Stops a running Ghostscript and joins (after a running prepare ends);
    // no done is called after.
    ~PreviewWorker();
    PreviewWorker(const PreviewWorker&) = delete;
    PreviewWorker& operator=(const PreviewWorker&) = delete;

    void Request(const wxString& postscript, const PreviewOptions& options, Done done);
    void Request(PreviewRequest request, Done done);

private:
    struct Job
    {
        PreviewRequest request;
        Done done;
        ~Job() { RemoveScratch(); }
        void RemoveScratch();
    };
    void Run();
    bool Superseded() const { return m_quit || m_pending; } // with m_mutex held
    void SignalStop();                                      // with m_mutex held
    void DrainStop();                                       // with m_mutex held

    std::mutex m_mutex;
    std::condition_variable m_wake;
    std::unique_ptr<Job> m_pending;
    bool m_busy = false;
    bool m_quit = false;
    posix::UniqueFd m_stopRead, m_stopWrite; // a byte written stops the running Ghostscript
    std::thread m_thread;
};
