#pragma once
// The system's text for an errno value, for messages that say why.
#include <string>

namespace posix
{
std::string ErrorText(int error);
} // namespace posix
