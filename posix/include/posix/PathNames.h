#pragma once
// The parts of a "/"-separated path, by text alone (nothing is looked up).
#include <string>

namespace posix
{
// What follows the last "/": the whole path when there is none.
std::string BaseName(const std::string& path);
// What precedes the last "/": "." when there is none, "/" for the root.
std::string DirectoryName(const std::string& path);
} // namespace posix
