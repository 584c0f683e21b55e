#pragma once
// A child started by a service that runs as root on behalf of a folder's
// owner: the identity in effect for file access (the thread's filesystem
// user and group ids and its supplementary groups) becomes the child's whole
// identity. exec would otherwise give the child the effective ids, root's.
#include <sys/types.h>

#include <vector>

namespace posix
{
struct FileAccessIdentity
{
    bool change = false; // running as root: the child takes the ids below
    uid_t uid = 0;
    gid_t gid = 0;
    std::vector<gid_t> groups;
};

// The calling thread's identity for file access. Call it in the thread
// that forks, before fork: the child cannot allocate.
FileAccessIdentity CurrentFileAccessIdentity();

// Between fork and exec: sets groups, then group ids, then user ids (the
// order that keeps the right to set the next). Async-signal-safe, allocates
// nothing. False with errno set when the system refused; the child must
// not go on then.
bool AssumeFileAccessIdentity(const FileAccessIdentity& identity);
} // namespace posix
