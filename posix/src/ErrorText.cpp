#include "posix/ErrorText.h"

#include <cstring>

namespace posix
{
std::string ErrorText(int error)
{
    return std::strerror(error);
}
} // namespace posix
