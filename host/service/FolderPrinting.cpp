#include "service/FolderPrinting.h"

#include <algorithm>
#include <fstream>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/datetime.h>
#include <wx/filename.h>

#include "cli/ConsoleText.h"
#include "jobs/JobPlaces.h"
#include "jobs/JobReport.h"
#include "jobs/RunStatistics.h"
#include "posix/NativePath.h"
#include "printing/CupsForwarding.h"
#include "service/FailureLog.h"

const char FolderPrinting::kPrintedLogName[] = "printed-jobs.log";
const char FolderPrinting::kHeldName[] = "printing-held";

namespace
{
// Polling the scheduler for verdicts: often enough that "status" is
// current, rarely enough to cost nothing (one request per queue).
const std::chrono::milliseconds kFollowInterval(200);
const std::chrono::milliseconds kFirstPause(500), kLongestPause(8000);

const char* EndName(printing::JobEnd end)
{
    switch (end)
    {
    case printing::JobEnd::Completed:
        return "completed";
    case printing::JobEnd::Aborted:
        return "aborted";
    case printing::JobEnd::Cancelled:
        return "cancelled";
    default:
        return "open";
    }
}

bool Exists(const wxString& path)
{
    struct stat info;
    return stat(path.fn_str(), &info) == 0;
}
} // namespace

FolderPrinting::FolderPrinting(FolderJournal& journal, const wxString& container,
                               const wxString& failedFolder, JobReport& report,
                               RunStatistics& statistics)
    : m_journal(journal), m_container(container), m_failedFolder(failedFolder), m_report(report),
      m_statistics(statistics)
{
    // A hold an earlier process left is this one's until printing works.
    std::ifstream held(std::string(wxFileName(container, kHeldName).GetFullPath().fn_str()));
    std::string reason;
    if (std::getline(held, reason) && !reason.empty())
        m_held = FromUtf8(reason);
    for (const PrintRecord& print : m_journal.Prints())
    {
        m_replayed.insert(print.id);
        if (!print.sent)
            m_unchecked.insert(print.id);
    }
}

bool FolderPrinting::Waiting() const
{
    for (const PrintRecord& print : m_journal.Prints())
        if (!print.sent)
            return true;
    return false;
}

bool FolderPrinting::Following() const
{
    for (const PrintRecord& print : m_journal.Prints())
        if (print.sent)
            return true;
    return false;
}

bool FolderPrinting::SubmitOne(const PrintRecord& print)
{
    if (m_unchecked.count(print.id))
    {
        if (!Check(print))
            return false;
        const PrintRecord* now = m_journal.PrintOf(print.id);
        if (!now || now->sent)
            return true;
    }
    if (!Exists(print.output))
    {
        Refuse(print, "the output " + print.output + " is gone");
        return true;
    }
    printing::CupsError error;
    // The printer shows the job's name (queue lists, banner pages): shown text.
    const std::string title = ToUtf8(posix::ShownLine(print.jobName));
    const int job = printing::CreateMarkedJob(
        print.queue, title, TicketOptions(print.output + kTicketSuffix), ToUtf8(print.id), error);
    if (job == 0)
    {
        // The scheduler may have made the job and lost the answer.
        m_unchecked.insert(print.id);
        return Trouble(print, error);
    }
    // Not synced: lost only with a power cut, and then the marker finds the job.
    m_journal.Append({FolderJournal::Job(print.id, job)}, false);
    if (!printing::SendJobDocument(print.queue, job, title, posix::NativePath(print.output), error))
    {
        printing::CupsError ignored;
        printing::CancelJob(print.queue, job, ignored);
        // If that cancel did not reach the scheduler, the next try looks first.
        m_unchecked.insert(print.id);
        return Trouble(print, error);
    }
    if (!m_journal.Append({FolderJournal::Sent(print.id)}))
        m_report.Error("cannot record in the journal that " + print.jobName + " was sent");
    m_report.Info(wxString::Format("%s: queued on %s as CUPS job %d", print.jobName,
                                   FromUtf8(print.queue), job));
    return true;
}

bool FolderPrinting::Check(const PrintRecord& print)
{
    // One listing of the queue's marked jobs serves every replayed record.
    printing::CupsError error;
    if (!m_listed.count(print.queue))
    {
        if (!printing::ListMarkedJobs(print.queue, m_marked[print.queue], error))
        {
            m_marked.erase(print.queue);
            return Trouble(print, error);
        }
        m_listed.insert(print.queue);
    }
    bool adopted = false;
    for (const printing::JobState& job : m_marked[print.queue][ToUtf8(print.id)])
    {
        if (job.complete && !adopted)
        {
            // The document reached the scheduler before the record did.
            adopted = true;
            m_journal.Append({FolderJournal::Job(print.id, job.id), FolderJournal::Sent(print.id)});
        }
        else if (job.end == printing::JobEnd::Open &&
                 !printing::CancelJob(print.queue, job.id, error))
        {
            Hold(print.queue, error.reason);
            return false;
        }
    }
    m_unchecked.erase(print.id);
    return true;
}

bool FolderPrinting::Trouble(const PrintRecord& print, const printing::CupsError& error)
{
    if (error.trouble == printing::CupsTrouble::Refused)
    {
        Refuse(print,
               "submission to " + FromUtf8(print.queue) + " failed: " + FromUtf8(error.reason));
        return true;
    }
    Hold(print.queue, error.reason);
    return false;
}

std::chrono::milliseconds FolderPrinting::NextPause(std::chrono::milliseconds previous)
{
    return std::clamp(previous * 2, kFirstPause, kLongestPause);
}

void FolderPrinting::Hold(const std::string& queue, const std::string& reason)
{
    m_pause = NextPause(m_pause);
    m_retryAt = Clock::now() + m_pause;
    // The listing may be stale by the next try.
    m_listed.clear();
    m_marked.clear();
    const wxString why = "printing on " + FromUtf8(queue) + " held: " + FromUtf8(reason);
    if (why == m_held)
        return;
    // One report per outage: a scheduler going away fails one call after
    // another, each with its own words; status shows the latest.
    if (m_held.empty())
        m_report.Error(why + "; the outputs stay delivered and are sent when it works again");
    m_held = why;
    const wxString path = wxFileName(m_container, kHeldName).GetFullPath();
    const wxString temporary = path + ".new";
    {
        std::ofstream file(std::string(temporary.fn_str()), std::ios::trunc);
        file << ToUtf8(why) << "\n";
    }
    rename(temporary.fn_str(), path.fn_str());
}

void FolderPrinting::Resume()
{
    m_pause = std::chrono::milliseconds(0);
    if (m_held.empty())
        return;
    m_held.clear();
    unlink(wxFileName(m_container, kHeldName).GetFullPath().fn_str());
    m_report.Info("printing resumed");
}

void FolderPrinting::Refuse(const PrintRecord& print, const wxString& reason)
{
    ++m_statistics.notPrinted;
    AppendFailureLine(m_failedFolder, print.jobName, "printer: " + reason, m_report);
    m_report.Error(print.jobName + ": " + reason + "; the output stays in " + print.output);
    AppendLogLine(wxFileName(m_container, kPrintedLogName).GetFullPath(),
                  {wxDateTime::Now().FormatISOCombined(' '), "refused", FromUtf8(print.queue), "0",
                   print.jobName, print.id, reason});
    m_journal.Append({FolderJournal::Dropped(print.id)});
}

bool FolderPrinting::AlreadyLogged(const wxString& id)
{
    if (!m_logRead)
    {
        m_logRead = true;
        std::ifstream log(
            std::string(wxFileName(m_container, kPrintedLogName).GetFullPath().fn_str()));
        std::string line;
        while (std::getline(log, line))
        {
            // time, state, queue, job, name, id, reason
            size_t at = 0;
            for (int field = 0; field < 5 && at != std::string::npos; ++field)
                at = line.find('\t', at + (field ? 1 : 0));
            if (at == std::string::npos)
                continue;
            const size_t end = line.find('\t', at + 1);
            m_loggedIds.insert(LogFieldText(line.substr(at + 1, end - at - 1)));
        }
    }
    return m_loggedIds.count(id) != 0;
}

void FolderPrinting::End(const PrintRecord& print, printing::JobEnd end, const std::string& reasons)
{
    // Only a verdict an earlier process may have logged is looked for.
    if (!m_replayed.count(print.id) || !AlreadyLogged(print.id))
    {
        AppendLogLine(wxFileName(m_container, kPrintedLogName).GetFullPath(),
                      {wxDateTime::Now().FormatISOCombined(' '), EndName(end),
                       FromUtf8(print.queue), wxString::Format("%d", print.schedulerJob),
                       print.jobName, print.id, FromUtf8(reasons)});
        if (end == printing::JobEnd::Completed)
            m_report.Info(wxString::Format("%s: printed on %s (CUPS job %d)", print.jobName,
                                           FromUtf8(print.queue), print.schedulerJob));
        else
        {
            ++m_statistics.notPrinted;
            const wxString reason = wxString::Format(
                "printer: CUPS job %d on %s %s: %s", print.schedulerJob, FromUtf8(print.queue),
                EndName(end), reasons.empty() ? wxString("no reason given") : FromUtf8(reasons));
            AppendFailureLine(m_failedFolder, print.jobName, reason, m_report);
            m_report.Error(print.jobName + ": " + reason);
        }
    }
    m_journal.Append({FolderJournal::Ended(print.id, EndName(end))});
    m_journal.CompactIfLarge();
}

void FolderPrinting::Follow(bool now)
{
    if (!Following() || (!now && Clock::now() < m_nextFollow))
        return;
    m_nextFollow = Clock::now() + kFollowInterval;
    std::map<std::string, std::set<int>> open;
    for (const PrintRecord& print : m_journal.Prints())
    {
        if (!print.sent)
            continue;
        printing::CupsError error;
        if (!open.count(print.queue) &&
            !printing::OpenJobIds(print.queue, open[print.queue], error))
            return; // the scheduler is away: asked again next time
        if (open[print.queue].count(print.schedulerJob))
            continue;
        printing::JobState state;
        bool found = false;
        if (!printing::GetJobState(print.schedulerJob, state, found, error))
            return;
        if (!found)
            End(print, printing::JobEnd::Completed, "the scheduler no longer knows the job");
        else if (state.end != printing::JobEnd::Open)
            End(print, state.end, state.reasons);
    }
}
