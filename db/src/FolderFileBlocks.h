#pragma once
// Internal: the blocks of a Folder.cfg read from and written to an already
// loaded document, so one operation can work on one consistent snapshot.
#include <memory>

#include <wx/string.h>
#include <wx/xml/xml.h>

#include "db/FilterConfiguration.h"
#include "db/FolderConfiguration.h"
#include "db/ImposeConfiguration.h"
#include "db/JobConfiguration.h"
#include "db/PreflightConfiguration.h"
#include "db/Setting.h"

namespace db
{
namespace folderfile
{
// The document at path loaded as "UTF-8", or null when it is missing, does
// not load or has no root element.
std::unique_ptr<wxXmlDocument> LoadWithRoot(const wxString& path);

// ReadSettingsInfo's rules on a loaded root: -1 or 1.
int ReadSettings(wxXmlNode* root, Setting& setting);

void ReadFolders(wxXmlNode* root, FolderConfiguration& configuration);
void ReadFilter(wxXmlNode* root, FilterConfiguration& configuration);
void ReadJob(wxXmlNode* root, JobConfiguration& configuration);
void ReadImpose(wxXmlNode* root, ImposeConfiguration& configuration);
void ReadPreflight(wxXmlNode* root, PreflightConfiguration& configuration);

// The complete "HotFolder" element for the given configuration.
wxXmlNode* BuildRoot(const Setting& setting, const JobConfiguration& jobConfiguration,
                     const FolderConfiguration& folderConfiguration,
                     const FilterConfiguration& filterConfiguration,
                     const ImposeConfiguration& imposeConfiguration,
                     const PreflightConfiguration& preflightConfiguration);
} // namespace folderfile
} // namespace db
