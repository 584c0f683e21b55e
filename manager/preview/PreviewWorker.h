#pragma once
// Renders previews one at a time on its own thread, so that the window
// never waits for Ghostscript. Only the newest request matters: a newer
// request supersedes an older one not yet done, whose Ghostscript is
// stopped and whose done is never called.
#include <condition_variable>
#include <functional>
#include <memory>
#include <mutex>
#include <thread>

#include "posix/UniqueFd.h"
#include "preview/PagePreview.h"

class PreviewWorker
{
public:
    using Done = std::function<void(const PagePreview&)>; // called on the worker thread

    PreviewWorker();
    // Stops a running Ghostscript and joins at once; no done is called after.
    ~PreviewWorker();
    PreviewWorker(const PreviewWorker&) = delete;
    PreviewWorker& operator=(const PreviewWorker&) = delete;

    void Request(const wxString& postscript, const PreviewOptions& options, Done done);

private:
    struct Job
    {
        wxString postscript;
        PreviewOptions options;
        Done done;
    };
    void Run();
    void SignalStop(); // with m_mutex held
    void DrainStop();  // with m_mutex held

    std::mutex m_mutex;
    std::condition_variable m_wake;
    std::unique_ptr<Job> m_pending;
    bool m_busy = false;
    bool m_quit = false;
    posix::UniqueFd m_stopRead, m_stopWrite; // a byte written stops the running Ghostscript
    std::thread m_thread;
};
