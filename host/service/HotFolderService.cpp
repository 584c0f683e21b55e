#include "service/HotFolderService.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <map>
#include <memory>
#include <poll.h>
#include <sys/inotify.h>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/filename.h>

#include "cli/ExitStatus.h"
#include "cli/ConsoleText.h"
#include "posix/NativePath.h"
#include "db/PathResolver.h"
#include "folder/FileMoves.h"
#include "folder/HotFolder.h"
#include "jobs/RunStatistics.h"
#include "jobs/StopRequest.h"
#include "service/HotFolderListEntries.h"
#include "service/ServedFolder.h"
#include "service/ServiceLock.h"
#include "jobs/JobReport.h"

namespace
{
using Clock = std::chrono::steady_clock;

const char kListName[] = "HotFolderList.cfg";
const char kMarkerName[] = "RunService";
// Folder events that offer a file: written and closed, renamed in, or made
// (a hard link makes a finished file at once; a writer still holding a new
// file open is told apart by the check for writers).
const uint32_t kFolderEvents =
    IN_CLOSE_WRITE | IN_MOVED_TO | IN_CREATE | IN_DELETE_SELF | IN_MOVE_SELF | IN_ONLYDIR;
// Broken folders are tried again this often.
const std::chrono::seconds kRetry(5);
// Files taken from one folder before the others get their turn.
const size_t kBatch = 128;

bool Exists(const wxString& path)
{
    struct stat info;
    return stat(path.fn_str(), &info) == 0;
}

class Service
{
public:
    explicit Service(const ServiceOptions& options)
        : m_options(options), m_report(options.report ? *options.report : m_serviceReport)
    {
    }
    ~Service()
    {
        if (m_inotify >= 0)
            close(m_inotify);
    }
    int Run();

private:
    struct Entry
    {
        std::unique_ptr<ServedFolder> folder;
        int watch = -1;
        int configWatch = -1; // the container: Folder.cfg and the server description
        bool reload = false;
        wxString problem; // why it is not served; empty while it is
    };

    bool StopWanted() const
    {
        return m_stop || StopRequest::Requested() || (!Single() && !Exists(m_marker));
    }
    void SyncList();
    void Serve(const wxString& path, Entry& entry);
    void Drop(Entry& entry, const wxString& problem);
    void DrainEvents();
    void Wait(int timeoutMs);
    void PrintStatistics() const;
    RunStatistics Totals() const;
    bool Single() const { return !m_options.onlyFolder.empty(); }
    // Sends and follows every folder's printing; true while some job is out.
    bool Print();

    ServiceOptions m_options;
    ServiceReport m_serviceReport;
    JobReport& m_report;
    int m_status = kExitSuccess;
    wxString m_warehouse;
    wxString m_marker;
    int m_inotify = -1;
    int m_warehouseWatch = -1;
    int m_serviceWatch = -1;
    bool m_stop = false;
    bool m_listChanged = true;
    std::map<wxString, Entry> m_entries;
    std::map<int, wxString> m_byWatch;
    std::map<int, wxString> m_byConfigWatch;
    Clock::time_point m_nextRetry;
    RunStatistics m_ended; // counts of folders no longer served
    double m_busySeconds = 0;
};

void Service::Drop(Entry& entry, const wxString& problem)
{
    if (entry.folder)
    {
        m_ended.Add(entry.folder->Statistics());
    }
    entry.folder.reset();
    if (entry.watch >= 0)
    {
        m_byWatch.erase(entry.watch);
        inotify_rm_watch(m_inotify, entry.watch);
        entry.watch = -1;
    }
    if (entry.configWatch >= 0)
    {
        m_byConfigWatch.erase(entry.configWatch);
        inotify_rm_watch(m_inotify, entry.configWatch);
        entry.configWatch = -1;
    }
    entry.problem = problem;
}

void Service::Serve(const wxString& path, Entry& entry)
{
    wxString problem;
    // The watch first, so nothing written while the folder opens is missed.
    int watch = inotify_add_watch(m_inotify, path.fn_str(), kFolderEvents);
    if (watch < 0)
        problem = wxString::Format("cannot watch it: %s", wxString::FromUTF8(std::strerror(errno)));
    else if (m_byWatch.count(watch))
    {
        problem = "it is the same folder as " + m_byWatch[watch];
        watch = -1; // the watch belongs to the other entry
    }
    else
    {
        m_byWatch[watch] = path;
        entry.watch = watch;
        // Settings changed while serving apply from the next job on; watched
        // before they are read, so a change while the folder opens counts.
        entry.configWatch =
            inotify_add_watch(m_inotify, db::PathResolver::GetContainerFolderPath(path).fn_str(),
                              IN_CLOSE_WRITE | IN_MOVED_TO | IN_DELETE | IN_ONLYDIR);
        if (entry.configWatch >= 0)
            m_byConfigWatch[entry.configWatch] = path;
        entry.folder = ServedFolder::Open(path, m_options.folder, m_report, problem);
        if (entry.folder)
        {
            entry.problem.clear();
            if (!Single())
                m_report.Info("serving " + path +
                              (entry.folder->Queue().empty()
                                   ? wxString()
                                   : " (printing on " + FromUtf8(entry.folder->Queue()) + ")"));
            return;
        }
    }
    if (Single())
    {
        // A run has nothing else to serve: it ends here.
        m_report.Error(problem);
        m_status = kExitSetupFailed;
        m_stop = true;
    }
    // Reported once for each new reason, not on every retry.
    else if (entry.problem != problem)
        m_report.Error("cannot serve " + path + ": " + problem);
    Drop(entry, problem);
}

void Service::SyncList()
{
    m_listChanged = false;
    const std::vector<wxString> listed =
        Single() ? std::vector<wxString>{m_options.onlyFolder} : ReadHotFolderListEntries();
    for (auto it = m_entries.begin(); it != m_entries.end();)
    {
        if (std::find(listed.begin(), listed.end(), it->first) == listed.end())
        {
            if (it->second.folder)
                m_report.Info("no longer serving " + it->first);
            Drop(it->second, wxString());
            it = m_entries.erase(it);
        }
        else
            ++it;
    }
    for (const wxString& path : listed)
    {
        Entry& entry = m_entries[path];
        if (entry.reload)
        {
            m_report.Info("the settings of " + path + " changed; reading them again");
            Drop(entry, wxString());
            entry.reload = false;
        }
        if (!entry.folder)
            Serve(path, entry);
    }
    m_nextRetry = Clock::now() + kRetry;
}

void Service::DrainEvents()
{
    alignas(struct inotify_event) char buffer[1 << 16];
    for (;;)
    {
        ssize_t got = read(m_inotify, buffer, sizeof(buffer));
        if (got <= 0)
            return;
        for (char* at = buffer; at < buffer + got;)
        {
            const auto* event = reinterpret_cast<const struct inotify_event*>(at);
            at += sizeof(struct inotify_event) + event->len;
            const wxString name = event->len ? posix::FromNativePath(event->name) : wxString();
            if (event->mask & IN_Q_OVERFLOW)
            {
                // Events were lost: look at everything again.
                for (auto& served : m_entries)
                    if (served.second.folder)
                        served.second.folder->OfferAll();
                m_listChanged = true;
                continue;
            }
            if (event->wd == m_warehouseWatch)
            {
                m_listChanged = m_listChanged || name == kListName;
                continue;
            }
            if (event->wd == m_serviceWatch)
            {
                if ((event->mask & (IN_DELETE_SELF | IN_MOVE_SELF)) || name == kMarkerName)
                    m_stop = true;
                continue;
            }
            auto configured = m_byConfigWatch.find(event->wd);
            if (configured != m_byConfigWatch.end())
            {
                // A folder whose configuration goes is found gone by its
                // own watch; only the queue is unbound by removing it.
                if (name == HotFolder::kPrinterQueueName ||
                    (!(event->mask & IN_DELETE) &&
                     (name == "Folder.cfg" || name == HotFolder::kServerDescriptionName)))
                    m_entries[configured->second].reload = true;
                continue;
            }
            auto watched = m_byWatch.find(event->wd);
            if (watched == m_byWatch.end())
                continue;
            Entry& entry = m_entries[watched->second];
            if (event->mask & (IN_DELETE_SELF | IN_MOVE_SELF | IN_IGNORED))
            {
                m_report.Error(watched->second + " vanished; it is no longer served");
                Drop(entry, "the folder vanished");
                continue;
            }
            if (entry.folder && !name.empty())
                entry.folder->Offer(name);
        }
    }
}

void Service::Wait(int timeoutMs)
{
    struct pollfd fds[2] = {{m_inotify, POLLIN, 0}, {StopRequest::WakeDescriptor(), POLLIN, 0}};
    poll(fds, fds[1].fd >= 0 ? 2 : 1, timeoutMs);
}

RunStatistics Service::Totals() const
{
    RunStatistics total = m_ended;
    for (const auto& served : m_entries)
        if (served.second.folder)
            total.Add(served.second.folder->Statistics());
    return total;
}

bool Service::Print()
{
    bool out = false;
    const auto stop = [this] { return StopWanted(); };
    for (auto& served : m_entries)
        if (served.second.folder)
        {
            served.second.folder->Print(stop);
            out = out || served.second.folder->Printing().Following();
        }
    return out;
}

void Service::PrintStatistics() const
{
    const RunStatistics total = Totals();
    const double outside = std::max(0.0, m_busySeconds - total.processSeconds);
    std::printf("Summary: %zu done, %zu failed, %zu refused\n", total.done, total.failed,
                total.refused);
    std::printf("Timing: busy %.3f s, inside Process %.3f s, outside %.3f s (share outside "
                "%.3f), %.1f jobs/s while busy\n",
                m_busySeconds, total.processSeconds, outside,
                m_busySeconds > 0 ? outside / m_busySeconds : 0.0,
                m_busySeconds > 0 ? (total.done + total.failed) / m_busySeconds : 0.0);
    std::fflush(stdout);
}

int Service::Run()
{
    wxString error;
    ServiceLock lock;
    m_inotify = inotify_init1(IN_NONBLOCK | IN_CLOEXEC);
    if (!Single())
    {
        m_warehouse = db::PathResolver::GetWarehousePath();
        if (!MakeDirectories(m_warehouse, error))
        {
            m_report.Error(error);
            return kExitSetupFailed;
        }
        m_marker = db::PathResolver::GetRunServiceFileName();
        if (!lock.Acquire(error))
        {
            m_report.Error(error);
            return kExitSetupFailed;
        }
        db::PathResolver::CreateRunServiceFile();
        if (m_inotify >= 0)
        {
            m_warehouseWatch = inotify_add_watch(m_inotify, m_warehouse.fn_str(),
                                                 IN_CLOSE_WRITE | IN_MOVED_TO | IN_CREATE);
            m_serviceWatch =
                inotify_add_watch(m_inotify, wxFileName(m_marker).GetPath().fn_str(),
                                  IN_DELETE | IN_MOVED_FROM | IN_DELETE_SELF | IN_MOVE_SELF);
        }
        if (m_inotify < 0 || m_warehouseWatch < 0 || m_serviceWatch < 0)
        {
            m_report.Error("cannot watch " + m_warehouse + ": " +
                           wxString::FromUTF8(std::strerror(errno)));
            return kExitSetupFailed;
        }
        m_report.Info("the hot-folder service starts; the list is " + HotFolderListFile());
    }
    else if (m_inotify < 0)
    {
        m_report.Error("cannot watch " + m_options.onlyFolder + ": " +
                       wxString::FromUTF8(std::strerror(errno)));
        return kExitSetupFailed;
    }
    StopRequest::Install();

    const wxString stopMarker = db::PathResolver::GetStopAllHFFilePath().GetFullPath();
    const int tickMs =
        static_cast<int>(std::clamp<long long>(m_options.folder.settle.count() / 2, 50, 1000));
    auto nextRescan = Clock::now();
    bool paused = false;
    const auto stop = [this] { return StopWanted(); };
    while (!StopWanted())
    {
        const auto started = Clock::now();
        bool reload = false;
        for (const auto& served : m_entries)
            reload = reload || served.second.reload;
        if (m_listChanged || reload || started >= m_nextRetry)
            SyncList();
        if (StopWanted())
            break;
        const bool stopMarkerPresent = Exists(stopMarker);
        if (Single() && stopMarkerPresent)
        {
            m_report.Info("the StopHF marker appeared; stopped");
            break;
        }
        if (stopMarkerPresent != paused)
        {
            paused = stopMarkerPresent;
            m_report.Info(paused ? "the StopHF marker is present; paused"
                                 : "the StopHF marker is gone; resumed");
            if (!paused)
                for (auto& served : m_entries)
                    if (served.second.folder)
                        served.second.folder->OfferAll();
        }
        bool offers = false, printing = false;
        if (!paused)
        {
            if (started >= nextRescan)
            {
                for (auto& served : m_entries)
                    if (served.second.folder && !served.second.folder->Rescan())
                    {
                        m_report.Error(served.first + " vanished; it is no longer served");
                        Drop(served.second, "the folder vanished");
                    }
                nextRescan = started + std::chrono::milliseconds(tickMs);
            }
            // Each folder in turn, a batch at a time, events read in between
            // so a burst cannot overflow the queue; each batch delivered is
            // sent to the printer at once.
            for (auto& served : m_entries)
            {
                if (StopWanted())
                    break;
                if (served.second.folder && served.second.folder->HasOffers())
                {
                    served.second.folder->TakeOffered(kBatch, stop);
                    served.second.folder->Print(stop);
                    DrainEvents();
                    offers = offers || (served.second.folder && served.second.folder->HasOffers());
                }
            }
            printing = Print();
        }
        DrainEvents();
        m_busySeconds += std::chrono::duration<double>(Clock::now() - started).count();
        if (!offers)
        {
            // Jobs at the printer are asked after more often than files settle.
            Wait(printing ? std::min(tickMs, 100) : tickMs);
            DrainEvents();
        }
    }
    if (!Single())
        m_report.Info(StopRequest::Requested() ? "stop requested; the service ends"
                                               : "RunService was removed; the service ends");
    else if (StopRequest::Requested())
        m_report.Info("stop requested; stopped");
    if (m_options.stats)
        PrintStatistics();
    if (m_options.totals)
        m_options.totals->Add(Totals());
    return m_status;
}
} // namespace

int RunHotFolderService(const ServiceOptions& options)
{
    Service service(options);
    return service.Run();
}
