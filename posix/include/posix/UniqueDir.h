#pragma once
// An owned directory stream: closed when the owner goes.
#include <dirent.h>

namespace posix
{
class UniqueDir
{
public:
    // Opens path; IsOpen tells whether that worked (errno says why not).
    explicit UniqueDir(const char* path);
    ~UniqueDir();
    UniqueDir(const UniqueDir&) = delete;
    UniqueDir& operator=(const UniqueDir&) = delete;

    bool IsOpen() const { return m_dir != nullptr; }
    explicit operator bool() const { return IsOpen(); }
    DIR* Get() const { return m_dir; }
    // The next entry, "." and ".." included; null at the end.
    const dirent* Next();

private:
    DIR* m_dir;
};
} // namespace posix
