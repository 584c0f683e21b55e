#include "FolderListing.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>

#include <cstring>
#include <string>
#include <vector>

#include <wx/strconv.h>

namespace folder_listing
{
namespace
{
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
} // namespace

void ListFiles(const wxString& folder, wxArrayString& files, std::vector<std::string>& nativePaths)
{
    const wxCharBuffer nativeFolder = folder.fn_str();
    DIR* dir = nativeFolder.data() ? opendir(nativeFolder.data()) : nullptr;
    if (!dir)
        return;
    const wxString prefix = folder.EndsWith("/") ? folder : folder + "/";
    const std::string nativePrefix =
        std::string(nativeFolder.data()) + (folder.EndsWith("/") ? "" : "/");
    std::vector<std::string> names;
    while (const dirent* entry = readdir(dir))
        if (entry->d_name[0] != '.' && !IsDirectory(dir, entry, true))
            names.emplace_back(entry->d_name);
    closedir(dir);

    // Sized once: growing a wxArrayString copies every string in it.
    files.Alloc(files.size() + names.size());
    nativePaths.reserve(nativePaths.size() + names.size());
    for (const std::string& nativeName : names)
    {
        const wxString name(nativeName.c_str(), *wxConvFileName);
        if (name.empty())
            continue; // a name the toolkit cannot represent
        files.Add(prefix + name);
        nativePaths.push_back(nativePrefix + nativeName);
    }
}

NameCounts CountPpmlNames(const wxString& folder)
{
    NameCounts counts;
    // Folders still to read; one open at a time, however deep the tree.
    std::vector<std::string> pending{std::string(folder.fn_str())};
    while (!pending.empty())
    {
        const std::string path = std::move(pending.back());
        pending.pop_back();
        DIR* dir = opendir(path.c_str());
        if (!dir)
            continue;
        while (const dirent* entry = readdir(dir))
        {
            if (IsDotOrDotDot(entry->d_name))
                continue;
            if (IsDirectory(dir, entry, false))
            {
                pending.push_back(path + "/" + entry->d_name);
                continue;
            }
            const size_t length = std::strlen(entry->d_name);
            counts.lower += EndsWith(entry->d_name, length, ".ppml");
            counts.upper += EndsWith(entry->d_name, length, ".PPML");
        }
        closedir(dir);
    }
    return counts;
}
} // namespace folder_listing
