#include "utils/CLocaleNumbers.h"

#include <cctype>
#include <charconv>
#include <clocale>
#include <cstdlib>
#include <locale.h>

#include "posix/CLocale.h"

namespace
{
bool OnlySpaceFrom(const char* p)
{
    while (*p && std::isspace(static_cast<unsigned char>(*p)))
        ++p;
    return *p == '\0';
}
} // namespace

namespace utils
{
double StrToDoubleC(const wxString& text, bool* complete)
{
    const wxScopedCharBuffer utf8 = text.utf8_str();
    const char* begin = utf8.data();
    char* end = nullptr;
    const double value = strtod_l(begin, &end, posix::CLocale());
    if (complete)
        *complete = end != begin && OnlySpaceFrom(end);
    return value;
}

long StrToLongC(const wxString& text, bool* complete)
{
    const wxScopedCharBuffer utf8 = text.utf8_str();
    const char* begin = utf8.data();
    char* end = nullptr;
    const long value = strtol_l(begin, &end, 10, posix::CLocale());
    if (complete)
        *complete = end != begin && OnlySpaceFrom(end);
    return value;
}

wxString FormatFixedC(double value, int decimals)
{
    // Large enough for the longest fixed notation of a double (309 integer
    // digits) plus sign, point and the decimals asked for.
    char buffer[400];
    if (decimals < 0)
        decimals = 0;
    if (decimals > 60)
        decimals = 60;
    const auto result =
        std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed, decimals);
    if (result.ec != std::errc())
        return wxString();
    return wxString::FromAscii(buffer, result.ptr - buffer);
}
} // namespace utils
