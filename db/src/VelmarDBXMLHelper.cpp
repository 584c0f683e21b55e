#include "db/VelmarDBXMLHelper.h"

#include <wx/filename.h>

#include "FolderFileBlocks.h"

namespace db
{
int VelmarDBXMLHelper::ReadSettingsInfo(const wxString& path, Setting& setting)
{
    if (!wxFileName::FileExists(path))
        return 0;
    const std::unique_ptr<wxXmlDocument> document = folderfile::LoadWithRoot(path);
    if (!document)
        return -1;
    return folderfile::ReadSettings(document->GetRoot(), setting);
}
} // namespace db
