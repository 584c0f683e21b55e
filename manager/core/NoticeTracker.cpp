#include "core/NoticeTracker.h"

#include <wx/intl.h>

#include "core/JobLogs.h"
#include "db/PathResolver.h"
#include "folder/HotFolder.h"
#include "posix/NativePath.h"

namespace
{
wxString Shown(const wxString& text)
{
    return posix::ShownLine(text);
}
} // namespace

void NoticeTracker::ReadFailures(const FolderRow& row, Seen& seen, bool learnOnly,
                                 std::vector<Notice>& notices)
{
    if (!learnOnly && seen.failedTotal == row.status.failedTotal &&
        seen.lastFailure == row.status.lastFailure)
        return;
    seen.failedTotal = row.status.failedTotal;
    seen.lastFailure = row.status.lastFailure;
    HotFolder folder;
    wxString error;
    if (!folder.Open(row.path, error))
        return;
    for (const FailureLine& failure : ReadFailureLog(folder.GetFailedFolder()))
    {
        // A printer's verdict is told from printed-jobs.log.
        if (failure.retried || failure.printer || !seen.failures.insert(failure.line).second ||
            learnOnly)
            continue;
        notices.push_back({wxString::Format(_("A job failed in %s"), Shown(row.name)),
                           Shown(failure.name) + ": " + Shown(failure.reason)});
    }
}

void NoticeTracker::ReadPrintFailures(const FolderRow& row, Seen& seen, bool learnOnly,
                                      std::vector<Notice>& notices)
{
    // The same verdict again changes the count, not the last line's words.
    if (!learnOnly && seen.lastPrintFailure == row.status.lastPrintFailure &&
        seen.printFailedToday == row.status.printFailedToday)
        return;
    seen.lastPrintFailure = row.status.lastPrintFailure;
    seen.printFailedToday = row.status.printFailedToday;
    for (const PrintedLine& line :
         ReadPrintedLog(db::PathResolver::GetContainerFolderPath(row.path)))
    {
        if (line.Completed() || !seen.printFailures.insert(line.line).second || learnOnly)
            continue;
        notices.push_back({wxString::Format(_("A job was not printed from %s"), Shown(row.name)),
                           Shown(line.name) + ": " + Shown(line.Describe())});
    }
}

void NoticeTracker::ReadPrinterProblems(const FolderRow& row, Seen& seen, bool learnOnly,
                                        std::vector<Notice>& notices)
{
    std::set<std::string> now;
    for (const std::string& reason : row.status.queueReasons)
        if (reason != "none")
            now.insert(reason);
    if (!row.status.printingHeld.empty())
        now.insert(std::string(row.status.printingHeld.utf8_str()));
    for (const std::string& problem : now)
        if (!learnOnly && !seen.printerProblems.count(problem))
            notices.push_back(
                {wxString::Format(_("The printer of %s needs attention"), Shown(row.name)),
                 Shown(wxString::FromUTF8(row.status.queue.c_str())) + ": " +
                     Shown(wxString::FromUTF8(problem.c_str()))});
    // A problem that went away is told again when it comes back.
    seen.printerProblems = now;
}

std::vector<Notice> NoticeTracker::Update(const std::vector<FolderRow>& rows)
{
    std::vector<Notice> notices;
    for (const FolderRow& row : rows)
    {
        if (!row.status.problem.empty())
            continue;
        const bool learnOnly = !m_folders.count(row.path);
        Seen& seen = m_folders[row.path];
        ReadFailures(row, seen, learnOnly, notices);
        ReadPrintFailures(row, seen, learnOnly, notices);
        ReadPrinterProblems(row, seen, learnOnly, notices);
    }
    return notices;
}
