#include "SharedDirectory.h"

#include <string>

#include <sys/stat.h>

namespace db
{
namespace
{
void MakeOne(const std::string& path)
{
    if (::mkdir(path.c_str(), 0777) == 0)
        ::chmod(path.c_str(), 0777);
}
} // namespace

void MakeSharedDirectory(const wxString& directory, bool withParents)
{
    std::string path(directory.fn_str());
    while (path.size() > 1 && path.back() == '/')
        path.pop_back();
    if (path.empty())
        return;
    if (withParents)
    {
        for (size_t slash = path.find('/', 1); slash != std::string::npos;
             slash = path.find('/', slash + 1))
        {
            const std::string ancestor = path.substr(0, slash);
            struct stat info;
            if (::stat(ancestor.c_str(), &info) != 0)
                MakeOne(ancestor);
        }
    }
    struct stat info;
    if (::stat(path.c_str(), &info) != 0)
        MakeOne(path);
}
} // namespace db
