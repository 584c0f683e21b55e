#pragma once
#include <map>
#include <set>
#include <string>
#include <utility>

#include <sys/types.h>

// A file by its device and inode number, so names and links do not matter.
using FileIdentity = std::pair<dev_t, ino_t>;

// Of files (by identity, with a path to each), those that some process of
// this machine holds open for writing.
std::set<FileIdentity> FindFilesOpenForWriting(const std::map<FileIdentity, std::string>& files);
