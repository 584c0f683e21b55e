#include "folder/HotFolder.h"

#include <sys/stat.h>

#include <fstream>

#include <wx/filename.h>
#include <wx/log.h>
#include <wx/xml/xml.h>

#include "db/ConfigurationReader.h"
#include "db/HFDatabase.h"
#include "db/PathResolver.h"

const char HotFolder::kServerDescriptionName[] = "ServerDescription.xml";
const char HotFolder::kServerPpdName[] = "server.ppd";
const char HotFolder::kPrinterQueueName[] = "PrinterQueue.txt";
const char HotFolder::kOutputFolderName[] = "Output";

static bool IsDirectory(const wxString& path)
{
    struct stat info;
    return stat(path.fn_str(), &info) == 0 && S_ISDIR(info.st_mode);
}

bool HotFolder::Open(const wxString& folder, wxString& error)
{
    wxFileName absolute = wxFileName::DirName(folder);
    absolute.MakeAbsolute();
    m_folder = absolute.GetPath();
    if (!IsDirectory(m_folder))
    {
        error = wxString::Format("no such folder: %s", m_folder);
        return false;
    }
    m_configFile = db::PathResolver::GetContainerFolder_SettingFilePath(m_folder);
    wxLogNull quiet; // the store logs parse errors; the host reports in one line
    int read = db::HFDatabase::ReadSetting(m_configFile, m_setting);
    if (read == 0)
    {
        error =
            wxString::Format("%s is not a hot folder (no %s); make it one with 'hotfolder init'",
                             m_folder, m_configFile);
        return false;
    }
    if (read < 0)
    {
        error = wxString::Format("cannot read the folder configuration %s", m_configFile);
        return false;
    }
    db::ConfigurationReader::ReadFolderConfiguration(m_configFile, m_folders);
    db::ConfigurationReader::ReadFilterConfiguration(m_configFile, m_filters);
    db::ConfigurationReader::ReadJobConfiguration(m_configFile, m_jobs);
    db::ConfigurationReader::ReadImposeConfiguration(m_configFile, m_impose);
    db::ConfigurationReader::ReadPreflightConfiguration(m_configFile, m_preflight);
    return true;
}

wxString HotFolder::GetServerDescriptionFile() const
{
    return wxFileName(db::PathResolver::GetContainerFolderPath(m_folder), kServerDescriptionName)
        .GetFullPath();
}

std::string HotFolder::BoundQueueOf(const wxString& folder)
{
    const wxString record =
        wxFileName(db::PathResolver::GetContainerFolderPath(folder), kPrinterQueueName)
            .GetFullPath();
    std::ifstream in(record.fn_str());
    std::string queue;
    std::getline(in, queue);
    return queue;
}

wxString HotFolder::GetDefaultOutputFolder() const
{
    return wxFileName(wxFileName::DirName(m_folder).GetPath(), kOutputFolderName).GetFullPath();
}

static wxString Either(const wxString& recorded, const wxString& fallback)
{
    return recorded.empty() ? fallback : recorded;
}

wxString HotFolder::GetWorkFolder() const
{
    return Either(m_folders.GetWorkFolder(), db::PathResolver::GetWorkFolderPath(m_folder));
}

wxString HotFolder::GetFailedFolder() const
{
    return Either(m_folders.GetFailFolder(), db::PathResolver::GetFailFolderPath(m_folder));
}

wxString HotFolder::GetKeptOriginalsFolder() const
{
    return Either(m_folders.GetBackupFolder(), db::PathResolver::GetBackUpFolderPath(m_folder));
}

const wxXmlNode* FindFilterElement(const wxXmlNode& filterSetting, const wxString& identifier)
{
    for (const wxXmlNode* child = filterSetting.GetChildren(); child; child = child->GetNext())
        if (child->GetType() == wxXML_ELEMENT_NODE && child->GetName() == "Filter" &&
            child->GetAttribute("name").Strip(wxString::trailing) == identifier)
            return child;
    return nullptr;
}

const wxXmlNode* HotFolder::FindFilter(const wxString& identifier) const
{
    return FindFilterElement(GetFilterSetting(), identifier);
}

bool HotFolder::SaveFilter(const wxXmlNode& filter, wxString& error)
{
    wxXmlNode filterSetting(GetFilterSetting());
    if (filterSetting.GetName() != "FilterSetting")
        filterSetting = wxXmlNode(wxXML_ELEMENT_NODE, "FilterSetting");
    const wxString identifier = filter.GetAttribute("name");
    wxXmlNode* replacement = new wxXmlNode(filter);
    if (wxXmlNode* old = const_cast<wxXmlNode*>(FindFilterElement(filterSetting, identifier)))
    {
        filterSetting.InsertChild(replacement, old);
        filterSetting.RemoveChild(old);
        delete old;
    }
    else
        filterSetting.AddChild(replacement);

    db::FilterConfiguration filters;
    filters.SetFilterSettingNode(filterSetting);
    return Save(filters, m_preflight, error);
}

bool HotFolder::SavePreflight(const db::PreflightConfiguration& preflight, wxString& error)
{
    return Save(m_filters, preflight, error);
}

bool HotFolder::SaveName(const wxString& name, wxString& error)
{
    const wxString previous = m_setting.GetName();
    m_setting.SetName(name);
    if (Save(m_filters, m_preflight, error))
        return true;
    m_setting.SetName(previous);
    return false;
}

bool HotFolder::Save(const db::FilterConfiguration& filters,
                     const db::PreflightConfiguration& preflight, wxString& error)
{
    wxString saved;
    if (db::HFDatabase::WriteFolderProperties(m_configFile, m_setting, m_jobs, m_folders, filters,
                                              m_impose, preflight, saved) != 0)
    {
        error = wxString::Format("cannot write the folder configuration %s", m_configFile);
        return false;
    }
    m_filters = filters;
    m_preflight = preflight;
    return true;
}

static wxString WithoutTrailingSlash(wxString path)
{
    while (path.length() > 1 && path.EndsWith("/"))
        path.RemoveLast();
    return path;
}

bool HotFolder::FollowMove(wxString& note, wxString& error)
{
    note.clear();
    const wxString recorded = WithoutTrailingSlash(m_folders.GetHotFolder());
    struct stat old, now;
    if (recorded.empty() || recorded == m_folder ||
        (stat(recorded.fn_str(), &old) == 0 && stat(m_folder.fn_str(), &now) == 0 &&
         old.st_dev == now.st_dev && old.st_ino == now.st_ino)) // another name, same folder
        return true;
    // Only what lay under the old place moves along; a folder elsewhere is
    // where its owner put it.
    const auto follow = [&](const wxString& path)
    {
        wxString rest;
        return path.StartsWith(recorded + "/", &rest) ? m_folder + "/" + rest : path;
    };
    db::FolderConfiguration folders = m_folders;
    folders.SetFailFolder(follow(m_folders.GetFailFolder()));
    folders.SetWorkFolder(follow(m_folders.GetWorkFolder()));
    folders.SetBackupFolder(follow(m_folders.GetBackupFolder()));
    folders.SetHotFolder(m_folder);
    wxString saved;
    if (db::HFDatabase::WriteFolderProperties(m_configFile, m_setting, m_jobs, folders, m_filters,
                                              m_impose, m_preflight, saved) != 0)
    {
        error = wxString::Format("the folder was moved from %s, and its configuration %s cannot "
                                 "be rewritten for its new place",
                                 recorded, m_configFile);
        return false;
    }
    m_folders = folders;
    note = m_folder + " was moved from " + recorded +
           ": its work, failed and kept-originals folders follow it, and " + m_configFile +
           " says so now";
    return true;
}
