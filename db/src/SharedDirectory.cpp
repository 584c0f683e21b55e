#include "SharedDirectory.h"

#include "posix/Directories.h"
#include "posix/NativePath.h"

namespace db
{
void MakeSharedDirectory(const wxString& directory, bool withParents)
{
    const std::string path = posix::NativePath(directory);
    if (path.empty())
        return;
    if (withParents)
        posix::MakeDirectories(path, 0777, posix::DirectoryMode::Exact);
    else
        posix::MakeDirectory(path, 0777, posix::DirectoryMode::Exact);
}
} // namespace db
