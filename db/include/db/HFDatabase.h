#pragma once
#include <wx/arrstr.h>
#include <wx/string.h>

#include "db/FilterConfiguration.h"
#include "db/FolderConfiguration.h"
#include "db/ImposeConfiguration.h"
#include "db/JobConfiguration.h"
#include "db/PreflightConfiguration.h"
#include "db/Preference.h"
#include "db/Setting.h"

namespace db
{
// Reading and writing of the configuration files: a hot folder's Folder.cfg
// and the machine-wide Preferences.cfg and HotFolderList.cfg. Every write
// replaces its file atomically; a file that cannot be read is never
// overwritten by an operation that would otherwise leave it unchanged.
class HFDatabase
{
public:
    // --- Folder.cfg ---

    // Root attributes of the file into setting: 0 no file, -1 unreadable or a
    // mandatory attribute missing, 1 read (see VelmarDBXMLHelper).
    static int ReadSetting(const wxString& path, Setting& setting);

    // Rewrites the whole file from the arguments; savedPath receives path.
    // 0 on success, -1 when the file could not be written.
    static int WriteFolderProperties(const wxString& path, const Setting& setting,
                                     const JobConfiguration& jobConfiguration,
                                     const FolderConfiguration& folderConfiguration,
                                     const FilterConfiguration& filterConfiguration,
                                     const ImposeConfiguration& imposeConfiguration,
                                     const PreflightConfiguration& preflightConfiguration,
                                     wxString& savedPath);

    // Merges keys/values (parallel arrays) as job overrides into the Folder.cfg
    // in folder. True when the file was rewritten.
    static bool WriteJobOverrides(const wxString& folder, const wxArrayString& keys,
                                  const wxArrayString& values);

    // Sets the root's "Enable" attribute in place, keeping all other content.
    // 0 on success, -1 when the file could not be read or written.
    static int UpdateFolderStatus(const wxString& path, bool enable);

    // Rewrites the file with a new server name unless it already holds it.
    // True when the file was rewritten.
    static bool UpdateServerName(const wxString& path, const wxString& serverName);

    // --- Preferences.cfg ---

    // -1 when the file exists (whatever it held), 0 when there is none.
    static int ReadPreferences(Preference& preference);
    // 0 on success, -1 when the file could not be written.
    static int WritePreferences(const Preference& preference);

    // --- HotFolderList.cfg ---

    // Appends an entry (no duplicate check). False when nothing was written.
    static bool AddToHotfolderList(const wxString& path);
    // Removes the first entry whose path matches (any case).
    static bool DeleteFromHotfolderList(const wxString& path);
    // Gives the first matching entry the new path.
    static bool EditHotFolderList(const wxString& oldPath, const wxString& newPath);
    // The listed hot folders that still exist, without case duplicates.
    static bool ReadFoldersList(wxArrayString& folders);
    // The same for a HotFolderList.cfg in directory.
    static bool GetHotFolderListFromPath(wxArrayString& folders, const wxString& directory);
    // Appends item unless list holds it in any case.
    static void AddUniqueToList(wxArrayString& list, const wxString& item);
};
} // namespace db
