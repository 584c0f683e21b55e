#include "service/ServedFolder.h"

#include <cups/cups.h>
#include <sys/stat.h>
#include <thread>

#include <wx/filename.h>

#include "cli/ConsoleText.h"
#include "db/PathResolver.h"
#include "folder/FileMoves.h"
#include "folder/ServerDescription.h"
#include "module/FilterSession.h"
#include "posix/NativePath.h"
#include "service/FolderAccess.h"
#include "service/OpenWriters.h"
#include "jobs/JobReport.h"

std::unique_ptr<ServedFolder> ServedFolder::Open(const wxString& path, const FolderOptions& options,
                                                 JobReport& report, wxString& error)
{
    std::unique_ptr<ServedFolder> served(new ServedFolder(options, report));
    std::string why;
    if (!posix::OwnerOf(posix::NativePath(path), served->m_owner, why))
    {
        error = "cannot find the owner of " + path + ": " + FromUtf8(why);
        return nullptr;
    }
    if (!OnlyTheOwnerCanSteer(path, served->m_owner, error))
        return nullptr;
    // From here on everything is done as the owner would do it.
    const posix::ActingAs acting(served->m_owner);
    if (!acting.Acting())
    {
        error = FromUtf8(acting.Error());
        return nullptr;
    }
    HotFolder& folder = served->m_folder;
    wxString moved;
    if (!folder.Open(path, error) || !folder.FollowMove(moved, error))
        return nullptr;
    if (!moved.empty())
        report.Warning(moved);
    const wxString container = db::PathResolver::GetContainerFolderPath(folder.GetFolder());
    // Before anything in the folder is touched: one process at a time.
    if (!served->m_lock.Acquire(container, options.holder, error))
        return nullptr;
    ServerDescription server;
    if (wxFileName::FileExists(folder.GetServerDescriptionFile()) &&
        !server.Load(folder.GetServerDescriptionFile(), error))
        return nullptr;

    JobPlaces& places = served->m_places;
    places.configFile = folder.GetConfigFile();
    places.workFolder = folder.GetWorkFolder();
    places.failedFolder = folder.GetFailedFolder();
    places.keptFolder = folder.GetKeptOriginalsFolder();
    places.outputFolder =
        options.outputFolder.empty() ? folder.GetDefaultOutputFolder() : options.outputFolder;
    places.cupsQueue = options.queue.empty() ? folder.GetBoundQueue() : options.queue;
    places.preflight = folder.GetPreflight().IsPreflightEnabled();
    for (const wxString& directory :
         {places.outputFolder, places.workFolder, places.failedFolder, places.keptFolder})
        if (!EnsureWritableDirectory(directory, error))
            return nullptr;

    served->m_session = FilterSession::Start(options.modulePath, server.GetText(),
                                             &folder.GetFilterSetting(), error);
    if (!served->m_session)
        return nullptr;
    const wxArrayString missing =
        server.MissingFeatures(served->m_session->Info().m_arrRequiredServerFeatures);
    if (!missing.empty())
        report.Warning(path + ": the server description does not offer " + wxJoin(missing, ' ') +
                       ", which the filter needs");
    if (!served->m_journal.Open(container, error))
        return nullptr;
    served->m_jobs.reset(new ServiceJobs(*served->m_session, places, folder.GetFolder(),
                                         served->m_journal, served->m_statistics, report));
    served->m_printing.reset(new FolderPrinting(served->m_journal, container, places.failedFolder,
                                                report, served->m_statistics));
    // Deliveries first: an output recorded for printing is then in place.
    served->m_jobs->Recover();
    // What waits already is taken as if it had just arrived.
    served->OfferAll();
    return served;
}

ServedFolder::~ServedFolder() = default;

void ServedFolder::OfferAll()
{
    const posix::ActingAs acting(m_owner);
    for (const wxString& path : ListFolderFiles(Path()))
        m_offered.insert(wxFileName(path).GetFullName());
}

bool ServedFolder::Rescan()
{
    const posix::ActingAs acting(m_owner);
    struct stat info;
    if (stat(Path().fn_str(), &info) != 0 || !S_ISDIR(info.st_mode))
        return false;
    for (const wxString& path : m_settle.Settled(ListFolderFiles(Path())))
        if (!IsSetAside(path))
            m_offered.insert(wxFileName(path).GetFullName());
    return true;
}

bool ServedFolder::IsSetAside(const wxString& path) const
{
    auto it = m_setAside.find(path);
    long long size = -1, mtime = -1;
    return it != m_setAside.end() && FileSignature(path, size, mtime) &&
           it->second == std::make_pair(size, mtime);
}

void ServedFolder::SetAside(const wxString& path)
{
    long long size = -1, mtime = -1;
    if (FileSignature(path, size, mtime))
        m_setAside[path] = std::make_pair(size, mtime);
}

size_t ServedFolder::TakeOffered(size_t limit, const std::function<bool()>& stop)
{
    const posix::ActingAs acting(m_owner);
    if (!acting.Acting())
    {
        m_report.Error(Path() + ": " + FromUtf8(acting.Error()));
        return 0;
    }
    const size_t run = TakeBatch(limit, stop);
    if (m_offered.empty())
        m_jobs->ReleaseSpares();
    return run;
}

void ServedFolder::Print(const std::function<bool()>& stop)
{
    const posix::ActingAs acting(m_owner);
    if (!acting.Acting())
        return;
    // The scheduler knows the jobs as the owner's (its user name in every
    // request); for the rest of the process they stay its own.
    const std::string previous = cupsUser();
    cupsSetUser(m_owner.name.c_str());
    m_printing->Submit(stop);
    m_printing->Follow();
    cupsSetUser(previous.c_str());
}

size_t ServedFolder::TakeBatch(size_t limit, const std::function<bool()>& stop)
{
    // Regular, visible files only: a FIFO or a device is never opened, and
    // a symbolic link is refused (it would make the folder's owner read
    // whatever it points to on the dropper's behalf).
    std::map<FileIdentity, wxString> candidates;
    while (!m_offered.empty() && candidates.size() < limit)
    {
        const wxString name = *m_offered.begin();
        m_offered.erase(m_offered.begin());
        if (name.empty() || name[0] == '.')
            continue;
        const wxString path = wxFileName(Path(), name).GetFullPath();
        struct stat info;
        if (lstat(path.fn_str(), &info) != 0 || IsSetAside(path))
            continue;
        if (S_ISLNK(info.st_mode))
        {
            ++m_statistics.refused;
            SetAside(path);
            m_report.Warning(name + " is a symbolic link; the hot folder takes files only");
            continue;
        }
        if (!S_ISREG(info.st_mode))
            continue;
        candidates[FileIdentity(info.st_dev, info.st_ino)] = path;
    }
    if (candidates.empty())
        return 0;
    std::map<FileIdentity, std::string> identities;
    for (const auto& candidate : candidates)
        identities[candidate.first] = posix::NativePath(candidate.second);
    // A file still open for writing is left for its writer's close event
    // (or, without one, the rescan).
    for (const FileIdentity& open : FindFilesOpenForWriting(identities))
        candidates.erase(open);
    if (candidates.empty())
        return 0;

    wxArrayString files;
    for (const auto& candidate : candidates)
        files.Add(candidate.second);
    wxArrayString rejected;
    JobInfoCollection jobs;
    {
        ScopedSeconds timing(m_statistics.sniffSeconds);
        m_session->SniffListed(Path(), files, rejected, jobs);
    }
    std::set<wxString> taken;
    for (size_t i = 0; i < jobs.size(); ++i)
        for (const wxString& file : jobs[i].files)
            taken.insert(file);
    for (const auto& candidate : candidates)
        if (!taken.count(candidate.second))
        {
            ++m_statistics.refused;
            SetAside(candidate.second);
            m_report.Refused(candidate.second, m_session->RefusalReason(candidate.second));
        }
    if (!jobs.empty() && m_options.delayJobsMs > 0)
    {
        m_report.Info(wxString::Format("found %zu job(s)", jobs.size()));
        std::this_thread::sleep_for(std::chrono::milliseconds(m_options.delayJobsMs));
    }
    size_t run = 0;
    for (size_t i = 0; i < jobs.size(); ++i)
    {
        if (stop())
        {
            // Not taken: offered again when the service next looks.
            for (size_t j = i; j < jobs.size(); ++j)
                for (const wxString& file : jobs[j].files)
                    m_offered.insert(wxFileName(file).GetFullName());
            break;
        }
        ++run;
        m_report.Begin(i, jobs.size(), jobs[i].jobName);
        if (m_jobs->Run(jobs[i]) == JobResult::OriginalStuck)
            for (const wxString& file : jobs[i].files)
                SetAside(file);
    }
    m_jobs->Commit();
    return run;
}
