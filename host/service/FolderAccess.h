#pragma once
#include <wx/string.h>

#include "posix/ActingUser.h"

// A hot folder's container and its Folder.cfg say where the service moves
// files and what it prints, and the service does that with the rights of
// the folder's owner. Whoever else could change them would steer the owner's
// rights: so both must be owned by the owner (or root) and writable by no
// group and no other user, and be what they seem (not symbolic links).
// False with the reason and the fix.
bool OnlyTheOwnerCanSteer(const wxString& folder, const posix::UserIdentity& owner,
                          wxString& error);

// Takes write permission on the container, its folders and files from group
// and others, whatever the umask made them.
void KeepToTheOwner(const wxString& folder);
