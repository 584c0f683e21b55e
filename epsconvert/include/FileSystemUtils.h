#pragma once
// Clean-up of job folders. Works with system calls only: no path ever reaches
// a shell. Paths are 8-bit (UTF-8) text like every path of the engine; the
// module does not export these, so no host interface fixes their types.

// Clears the immutable flag where set and allowed, and gives every entry of
// the tree at path mode 0777, folders before what they hold (so a folder
// nobody could read is opened up and then read). False when path is null,
// empty or does not exist, or when any entry could not be made writable or
// any folder of the tree could not be read.
bool MakeFolderWritable(const char* path);

// Removes everything below folder and then folder itself, after making each
// entry writable. Failures are not reported.
void DeleteFolderChildren(const char* folder);
