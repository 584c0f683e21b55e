#pragma once
#include <wx/string.h>

#include "db/FilterConfiguration.h"
#include "db/FolderConfiguration.h"
#include "db/ImposeConfiguration.h"
#include "db/JobConfiguration.h"
#include "db/PreflightConfiguration.h"

namespace db
{
// Readers of the blocks of a Folder.cfg. Each loads the file afresh and
// returns 0; a missing file, root or block leaves the target unchanged.
// Attribute values are taken by position, as the writer orders them.
class ConfigurationReader
{
public:
    static int ReadFolderConfiguration(const wxString& path, FolderConfiguration& configuration);
    static int ReadFilterConfiguration(const wxString& path, FilterConfiguration& configuration);
    static int ReadJobConfiguration(const wxString& path, JobConfiguration& configuration);
    static int ReadImposeConfiguration(const wxString& path, ImposeConfiguration& configuration);
    static int ReadPreflightConfiguration(const wxString& path,
                                          PreflightConfiguration& configuration);
};
} // namespace db
