#pragma once
#include <memory>
#include <string>

#include <wx/string.h>

#include "db/FilterConfiguration.h"
#include "db/FolderConfiguration.h"
#include "db/ImposeConfiguration.h"
#include "db/JobConfiguration.h"
#include "db/PreflightConfiguration.h"
#include "db/Setting.h"

class wxXmlNode;

// One hot folder as the host sees it: the folder, its container with
// Folder.cfg and the stored server description, and the folders its jobs
// pass through.
class HotFolder
{
public:
    // Beside Folder.cfg in the container.
    static const char kServerDescriptionName[];
    // Beside it: the printer description it was made from (init --ppd).
    static const char kServerPpdName[];
    // Beside it: the CUPS queue the folder prints on (init --printer), one line.
    static const char kPrinterQueueName[];
    // Beside the container, unless the run names another place.
    static const char kOutputFolderName[];

    // Reads Folder.cfg. False with one clear reason when the folder is
    // missing, is not a hot folder, or its configuration cannot be read.
    bool Open(const wxString& folder, wxString& error);

    const wxString& GetFolder() const { return m_folder; }
    const wxString& GetConfigFile() const { return m_configFile; }
    wxString GetServerDescriptionFile() const;
    wxString GetDefaultOutputFolder() const;
    // The CUPS queue the folder is bound to, or "".
    std::string GetBoundQueue() const { return BoundQueueOf(m_folder); }
    static std::string BoundQueueOf(const wxString& folder);
    // Recorded paths, or the container defaults when Folder.cfg has none.
    wxString GetWorkFolder() const;
    wxString GetFailedFolder() const;
    wxString GetKeptOriginalsFolder() const;

    // The stored "FilterSetting" element (a copy owned by this object).
    const wxXmlNode& GetFilterSetting() const { return m_filters.GetFilterSettingNode(); }
    // The "Filter" element named identifier inside it, or null.
    const wxXmlNode* FindFilter(const wxString& identifier) const;

    // Rewrites Folder.cfg with filter replacing (or adding) the "Filter"
    // element of the same name; everything else is written back as read.
    bool SaveFilter(const wxXmlNode& filter, wxString& error);

    // When Folder.cfg names another place as the hot folder (the folder was
    // moved or renamed), its work, failed and kept-originals folders that lay
    // under the old place are taken to lie under this one, and Folder.cfg is
    // rewritten so. note says so (empty when nothing moved); false with a
    // reason when the configuration cannot be written.
    bool FollowMove(wxString& note, wxString& error);

    // The name stored in Folder.cfg ("Setting" name); may be empty.
    wxString GetName() const { return m_setting.GetName(); }
    // Rewrites Folder.cfg with this name; everything else as read.
    bool SaveName(const wxString& name, wxString& error);

    // The stored "PreflightSettings" entries.
    const db::PreflightConfiguration& GetPreflight() const { return m_preflight; }
    // Rewrites Folder.cfg with these entries; everything else as read.
    bool SavePreflight(const db::PreflightConfiguration& preflight, wxString& error);

private:
    bool Save(const db::FilterConfiguration& filters, const db::PreflightConfiguration& preflight,
              wxString& error);

    wxString m_folder;
    wxString m_configFile;
    db::Setting m_setting;
    db::FolderConfiguration m_folders;
    db::FilterConfiguration m_filters;
    db::JobConfiguration m_jobs;
    db::ImposeConfiguration m_impose;
    db::PreflightConfiguration m_preflight;
};

// The "Filter" child of filterSetting whose "name" is identifier, or null.
const wxXmlNode* FindFilterElement(const wxXmlNode& filterSetting, const wxString& identifier);
