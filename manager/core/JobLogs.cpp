#include "core/JobLogs.h"

#include <fstream>

#include <wx/filename.h>

#include "jobs/JobPlaces.h"
#include "posix/NativePath.h"
#include "service/FailureLog.h"
#include "service/FolderPrinting.h"

namespace
{
std::vector<std::string> Fields(const std::string& line)
{
    std::vector<std::string> fields;
    for (size_t start = 0, tab = 0; tab != std::string::npos; start = tab + 1)
    {
        tab = line.find('\t', start);
        fields.push_back(line.substr(start, tab == std::string::npos ? tab : tab - start));
    }
    return fields;
}

wxDateTime LoggedTime(const std::string& field)
{
    wxDateTime time;
    if (!time.ParseISOCombined(wxString::FromUTF8(field.c_str()), ' '))
        return wxDateTime();
    return time;
}

std::vector<std::string> Lines(const wxString& file)
{
    std::vector<std::string> lines;
    std::ifstream in(posix::NativePath(file));
    for (std::string line; std::getline(in, line);)
        if (!line.empty())
            lines.push_back(line);
    return lines;
}
} // namespace

std::vector<FailureLine> ReadFailureLog(const wxString& failedFolder)
{
    std::vector<FailureLine> failures;
    for (const std::string& line : Lines(wxFileName(failedFolder, kFailureLogName).GetFullPath()))
    {
        const std::vector<std::string> fields = Fields(line);
        if (fields.size() < 2)
            continue;
        FailureLine failure;
        failure.line = line;
        failure.time = LoggedTime(fields[0]);
        failure.name = LogFieldText(fields[1]);
        if (fields.size() > 2)
        {
            const std::string reason = ReadLogField(fields[2]);
            failure.retried = reason.compare(0, 8, "retried:") == 0;
            failure.printer = reason.compare(0, 8, "printer:") == 0;
            failure.reason = LogFieldText(fields[2]);
        }
        failures.push_back(failure);
    }
    return failures;
}

wxString PrintedLine::Describe() const
{
    return wxString::FromUTF8(verdict.c_str()) + " on " + queue +
           (reason.empty() ? wxString() : ": " + reason);
}

std::vector<PrintedLine> ReadPrintedLog(const wxString& container)
{
    std::vector<PrintedLine> printed;
    for (const std::string& line :
         Lines(wxFileName(container, FolderPrinting::kPrintedLogName).GetFullPath()))
    {
        const std::vector<std::string> fields = Fields(line);
        if (fields.size() < 7)
            continue;
        PrintedLine entry;
        entry.line = line;
        entry.time = LoggedTime(fields[0]);
        entry.verdict = fields[1];
        entry.queue = LogFieldText(fields[2]);
        entry.name = LogFieldText(fields[4]);
        entry.reason = LogFieldText(fields[6]);
        printed.push_back(entry);
    }
    return printed;
}
