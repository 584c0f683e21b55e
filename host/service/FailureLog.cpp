#include "service/FailureLog.h"

#include <fcntl.h>
#include <string>
#include <unistd.h>

#include <wx/datetime.h>
#include <wx/filename.h>

#include "jobs/JobPlaces.h"
#include "jobs/JobReport.h"
#include "posix/NativePath.h"

bool AppendLogLine(const wxString& path, const std::vector<wxString>& fields)
{
    std::string line;
    for (size_t i = 0; i < fields.size(); ++i)
    {
        // Shown text has no tab or line end left, so the line splits back
        // into its fields, and ReadShownText gives each name back.
        line += (i ? "\t" : "") + posix::ShownText(posix::NativePath(fields[i]));
    }
    line += "\n";
    // Append mode and one write: whole lines, whoever else writes the log.
    const int fd = open(path.fn_str(), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0644);
    if (fd < 0)
        return false;
    const bool written = write(fd, line.data(), line.size()) == static_cast<ssize_t>(line.size());
    close(fd);
    return written;
}

std::string ReadLogField(const std::string& shown)
{
    std::string raw;
    return posix::ReadShownText(shown, raw) ? raw : shown;
}

wxString LogFieldText(const std::string& shown)
{
    return posix::FromNativePath(ReadLogField(shown).c_str());
}

void AppendFailureLine(const wxString& failedFolder, const wxString& name, const wxString& reason,
                       JobReport& report)
{
    const wxString path = wxFileName(failedFolder, kFailureLogName).GetFullPath();
    if (!AppendLogLine(path, {wxDateTime::Now().FormatISOCombined(' '), name, reason}))
        report.Error("cannot write the failure log " + path);
}
