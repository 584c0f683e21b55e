#include "service/FolderAccess.h"

#include <sys/stat.h>

#include "db/PathResolver.h"
#include "posix/NativePath.h"
#include "posix/UniqueDir.h"

namespace
{
std::string ContainerOf(const wxString& folder)
{
    std::string container = posix::NativePath(db::PathResolver::GetContainerFolderPath(folder));
    while (container.size() > 1 && container.back() == '/')
        container.pop_back();
    return container;
}

// Why path must not be as it is; empty when it may.
wxString Trouble(const std::string& path, bool directory, uid_t owner)
{
    struct stat info;
    if (lstat(path.c_str(), &info) != 0)
        return wxString(); // missing: opening the folder says so
    if (S_ISLNK(info.st_mode))
        return "is a symbolic link";
    if (directory ? !S_ISDIR(info.st_mode) : !S_ISREG(info.st_mode))
        return directory ? "is not a folder" : "is not a plain file";
    if (info.st_uid != owner && info.st_uid != 0)
        return wxString::Format("belongs to user %u, not to the folder's owner",
                                static_cast<unsigned>(info.st_uid));
    if (info.st_mode & (S_IWGRP | S_IWOTH))
        return "can be written by others than its owner";
    return wxString();
}
} // namespace

bool OnlyTheOwnerCanSteer(const wxString& folder, const posix::UserIdentity& owner, wxString& error)
{
    const std::string container = ContainerOf(folder);
    for (const auto& [path, directory] :
         {std::make_pair(container, true), std::make_pair(container + "/Folder.cfg", false)})
    {
        const wxString trouble = Trouble(path, directory, owner.uid);
        if (trouble.empty())
            continue;
        const wxString shown = posix::FromNativePath(path.c_str());
        error = shown + " " + trouble + ", so the folder is not served (whoever may change it " +
                "steers what the service does as the folder's owner); fix: " +
                (trouble.StartsWith("can be written") ? "chmod go-w '" + shown + "'"
                                                      : "make it the owner's own, as init does");
        return false;
    }
    return true;
}

void KeepToTheOwner(const wxString& folder)
{
    const std::string container = ContainerOf(folder);
    const auto protect = [](const std::string& path)
    {
        struct stat info;
        if (lstat(path.c_str(), &info) == 0 && !S_ISLNK(info.st_mode))
            chmod(path.c_str(), info.st_mode & 07755);
    };
    protect(container);
    posix::UniqueDir entries(container.c_str());
    while (entries)
    {
        const dirent* entry = entries.Next();
        if (!entry)
            break;
        const std::string name = entry->d_name;
        if (name != "." && name != "..")
            protect(container + "/" + name);
    }
}
