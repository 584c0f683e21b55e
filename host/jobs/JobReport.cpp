#include "jobs/JobReport.h"

#include "cli/ConsoleText.h"
#include "cli/ProgressDisplay.h"
#include "jobs/JobPlaces.h"
#include "service/ServiceLog.h"

const char kFailureLogName[] = "failed-jobs.log";
const char kTicketSuffix[] = ".Folder.cfg";

namespace
{
wxString RefusalLine(const wxString& path, const wxString& reason)
{
    return "refused (left in place): " + path + (reason.empty() ? wxString() : ": " + reason);
}
} // namespace

void ServiceReport::Done(const wxString& line)
{
    ServiceLog(Severity::Info, line);
}

void ServiceReport::Failed(const wxString& jobName, const wxString& reason,
                           const wxString& original)
{
    ServiceLog(Severity::Error, jobName + ": failed: " + reason + "; " + original);
}

void ServiceReport::Refused(const wxString& path, const wxString& reason)
{
    ServiceLog(Severity::Warning, RefusalLine(path, reason));
}

void ServiceReport::Info(const wxString& line)
{
    ServiceLog(Severity::Info, line);
}

void ServiceReport::Warning(const wxString& line)
{
    ServiceLog(Severity::Warning, line);
}

void ServiceReport::Error(const wxString& line)
{
    ServiceLog(Severity::Error, line);
}

void ConsoleReport::Begin(size_t index, size_t total, const wxString& name)
{
    m_progress.BeginJob(index, total, name);
}

void ConsoleReport::Done(const wxString& line)
{
    m_progress.EndJob(line);
}

void ConsoleReport::Failed(const wxString& jobName, const wxString& reason,
                           const wxString& original)
{
    m_progress.EndJob(jobName + ": failed: " + reason);
    PrintError(jobName + ": " + reason + "; " + original);
}

void ConsoleReport::Refused(const wxString& path, const wxString& reason)
{
    m_progress.Note(RefusalLine(path, reason));
}

void ConsoleReport::Info(const wxString& line)
{
    m_progress.Note(line);
}

void ConsoleReport::Warning(const wxString& line)
{
    PrintError(line);
}

void ConsoleReport::Error(const wxString& line)
{
    PrintError(line);
}

IProgressTracker* ConsoleReport::Progress()
{
    return &m_progress;
}
