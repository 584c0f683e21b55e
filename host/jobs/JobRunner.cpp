#include "jobs/JobRunner.h"

#include <cstdio>
#include <sys/stat.h>

#include <wx/datetime.h>
#include <wx/filename.h>

#include "cli/ConsoleText.h"
#include "printing/CupsForwarding.h"
#include "folder/FileMoves.h"
#include "module/FilterSession.h"
#include "jobs/JobExecution.h"
#include "cli/ProgressDisplay.h"
#include "jobs/RunStatistics.h"

const char JobRunner::kFailureLogName[] = "failed-jobs.log";
const char JobRunner::kTicketSuffix[] = ".Folder.cfg";

static bool Exists(const wxString& path)
{
    struct stat info;
    return lstat(path.fn_str(), &info) == 0;
}

JobOutcome JobRunner::Run(const ReadyToProcessJobInfo& job, size_t index, size_t total)
{
    m_progress.BeginJob(index, total, job.jobName);
    for (const wxString& file : job.files)
        if (!Exists(file))
        {
            ++m_statistics.failed;
            m_progress.EndJob(job.jobName + ": failed");
            PrintError(wxString::Format("%s vanished between sniffing and processing", file));
            return JobOutcome::Failed;
        }

    wxString error;
    wxString work = MakeUniqueDirectory(m_places.workFolder, "job-", error);
    if (work.empty() ||
        !CopyFileTo(m_places.configFile, wxFileName(work, "Folder.cfg").GetFullPath(), error))
    {
        if (!work.empty())
            RemoveTree(work);
        return Fail(job, error);
    }

    JobOutput output = ProcessJob(m_session.Filter(), job, work, &m_progress);
    m_statistics.processSeconds += output.processSeconds;
    if (output.status != 0 || output.producedPath.empty())
    {
        m_session.ClearStatusAfterFailure();
        RemoveTree(work);
        return Fail(job, output.status != 0 ? m_session.DescribeStatus(output.status)
                                            : wxString("the filter reported no output file"));
    }

    // Deliver: output first, then its ticket, and the original last, so an
    // interruption never leaves the original gone without its output.
    wxString delivered;
    bool ok = true;
    if (output.passThrough)
    {
        wxString copy = wxFileName(work, ".deliver-" + output.outputName).GetFullPath();
        ok = CopyFileTo(output.producedPath, copy, error) &&
             MoveIntoDirectory(copy, m_places.outputFolder, output.outputName, delivered, error);
    }
    else
        ok = MoveIntoDirectory(output.producedPath, m_places.outputFolder, output.outputName,
                               delivered, error);
    wxString ticket;
    ok =
        ok && MoveIntoDirectory(wxFileName(work, "Folder.cfg").GetFullPath(), m_places.outputFolder,
                                wxFileName(delivered).GetFullName() + kTicketSuffix, ticket, error);
    if (!ok)
    {
        RemoveTree(work);
        return Fail(job, "cannot deliver the output: " + error);
    }
    RemoveTree(work);

    wxString result = job.jobName + " -> " + delivered;
    const wxString refusal = Submit(job, delivered, ticket, result);

    for (const wxString& file : job.files)
    {
        wxString kept;
        if (!MoveIntoDirectory(file, m_places.keptFolder, wxFileName(file).GetFullName(), kept,
                               error))
        {
            ++m_statistics.failed;
            m_progress.EndJob(result);
            PrintError("the original stays in the hot folder: " + error);
            return JobOutcome::OriginalStuck;
        }
    }
    if (!refusal.empty())
    {
        // Processed and delivered, so the original is kept, not failed; the
        // job still counts as failed because it was not printed.
        ++m_statistics.failed;
        m_progress.EndJob(result + ": failed: " + refusal);
        LogFailure(job.jobName, refusal);
        PrintError(job.jobName + ": " + refusal + "; the output stays in " + delivered);
        return JobOutcome::Failed;
    }
    ++m_statistics.done;
    m_progress.EndJob(result);
    return JobOutcome::Done;
}

wxString JobRunner::Submit(const ReadyToProcessJobInfo& job, const wxString& output,
                           const wxString& ticket, wxString& note)
{
    if (m_places.cupsQueue.empty())
        return wxString();
    // The queue shows the name the user dropped in, not the output's.
    const wxString jobName =
        job.files.empty() ? job.jobName : wxFileName(job.files[0]).GetFullName();
    const wxString queue = FromUtf8(m_places.cupsQueue);
    int jobId = 0;
    wxString reason;
    if (!SubmitDeliveredOutput(m_places.cupsQueue, output, ticket, jobName, jobId, reason))
        return "submission to " + queue + " failed: " + reason;
    note += wxString::Format(" (queued on %s as CUPS job %d)", queue, jobId);
    return wxString();
}

JobOutcome JobRunner::Fail(const ReadyToProcessJobInfo& job, const wxString& reason)
{
    ++m_statistics.failed;
    m_progress.EndJob(job.jobName + ": failed: " + reason);
    LogFailure(job.jobName, reason);
    JobOutcome outcome = JobOutcome::Failed;
    for (const wxString& file : job.files)
    {
        wxString moved, error;
        if (!Exists(file))
        {
            PrintError(job.jobName + ": " + reason + "; " + file + " is gone");
            continue;
        }
        if (MoveIntoDirectory(file, m_places.failedFolder, wxFileName(file).GetFullName(), moved,
                              error))
            PrintError(job.jobName + ": " + reason + "; moved to " + moved);
        else
        {
            PrintError(job.jobName + ": " + reason + "; the original stays in place: " + error);
            outcome = JobOutcome::OriginalStuck;
        }
    }
    return outcome;
}

void JobRunner::LogFailure(const wxString& name, const wxString& reason)
{
    wxString path = wxFileName(m_places.failedFolder, kFailureLogName).GetFullPath();
    // Append mode: concurrent hosts each add whole lines.
    FILE* log = std::fopen(path.fn_str(), "a");
    if (!log)
    {
        PrintError("cannot write the failure log " + path);
        return;
    }
    wxString line = wxDateTime::Now().FormatISOCombined(' ') + "\t" + name + "\t" + reason + "\n";
    std::fputs(ToUtf8(line).c_str(), log);
    std::fclose(log);
}
