#include "db/ConfigurationReader.h"

#include "FolderFileBlocks.h"

namespace db
{
namespace
{
template <typename Configuration>
int ReadBlock(const wxString& path, Configuration& configuration,
              void (*read)(wxXmlNode*, Configuration&))
{
    if (const std::unique_ptr<wxXmlDocument> document = folderfile::LoadWithRoot(path))
        read(document->GetRoot(), configuration);
    return 0;
}
} // namespace

int ConfigurationReader::ReadFolderConfiguration(const wxString& path,
                                                 FolderConfiguration& configuration)
{
    return ReadBlock(path, configuration, &folderfile::ReadFolders);
}

int ConfigurationReader::ReadFilterConfiguration(const wxString& path,
                                                 FilterConfiguration& configuration)
{
    return ReadBlock(path, configuration, &folderfile::ReadFilter);
}

int ConfigurationReader::ReadJobConfiguration(const wxString& path, JobConfiguration& configuration)
{
    return ReadBlock(path, configuration, &folderfile::ReadJob);
}

int ConfigurationReader::ReadImposeConfiguration(const wxString& path,
                                                 ImposeConfiguration& configuration)
{
    return ReadBlock(path, configuration, &folderfile::ReadImpose);
}

int ConfigurationReader::ReadPreflightConfiguration(const wxString& path,
                                                    PreflightConfiguration& configuration)
{
    return ReadBlock(path, configuration, &folderfile::ReadPreflight);
}
} // namespace db
