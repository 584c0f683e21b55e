#include "posix/UniqueDir.h"

namespace posix
{
UniqueDir::UniqueDir(const char* path) : m_dir(path ? ::opendir(path) : nullptr) {}

UniqueDir::~UniqueDir()
{
    if (m_dir)
        ::closedir(m_dir);
}

const dirent* UniqueDir::Next()
{
    return m_dir ? ::readdir(m_dir) : nullptr;
}
} // namespace posix
