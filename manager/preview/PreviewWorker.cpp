#include "preview/PreviewWorker.h"

#include <fcntl.h>
#include <unistd.h>

#include "posix/NativePath.h"

PreviewWorker::PreviewWorker()
{
    int ends[2];
    if (pipe2(ends, O_CLOEXEC | O_NONBLOCK) == 0)
    {
        m_stopRead.Reset(ends[0]);
        m_stopWrite.Reset(ends[1]);
    }
    m_thread = std::thread(&PreviewWorker::Run, this);
}

PreviewWorker::~PreviewWorker()
{
    {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_quit = true;
        m_pending.reset();
        SignalStop();
    }
    m_wake.notify_all();
    m_thread.join();
}

void PreviewWorker::Request(const wxString& postscript, const PreviewOptions& options, Done done)
{
    PreviewRequest request;
    request.postscript = postscript;
    request.options = options;
    Request(std::move(request), std::move(done));
}

void PreviewWorker::Request(PreviewRequest request, Done done)
{
    {
        std::lock_guard<std::mutex> lock(m_mutex);
        m_pending.reset(new Job{std::move(request), std::move(done)});
        if (m_busy)
            SignalStop();
    }
    m_wake.notify_all();
}

void PreviewWorker::SignalStop()
{
    const char byte = 1;
    if (m_stopWrite) [[maybe_unused]]
        const ssize_t ignored = write(m_stopWrite.Get(), &byte, 1);
}

void PreviewWorker::DrainStop()
{
    char bytes[64];
    while (m_stopRead && read(m_stopRead.Get(), bytes, sizeof bytes) > 0)
    {
    }
}

void PreviewWorker::Run()
{
    std::unique_lock<std::mutex> lock(m_mutex);
    for (;;)
    {
        m_wake.wait(lock, [this] { return m_quit || m_pending; });
        if (m_quit)
            return;
        std::unique_ptr<Job> job = std::move(m_pending);
        // A stop meant for an earlier request must not end this one.
        DrainStop();
        m_busy = true;
        lock.unlock();
        PagePreview preview;
        const PreviewRequest& request = job->request;
        if (!request.prepare || request.prepare(preview.reason))
        {
            lock.lock();
            const bool stale = Superseded();
            lock.unlock();
            if (!stale)
                preview = RenderPagePreview(request.postscript, request.options, m_stopRead.Get());
        }
        // Before done: whoever is told of the page finds no scratch file left.
        job->RemoveScratch();
        lock.lock();
        m_busy = false;
        // Superseded or closing: the result is stale, and nobody gets it.
        if (Superseded())
            continue;
        lock.unlock();
        if (job->done)
            job->done(preview);
        lock.lock();
    }
}

void PreviewWorker::Job::RemoveScratch()
{
    if (request.removeAfter)
        unlink(posix::NativePath(request.postscript).c_str());
    request.removeAfter = false;
}
