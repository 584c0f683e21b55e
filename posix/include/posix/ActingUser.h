#pragma once
// Working for a user: a process started as root (the hot-folder service)
// does each folder's work with the rights of the folder's owner, so nobody
// who can drop a file makes it read, write or move what the owner could not.
#include <string>
#include <vector>

#include <sys/types.h>

namespace posix
{
struct UserIdentity
{
    uid_t uid = 0;
    gid_t gid = 0;
    std::vector<gid_t> groups; // supplementary groups
    std::string name;          // the user's name; the number when it has none
};

// The owner of path (followed if it is a link) with the primary and
// supplementary groups of the password and group databases; a user without
// an entry there gets the group of path and no others. False with a reason.
bool OwnerOf(const std::string& path, UserIdentity& owner, std::string& error);

// While alive, the calling thread's file accesses are checked as the user's:
// its file-system user and group ids and its supplementary groups change
// (those of this thread only; the process stays root for what the owner
// could not do for itself, and a child must drop its own rights before it
// runs anything). Does nothing unless the process runs as root and the user
// is not root.
class ActingAs
{
public:
    explicit ActingAs(const UserIdentity& user);
    ~ActingAs();
    ActingAs(const ActingAs&) = delete;
    ActingAs& operator=(const ActingAs&) = delete;

    // False when the switch was needed and failed; the work must not go on.
    bool Acting() const { return m_ok; }
    const std::string& Error() const { return m_error; }

private:
    bool m_switched = false;
    bool m_ok = true;
    std::string m_error;
    std::vector<gid_t> m_savedGroups;
};
} // namespace posix
