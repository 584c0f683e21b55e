#include "SharedDirectory.h"

#include "posix/Directories.h"
#include "posix/NativePath.h"

namespace db
{
void MakeSharedDirectory(const wxString& directory, bool withParents)
{
    std::string path = posix::NativePath(directory);
    while (path.size() > 1 && path.back() == '/')
        path.pop_back();
    if (path.empty())
        return;
    const size_t slash = path.rfind('/');
    if (withParents && slash != std::string::npos && slash > 0)
        posix::MakeDirectories(path.substr(0, slash), 0777); // as mkdir makes them
    posix::MakeDirectory(path, 0777, posix::DirectoryMode::Exact);
}
} // namespace db
