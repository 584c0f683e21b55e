#include "service/ServiceJobs.h"

#include <cerrno>
#include <chrono>
#include <cstdio>
#include <cstring>
#include <dirent.h>
#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/datetime.h>
#include <wx/filename.h>

#include "cli/ConsoleText.h"
#include "posix/NativePath.h"
#include "folder/FileMoves.h"
#include "jobs/JobExecution.h"
#include "jobs/Preflight.h"
#include "jobs/RunStatistics.h"
#include "module/FilterSession.h"
#include "service/FolderJournal.h"
#include "jobs/JobReport.h"
#include "service/FailureLog.h"

namespace
{
const char kJobPrefix[] = "svc-";
const char kOriginals[] = "original";
const char kSparePrefix[] = "spare-";
const size_t kSyncWholeBatch = 8;
// Enough for every job of a batch (128) in hand at once.
const size_t kSpareLimit = 160;

std::string Native(const wxString& path)
{
    return std::string(path.fn_str());
}

wxString Reason(int error)
{
    return wxString::FromUTF8(std::strerror(error));
}

bool Exists(const wxString& path)
{
    struct stat info;
    return lstat(Native(path).c_str(), &info) == 0;
}

// Data or directory entries on disk before the next step depends on them.
void SyncPath(const wxString& path)
{
    int fd = open(Native(path).c_str(), O_RDONLY | O_CLOEXEC);
    if (fd >= 0)
    {
        fsync(fd);
        close(fd);
    }
}

int RenameNoReplace(const wxString& from, const wxString& to)
{
    return renameat2(AT_FDCWD, Native(from).c_str(), AT_FDCWD, Native(to).c_str(),
                     RENAME_NOREPLACE);
}

std::vector<wxString> EntryNames(const wxString& directory)
{
    std::vector<wxString> names;
    if (DIR* dir = opendir(Native(directory).c_str()))
    {
        while (struct dirent* entry = readdir(dir))
            if (std::strcmp(entry->d_name, ".") != 0 && std::strcmp(entry->d_name, "..") != 0)
                names.push_back(posix::FromNativePath(entry->d_name));
        closedir(dir);
    }
    return names;
}

wxString NewJobId()
{
    static unsigned counter = 0;
    auto now = std::chrono::system_clock::now().time_since_epoch();
    long long micros = std::chrono::duration_cast<std::chrono::microseconds>(now).count();
    return wxString::Format("%s%lld-%d-%u", kJobPrefix, micros, static_cast<int>(getpid()),
                            ++counter);
}

void RemoveEntry(const wxString& path)
{
    struct stat info;
    if (lstat(Native(path).c_str(), &info) != 0)
        return;
    if (S_ISDIR(info.st_mode))
        RemoveTree(path);
    else
        unlink(Native(path).c_str());
}

// Into a hidden name of the target's directory: a rename when both lie on one
// file system, else a copy under a ".tmp" name renamed once whole and synced,
// so the staged name never holds half a file.
bool Stage(const wxString& from, const wxString& to, bool copy, wxString& error)
{
    if (!copy)
    {
        if (rename(Native(from).c_str(), Native(to).c_str()) == 0)
            return true;
        if (errno != EXDEV)
        {
            error = wxString::Format("cannot move %s to %s: %s", from, to, Reason(errno));
            return false;
        }
    }
    const wxString temporary = to + ".tmp";
    unlink(Native(temporary).c_str());
    if (!CopyFileTo(from, temporary, error)) // synced with the batch
        return false;
    if (rename(Native(temporary).c_str(), Native(to).c_str()) != 0)
    {
        error = wxString::Format("cannot move %s to %s: %s", temporary, to, Reason(errno));
        unlink(Native(temporary).c_str());
        return false;
    }
    return true;
}
} // namespace

wxString ServiceJobs::WorkDirectory(const wxString& id) const
{
    return wxFileName(m_places.workFolder, id).GetFullPath();
}

wxString ServiceJobs::OriginalsDirectory(const wxString& id) const
{
    return wxFileName(WorkDirectory(id), kOriginals).GetFullPath();
}

wxString ServiceJobs::StagedPath(const wxString& id, const char* what) const
{
    return wxFileName(m_places.outputFolder, ".hf-" + id + "." + what).GetFullPath();
}

std::vector<wxString> ServiceJobs::Originals(const wxString& id) const
{
    std::vector<wxString> paths;
    const wxString directory = OriginalsDirectory(id);
    for (const wxString& name : EntryNames(directory))
        paths.push_back(wxFileName(directory, name).GetFullPath());
    return paths;
}

void ServiceJobs::RemoveStaged(const wxString& id)
{
    for (const char* what : {"output", "ticket", "output.tmp", "ticket.tmp"})
        unlink(Native(StagedPath(id, what)).c_str());
}

JobResult ServiceJobs::Run(const ReadyToProcessJobInfo& job)
{
    const wxString id = NewJobId();
    const wxString work = WorkDirectory(id);
    if (!MakeWorkDirectory(id))
    {
        m_report.Error(wxString::Format("%s: cannot make a work directory in %s: %s", job.jobName,
                                        m_places.workFolder, Reason(errno)));
        RemoveTree(work);
        return JobResult::OriginalStuck;
    }
    ReadyToProcessJobInfo claimed = job;
    claimed.files.clear();
    for (const wxString& file : job.files)
    {
        const wxString name = wxFileName(file).GetFullName();
        const wxString target = wxFileName(OriginalsDirectory(id), name).GetFullPath();
        wxString moved, error;
        if (RenameNoReplace(file, target) == 0)
            claimed.files.Add(target);
        else if (errno == ENOENT)
        {
            ++m_statistics.failed;
            m_report.Error(file + " vanished between sniffing and processing");
        }
        else if (errno == EXDEV &&
                 MoveIntoDirectory(file, OriginalsDirectory(id), name, moved, error))
            claimed.files.Add(moved);
        else
            m_report.Error("cannot take " + file + ": " + (error.empty() ? Reason(errno) : error));
    }
    if (claimed.files.empty())
    {
        Retire(id);
        return JobResult::Failed;
    }
    // What was checked in the hot folder may have been swapped for a link
    // since; in the work folder no dropper can swap it again.
    for (const wxString& file : claimed.files)
    {
        struct stat info;
        if (lstat(Native(file).c_str(), &info) != 0 || !S_ISREG(info.st_mode))
            return Fail(id, job.jobName,
                        wxFileName(file).GetFullName() +
                            " is a symbolic link; the hot folder takes files only");
    }
    return Continue(id, claimed);
}

bool ServiceJobs::MakeWorkDirectory(const wxString& id)
{
    const wxString work = WorkDirectory(id);
    while (!m_spares.empty())
    {
        const wxString spare = m_spares.back();
        m_spares.pop_back();
        if (rename(Native(spare).c_str(), Native(work).c_str()) == 0)
            return true;
    }
    return mkdir(Native(work).c_str(), 0777) == 0 &&
           mkdir(Native(OriginalsDirectory(id)).c_str(), 0777) == 0;
}

void ServiceJobs::ReleaseSpares()
{
    for (const wxString& spare : m_spares)
        RemoveTree(spare);
    m_spares.clear();
}

void ServiceJobs::Retire(const wxString& id)
{
    const wxString work = WorkDirectory(id);
    if (m_spares.size() < kSpareLimit && Originals(id).empty())
    {
        // Usually only the originals folder is left; a job started in a
        // spare relies on finding nothing else there.
        const bool clean = !RemoveAllButOriginals(id) || EntryNames(work).size() == 1;
        const wxString spare =
            wxFileName(m_places.workFolder,
                       wxString::Format("%s%d-%u", kSparePrefix, static_cast<int>(getpid()),
                                        ++m_spareCounter))
                .GetFullPath();
        if (clean && rename(Native(work).c_str(), Native(spare).c_str()) == 0)
        {
            m_spares.push_back(spare);
            return;
        }
    }
    RemoveTree(work);
}

bool ServiceJobs::RemoveAllButOriginals(const wxString& id)
{
    const wxString work = WorkDirectory(id);
    bool removed = false;
    for (const wxString& name : EntryNames(work))
        if (name != kOriginals)
        {
            RemoveEntry(wxFileName(work, name).GetFullPath());
            removed = true;
        }
    return removed;
}

void ServiceJobs::ClearEarlierAttempt(const wxString& id)
{
    RemoveAllButOriginals(id);
    RemoveStaged(id);
}

JobResult ServiceJobs::Continue(const wxString& id, ReadyToProcessJobInfo job)
{
    const wxString work = WorkDirectory(id);
    wxString error;
    const wxString workConfig = wxFileName(work, "Folder.cfg").GetFullPath();
    if (!CopyFileTo(m_places.configFile, workConfig, error))
        return Fail(id, job.jobName, error);
    JobOutput output = ProcessJob(m_session.Filter(), job, work, m_report.Progress());
    m_statistics.processSeconds += output.processSeconds;
    if (output.status != 0 || output.producedPath.empty())
    {
        m_session.ClearStatusAfterFailure();
        return Fail(id, job.jobName,
                    output.status != 0 ? m_session.DescribeStatus(output.status)
                                       : wxString("the filter reported no output file"));
    }
    if (m_places.preflight)
    {
        const std::string problem = PreflightProblem(Native(output.producedPath));
        if (!problem.empty())
            return Fail(id, job.jobName, wxString::FromUTF8(problem));
    }

    if (!Stage(workConfig, StagedPath(id, "ticket"), false, error) ||
        !Stage(output.producedPath, StagedPath(id, "output"), output.passThrough, error))
    {
        RemoveStaged(id);
        return Fail(id, job.jobName, "cannot deliver the output: " + error);
    }
    // A name free for the output and its ticket alike, and not chosen by
    // another job of the batch.
    wxString name;
    for (int attempt = 1; attempt < 10000 && name.empty(); ++attempt)
    {
        const wxString candidate = NumberedName(output.outputName, attempt);
        const wxString target = wxFileName(m_places.outputFolder, candidate).GetFullPath();
        bool chosen = false;
        for (const Staged& staged : m_staged)
            chosen = chosen || staged.name == candidate;
        if (!chosen && !Exists(target) && !Exists(target + kTicketSuffix))
            name = candidate;
    }
    if (name.empty())
    {
        RemoveStaged(id);
        return Fail(id, job.jobName, "cannot find a free name for " + output.outputName);
    }
    m_staged.push_back(Staged{id, name, job.jobName});
    return JobResult::Done;
}

void ServiceJobs::Commit()
{
    if (m_staged.empty())
        return;
    std::vector<Staged> batch;
    batch.swap(m_staged);
    // Staged bytes on disk before any record names them: file by file for a
    // few jobs; for a large batch one sync of the file system is cheaper
    // than a sync per file, though it waits for other writers' data too.
    int folder = -1;
    if (batch.size() >= kSyncWholeBatch)
        folder = open(Native(m_places.outputFolder).c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (folder >= 0)
    {
        syncfs(folder);
        close(folder);
    }
    else
        for (const Staged& staged : batch)
            for (const char* what : {"ticket", "output"})
                SyncPath(StagedPath(staged.id, what));
    std::vector<FolderJournal::Record> records;
    for (const Staged& staged : batch)
        for (auto& record : DeliveryRecords(staged.id, staged.name, staged.jobName))
            records.push_back(std::move(record));
    if (!m_journal.Append(records))
    {
        for (const Staged& staged : batch)
        {
            RemoveStaged(staged.id);
            Fail(staged.id, staged.jobName, "cannot record the delivery in the journal");
        }
        return;
    }
    std::vector<Staged> placed;
    for (Staged& staged : batch)
        if (Place(staged.id, staged.name, staged.jobName))
            placed.push_back(staged);
    // The outputs are on disk under their names before the originals leave
    // the work directories: a power loss then finds them delivered, never missing.
    SyncPath(m_places.outputFolder);
    for (const Staged& staged : placed)
        KeepOriginals(staged.id, staged.jobName + " -> " +
                                     wxFileName(m_places.outputFolder, staged.name).GetFullPath());
}

bool ServiceJobs::Place(const wxString& id, wxString& name, const wxString& jobName)
{
    const wxString output = StagedPath(id, "output");
    while (Exists(output))
    {
        const wxString target = wxFileName(m_places.outputFolder, name).GetFullPath();
        if (RenameNoReplace(output, target) == 0)
            break;
        if (errno != EEXIST)
        {
            const wxString reason = Reason(errno);
            RemoveStaged(id);
            Fail(id, jobName, "cannot deliver the output: " + reason);
            return false;
        }
        // Someone else took the name since it was chosen: the next one, recorded first.
        name = NumberedName(name, 2);
        if (!m_journal.Append(DeliveryRecords(id, name, jobName)))
        {
            Fail(id, jobName, "cannot record the delivery in the journal");
            return false;
        }
    }
    const wxString ticket = StagedPath(id, "ticket");
    wxString placedTicket, error;
    if (Exists(ticket) && !MoveIntoDirectory(ticket, m_places.outputFolder, name + kTicketSuffix,
                                             placedTicket, error))
        m_report.Warning(jobName + ": the job ticket stays at " + ticket);
    return true;
}

JobResult ServiceJobs::Deliver(const wxString& id, const wxString& recordedName,
                               const wxString& jobName)
{
    wxString name = recordedName;
    if (!Place(id, name, jobName))
        return JobResult::Failed;
    SyncPath(m_places.outputFolder);
    return KeepOriginals(id,
                         jobName + " -> " + wxFileName(m_places.outputFolder, name).GetFullPath());
}

JobResult ServiceJobs::KeepOriginals(const wxString& id, const wxString& result)
{
    for (const wxString& file : Originals(id))
    {
        wxString kept, error;
        if (!MoveIntoDirectory(file, m_places.keptFolder, wxFileName(file).GetFullName(), kept,
                               error))
        {
            ++m_statistics.failed;
            m_report.Error(result + "; the original stays in the work folder: " + error);
            return JobResult::OriginalStuck;
        }
    }
    Retire(id);
    m_journal.ForgetDelivery(id);
    ++m_statistics.done;
    m_report.Done(result);
    m_journal.CompactIfLarge();
    return JobResult::Done;
}

JobResult ServiceJobs::Fail(const wxString& id, const wxString& jobName, const wxString& reason)
{
    ++m_statistics.failed;
    AppendFailureLine(m_places.failedFolder, jobName, reason, m_report);
    // Recorded as to be printed, it never was delivered: the printing forgets it.
    if (m_journal.PrintOf(id))
        m_journal.Append({FolderJournal::Dropped(id)});
    JobResult outcome = JobResult::Failed;
    for (const wxString& file : Originals(id))
    {
        wxString moved, error;
        if (MoveIntoDirectory(file, m_places.failedFolder, wxFileName(file).GetFullName(), moved,
                              error))
            m_report.Failed(jobName, reason, "moved to " + moved);
        else
        {
            m_report.Failed(jobName, reason, "the original stays in the work folder: " + error);
            outcome = JobResult::OriginalStuck;
        }
    }
    if (outcome == JobResult::Failed)
    {
        RemoveStaged(id);
        Retire(id);
        m_journal.ForgetDelivery(id);
    }
    return outcome;
}

std::vector<FolderJournal::Record> ServiceJobs::DeliveryRecords(const wxString& id,
                                                                const wxString& name,
                                                                const wxString& jobName) const
{
    std::vector<FolderJournal::Record> records{FolderJournal::Deliver(id, name)};
    if (!m_places.cupsQueue.empty())
    {
        PrintRecord print;
        print.id = id;
        print.queue = m_places.cupsQueue;
        print.output = wxFileName(m_places.outputFolder, name).GetFullPath();
        print.jobName = jobName;
        records.push_back(FolderJournal::Print(print));
    }
    return records;
}

void ServiceJobs::Recover()
{
    // Write probes left by a killed process in the folders this one proved.
    for (const wxString& directory :
         {m_places.outputFolder, m_places.workFolder, m_places.failedFolder, m_places.keptFolder})
        for (const wxString& entry : EntryNames(directory))
        {
            long pid = 0;
            if (entry.StartsWith(".hotfolder-probe-") && entry.Mid(17).ToLong(&pid) && pid > 0 &&
                kill(static_cast<pid_t>(pid), 0) != 0 && errno == ESRCH)
                unlink(Native(wxFileName(directory, entry).GetFullPath()).c_str());
        }
    for (const wxString& entry : EntryNames(m_places.workFolder))
    {
        const wxString work = wxFileName(m_places.workFolder, entry).GetFullPath();
        if (!entry.StartsWith(kJobPrefix))
        {
            // A killed "run" left it (its original never left the hot
            // folder), or it is a spare, perhaps half emptied.
            if (entry.StartsWith("job-") || entry.StartsWith(kSparePrefix))
                RemoveTree(work);
            continue;
        }
        const std::vector<wxString> originals = Originals(entry);
        if (originals.empty())
        {
            // Never claimed anything, or finished but for the clean-up.
            RemoveStaged(entry);
            RemoveTree(work);
            m_journal.ForgetDelivery(entry);
            continue;
        }
        const wxString jobName = wxFileName(originals[0]).GetFullName();
        const wxString name = m_journal.DeliveryOf(entry);
        if (!name.empty() && (Exists(StagedPath(entry, "output")) ||
                              Exists(wxFileName(m_places.outputFolder, name).GetFullPath())))
            Deliver(entry, name, jobName);
        else
        {
            wxArrayString files;
            for (const wxString& file : originals)
                files.Add(file);
            wxArrayString rejected;
            JobInfoCollection jobs;
            m_session.SniffListed(m_hotFolder, files, rejected, jobs);
            if (jobs.empty())
                Fail(entry, jobName, "the filter no longer accepts it");
            else
            {
                ClearEarlierAttempt(entry);
                Continue(entry, jobs[0]);
            }
        }
    }
    Commit();
    m_journal.CompactIfLarge();
}
