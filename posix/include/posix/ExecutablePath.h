#pragma once
#include <string>

namespace posix
{
// The running program's file, as the kernel knows it: right also when the
// program was started through a relative path or a symbolic link. Empty
// when it cannot be read.
std::string ExecutablePath();
} // namespace posix
