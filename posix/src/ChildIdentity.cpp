#include "posix/ChildIdentity.h"

#include <sys/fsuid.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace posix
{
FileAccessIdentity CurrentFileAccessIdentity()
{
    FileAccessIdentity identity;
    if (geteuid() != 0)
        return identity; // nothing to give away, and no right to change it
    identity.change = true;
    // An id that is not valid changes nothing; the previous one comes back.
    identity.uid = static_cast<uid_t>(setfsuid(static_cast<uid_t>(-1)));
    identity.gid = static_cast<gid_t>(setfsgid(static_cast<gid_t>(-1)));
    const int count = getgroups(0, nullptr);
    if (count > 0)
    {
        identity.groups.resize(static_cast<size_t>(count));
        const int got = getgroups(count, identity.groups.data());
        identity.groups.resize(got > 0 ? static_cast<size_t>(got) : 0);
    }
    return identity;
}

bool AssumeFileAccessIdentity(const FileAccessIdentity& identity)
{
    if (!identity.change)
        return true;
        // Raw system calls: after fork only this thread exists, and the C
        // library's wrappers would try to reach the parent's other threads.
#ifdef SYS_setgroups32
    const long setgroups = SYS_setgroups32, setresgid = SYS_setresgid32,
               setresuid = SYS_setresuid32;
#else
    const long setgroups = SYS_setgroups, setresgid = SYS_setresgid, setresuid = SYS_setresuid;
#endif
    const gid_t* groups = identity.groups.empty() ? nullptr : identity.groups.data();
    return syscall(setgroups, identity.groups.size(), groups) == 0 &&
           syscall(setresgid, identity.gid, identity.gid, identity.gid) == 0 &&
           syscall(setresuid, identity.uid, identity.uid, identity.uid) == 0;
}
} // namespace posix
