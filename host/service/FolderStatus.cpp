#include "service/FolderStatus.h"

#include <ctime>
#include <dirent.h>
#include <fstream>
#include <string>
#include <sys/stat.h>

#include <wx/datetime.h>
#include <wx/filename.h>
#include <wx/log.h>
#include <wx/sstream.h>
#include <wx/xml/xml.h>

#include "CupsJobs.h"
#include "cli/ConsoleText.h"
#include "db/PathResolver.h"
#include "folder/FolderWatcher.h"
#include "folder/HotFolder.h"
#include "jobs/JobPlaces.h"
#include "module/FilterSettings.h"
#include "service/FolderJournal.h"
#include "service/FailureLog.h"
#include "service/FolderPrinting.h"

namespace
{
const wxXmlNode* FindElement(const wxXmlNode* node, const wxString& name)
{
    for (const wxXmlNode* child = node->GetChildren(); child; child = child->GetNext())
    {
        if (child->GetType() != wxXML_ELEMENT_NODE)
            continue;
        if (child->GetName() == name)
            return child;
        if (const wxXmlNode* found = FindElement(child, name))
            return found;
    }
    return nullptr;
}

wxString ServerName(const HotFolder& folder)
{
    const wxString file = folder.GetServerDescriptionFile();
    if (!wxFileName::FileExists(file))
        return wxString();
    wxLogNull quiet;
    wxXmlDocument document;
    if (!document.Load(file, "UTF-8") || !document.GetRoot())
        return "(unreadable description)";
    const wxXmlNode* name = FindElement(document.GetRoot(), "ServerName");
    return name ? name->GetNodeContent().Strip(wxString::both) : wxString("(unnamed)");
}

time_t LocalMidnight()
{
    time_t now = std::time(nullptr);
    struct tm day;
    localtime_r(&now, &day);
    day.tm_hour = day.tm_min = day.tm_sec = 0;
    return mktime(&day);
}

void CountKept(const wxString& directory, FolderStatus& status)
{
    const time_t midnight = LocalMidnight();
    DIR* dir = opendir(directory.fn_str());
    if (!dir)
        return;
    const std::string base(directory.fn_str());
    while (struct dirent* entry = readdir(dir))
    {
        struct stat info;
        if (entry->d_name[0] == '.' || stat((base + "/" + entry->d_name).c_str(), &info) != 0 ||
            !S_ISREG(info.st_mode))
            continue;
        ++status.doneTotal;
        // A move sets the change time, not the modification time.
        status.doneToday += info.st_ctime >= midnight;
    }
    closedir(dir);
}

void CountFailed(const wxString& directory, FolderStatus& status)
{
    std::ifstream log(std::string(wxFileName(directory, kFailureLogName).GetFullPath().fn_str()));
    const std::string today = ToUtf8(wxDateTime::Now().FormatISODate());
    std::string line, last;
    while (std::getline(log, line))
    {
        const size_t reason = line.find('\t', line.find('\t') + 1);
        if (line.empty() ||
            (reason != std::string::npos && line.compare(reason + 1, 8, "retried:") == 0))
            continue;
        ++status.failedTotal;
        status.failedToday += line.compare(0, today.size(), today) == 0;
        last = line;
    }
    // "time <TAB> name <TAB> reason" reads "name: reason".
    const size_t tab = last.find('\t');
    if (tab != std::string::npos)
    {
        const std::string rest = last.substr(tab + 1);
        const size_t second = rest.find('\t');
        status.lastFailure = second == std::string::npos
                                 ? LogFieldText(rest)
                                 : LogFieldText(rest.substr(0, second)) + ": " +
                                       LogFieldText(rest.substr(second + 1));
    }
}
// printed-jobs.log: time, verdict, queue, job id, name, work id, reason.
void CountPrinted(const wxString& container, FolderStatus& status)
{
    std::ifstream log(
        std::string(wxFileName(container, FolderPrinting::kPrintedLogName).GetFullPath().fn_str()));
    const std::string today = ToUtf8(wxDateTime::Now().FormatISODate());
    std::string line;
    while (std::getline(log, line))
    {
        std::vector<std::string> fields;
        for (size_t start = 0, tab = 0; tab != std::string::npos; start = tab + 1)
        {
            tab = line.find('\t', start);
            fields.push_back(line.substr(start, tab == std::string::npos ? tab : tab - start));
        }
        if (fields.size() < 7)
            continue;
        const bool isToday = fields[0].compare(0, today.size(), today) == 0;
        if (fields[1] == "completed")
        {
            ++status.printedTotal;
            status.printedToday += isToday;
            continue;
        }
        status.printFailedToday += isToday;
        status.lastPrintFailure =
            LogFieldText(fields[4]) + ": " + LogFieldText(fields[1]) + " on " +
            LogFieldText(fields[2]) +
            (fields[3] != "0" ? " (CUPS job " + LogFieldText(fields[3]) + ")" : wxString()) +
            (fields[6].empty() ? wxString() : ": " + LogFieldText(fields[6]));
    }
}

void ReadPrinting(const HotFolder& folder, FolderStatus& status)
{
    const wxString container = db::PathResolver::GetContainerFolderPath(folder.GetFolder());
    status.queue = folder.GetBoundQueue();
    status.printing = FolderJournal::ReadOnly(container).Prints().size();
    CountPrinted(container, status);
    std::ifstream held(
        std::string(wxFileName(container, FolderPrinting::kHeldName).GetFullPath().fn_str()));
    std::string reason;
    if (std::getline(held, reason))
        status.printingHeld = FromUtf8(reason);
    if (status.queue.empty())
        return;
    printing::QueueState state;
    printing::CupsError error;
    if (printing::GetQueueState(status.queue, state, error))
    {
        status.queueState = state.state;
        status.queueReasons = state.reasons;
        if (!state.accepting)
            status.queueReasons.push_back("not-accepting-jobs");
    }
    else
        status.queueState = "unknown (" + error.reason + ")";
}
} // namespace

FolderStatus ReadFolderStatus(const wxString& path)
{
    FolderStatus status;
    status.path = path;
    HotFolder folder;
    if (!folder.Open(path, status.problem))
        return status;
    status.name = folder.GetName();
    status.server = ServerName(folder);
    const wxXmlNode* filter = nullptr;
    for (const wxXmlNode* child = folder.GetFilterSetting().GetChildren(); child && !filter;
         child = child->GetNext())
        if (child->GetType() == wxXML_ELEMENT_NODE && child->GetName() == "Filter")
            filter = child;
    wxString passThrough, page, custom;
    for (const auto& setting : ReadFilterSettings(filter))
    {
        if (setting.first == "OUTPUTFILETYPEEPS")
            passThrough = setting.second;
        else if (setting.first == "DEFAULTPAGESIZE")
            page = setting.second;
        else if (setting.first == "CUSTOMPAGESIZE")
            custom = setting.second;
    }
    status.outputType = passThrough == "1" ? "EPS (passed through)" : "PostScript";
    status.page = custom == "1" ? wxString("custom") : page;
    status.preflight = folder.GetPreflight().IsPreflightEnabled();
    status.waiting = ListFolderFiles(folder.GetFolder()).size();
    CountKept(folder.GetKeptOriginalsFolder(), status);
    CountFailed(folder.GetFailedFolder(), status);
    ReadPrinting(folder, status);
    return status;
}
