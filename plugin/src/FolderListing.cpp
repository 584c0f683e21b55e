#include "FolderListing.h"

#include <dirent.h>
#include <fcntl.h>
#include <limits.h>
#include <sys/stat.h>

#include <algorithm>
#include <map>
#include <cstring>
#include <string>
#include <utility>
#include <vector>

#include <wx/strconv.h>

#include "posix/UniqueDir.h"

namespace folder_listing
{
namespace
{
// Two readings of a folder count its PPML files twice: as many as matter.
constexpr int kMostReadings = 2;

bool IsDotOrDotDot(const char* name)
{
    return name[0] == '.' && (name[1] == '\0' || (name[1] == '.' && name[2] == '\0'));
}

bool EndsWith(const char* name, size_t length, const char* suffix)
{
    const size_t m = std::strlen(suffix);
    return length >= m && std::memcmp(name + length - m, suffix, m) == 0;
}

// Whether the entry is a directory, looking through links when follow is set.
bool IsDirectory(DIR* dir, const dirent* entry, bool follow)
{
    if (entry->d_type == DT_DIR)
        return true;
    if (entry->d_type != DT_UNKNOWN && !(follow && entry->d_type == DT_LNK))
        return false;
    struct stat status;
    return fstatat(dirfd(dir), entry->d_name, &status, follow ? 0 : AT_SYMLINK_NOFOLLOW) == 0 &&
           S_ISDIR(status.st_mode);
}

// prefix followed by the name; empty when the name is no text. ASCII reads
// the same in every file-name encoding and is copied a byte a character;
// other names go through the converter, which costs many times more.
wxString JoinName(const wxString& prefix, const std::string& name)
{
    const bool ascii = name.size() <= NAME_MAX &&
                       std::all_of(name.begin(), name.end(),
                                   [](char c) { return static_cast<unsigned char>(c) < 0x80; });
    if (!ascii)
    {
        const wxString converted(name.c_str(), *wxConvFileName);
        return converted.empty() ? wxString() : prefix + converted;
    }
    wchar_t wide[NAME_MAX];
    std::copy(name.begin(), name.end(), wide);
    wxString path;
    path.reserve(prefix.length() + name.size());
    path.append(prefix);
    path.append(wide, name.size());
    return path;
}
} // namespace

void ForEachFile(const wxString& folder,
                 const std::function<void(const wxString& path, const char* nativePath)>& visit)
{
    const wxCharBuffer nativeFolder = folder.fn_str();
    std::vector<std::string> names;
    {
        posix::UniqueDir dir(nativeFolder.data());
        if (!dir)
            return;
        while (const dirent* entry = dir.Next())
            if (entry->d_name[0] != '.' && !IsDirectory(dir.Get(), entry, true))
                names.emplace_back(entry->d_name);
    }

    const bool endsInSlash = folder.EndsWith("/");
    const wxString prefix = endsInSlash ? folder : folder + "/";
    std::string nativePath = std::string(nativeFolder.data()) + (endsInSlash ? "" : "/");
    const size_t nativePrefixLength = nativePath.size();
    for (const std::string& name : names)
    {
        const wxString path = JoinName(prefix, name);
        if (path.empty())
            continue; // a name the toolkit cannot represent
        nativePath.resize(nativePrefixLength);
        nativePath += name;
        visit(path, nativePath.c_str());
    }
}

NameCounts CountPpmlNames(const wxString& folder)
{
    NameCounts counts;
    // How often each folder (device, inode) has been read. A folder reached
    // through links is read again, as the toolkit's listing does; a third
    // reading cannot change whether there is exactly one PPML file, so none
    // is made, which also ends a walk round a loop of links.
    std::map<std::pair<dev_t, ino_t>, int> readings;
    // Folders still to read; one open at a time, however deep the tree.
    std::vector<std::string> pending{std::string(folder.fn_str())};
    while (!pending.empty())
    {
        const std::string path = std::move(pending.back());
        pending.pop_back();
        posix::UniqueDir dir(path.c_str());
        struct stat status;
        if (!dir || fstat(dirfd(dir.Get()), &status) != 0 ||
            ++readings[{status.st_dev, status.st_ino}] > kMostReadings)
            continue;
        while (const dirent* entry = dir.Next())
        {
            if (IsDotOrDotDot(entry->d_name))
                continue;
            if (IsDirectory(dir.Get(), entry, true))
            {
                pending.push_back(path + "/" + entry->d_name);
                continue;
            }
            const size_t length = std::strlen(entry->d_name);
            counts.lower += EndsWith(entry->d_name, length, ".ppml");
            counts.upper += EndsWith(entry->d_name, length, ".PPML");
        }
    }
    return counts;
}
} // namespace folder_listing
