#include "posix/ActingUser.h"

#include <cerrno>
#include <grp.h>
#include <pwd.h>
#include <sys/fsuid.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <unistd.h>

#include "posix/ErrorText.h"

namespace posix
{
namespace
{
// The C library's setgroups changes every thread of the process; the system
// call changes the calling thread alone, as setfsuid and setfsgid do.
int SetThreadGroups(const std::vector<gid_t>& groups)
{
    return static_cast<int>(syscall(SYS_setgroups, groups.size(), groups.data()));
}

std::vector<gid_t> ThreadGroups()
{
    const int count = getgroups(0, nullptr);
    std::vector<gid_t> groups(count > 0 ? count : 0);
    if (count > 0 && getgroups(count, groups.data()) != count)
        groups.clear();
    return groups;
}

// setfsuid reports the previous id whatever happens: the id in effect
// afterwards tells.
bool SetFileUser(uid_t uid)
{
    setfsuid(uid);
    return static_cast<uid_t>(setfsuid(static_cast<uid_t>(-1))) == uid;
}

bool SetFileGroup(gid_t gid)
{
    setfsgid(gid);
    return static_cast<gid_t>(setfsgid(static_cast<gid_t>(-1))) == gid;
}
} // namespace

bool OwnerOf(const std::string& path, UserIdentity& owner, std::string& error)
{
    struct stat info;
    if (stat(path.c_str(), &info) != 0)
    {
        error = ErrorText(errno);
        return false;
    }
    owner = UserIdentity();
    owner.uid = info.st_uid;
    owner.gid = info.st_gid;
    owner.name = std::to_string(info.st_uid);
    std::vector<char> buffer(16384);
    struct passwd entry, *found = nullptr;
    if (getpwuid_r(info.st_uid, &entry, buffer.data(), buffer.size(), &found) == 0 && found)
    {
        owner.gid = entry.pw_gid;
        owner.name = entry.pw_name;
        int count = 64;
        std::vector<gid_t> groups(count);
        while (getgrouplist(entry.pw_name, entry.pw_gid, groups.data(), &count) < 0)
            groups.resize(count);
        groups.resize(count);
        owner.groups = groups;
    }
    else
        owner.groups = {info.st_gid};
    return true;
}

ActingAs::ActingAs(const UserIdentity& user)
{
    if (geteuid() != 0 || user.uid == 0)
        return;
    m_savedGroups = ThreadGroups();
    m_switched = true;
    // Groups and group before the user: with the user's id in effect the
    // thread may no longer be allowed to change them.
    if (SetThreadGroups(user.groups) != 0 || !SetFileGroup(user.gid) || !SetFileUser(user.uid))
    {
        m_error = "cannot act as user " + user.name + ": " + ErrorText(errno);
        m_ok = false;
    }
}

ActingAs::~ActingAs()
{
    if (!m_switched)
        return;
    SetFileUser(0);
    SetFileGroup(0);
    SetThreadGroups(m_savedGroups);
}
} // namespace posix
