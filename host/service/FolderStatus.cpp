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

#include "cli/ConsoleText.h"
#include "folder/FolderWatcher.h"
#include "folder/HotFolder.h"
#include "jobs/JobPlaces.h"
#include "module/FilterSettings.h"

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
    std::ifstream log(
        std::string(wxFileName(directory, kFailureLogName).GetFullPath().fn_str()));
    const std::string today = ToUtf8(wxDateTime::Now().FormatISODate());
    std::string line, last;
    while (std::getline(log, line))
    {
        if (line.empty())
            continue;
        ++status.failedTotal;
        status.failedToday += line.compare(0, today.size(), today) == 0;
        last = line;
    }
    // "time <TAB> name <TAB> reason" reads "name: reason".
    const size_t tab = last.find('\t');
    if (tab != std::string::npos)
    {
        std::string rest = last.substr(tab + 1);
        const size_t second = rest.find('\t');
        if (second != std::string::npos)
            rest.replace(second, 1, ": ");
        status.lastFailure = FromUtf8(rest);
    }
}
} // namespace

FolderStatus ReadFolderStatus(const wxString& path)
{
    FolderStatus status;
    status.path = path;
    HotFolder folder;
    if (!folder.Open(path, status.problem))
        return status;
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
    status.waiting = ListFolderFiles(folder.GetFolder()).size();
    CountKept(folder.GetKeptOriginalsFolder(), status);
    CountFailed(folder.GetFailedFolder(), status);
    return status;
}
