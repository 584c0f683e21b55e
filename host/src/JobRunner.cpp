#include "JobRunner.h"

#include <cstdio>
#include <sys/stat.h>

#include <wx/datetime.h>
#include <wx/filename.h>

#include "ConsoleText.h"
#include "FileMoves.h"
#include "FilterSession.h"
#include "JobExecution.h"
#include "ProgressDisplay.h"
#include "RunStatistics.h"

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

    for (const wxString& file : job.files)
    {
        wxString kept;
        if (!MoveIntoDirectory(file, m_places.keptFolder, wxFileName(file).GetFullName(), kept,
                               error))
        {
            ++m_statistics.failed;
            m_progress.EndJob(job.jobName + " -> " + delivered);
            PrintError("the original stays in the hot folder: " + error);
            return JobOutcome::OriginalStuck;
        }
    }
    ++m_statistics.done;
    m_progress.EndJob(job.jobName + " -> " + delivered);
    return JobOutcome::Done;
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
