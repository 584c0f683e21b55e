#include "LocaleDecimalPoint.h"

#include <cctype>
#include <clocale>
#include <strings.h>

std::string CurrentLocaleDecimalPoint()
{
    // The thread's locale if it set one, else the process locale: what the
    // number formatting of this thread would use.
    const lconv* conventions = localeconv();
    std::string point =
        conventions && conventions->decimal_point ? conventions->decimal_point : ".";
    size_t first = 0;
    while (first < point.size() && std::isspace(static_cast<unsigned char>(point[first])))
        ++first;
    size_t last = point.size();
    while (last > first && std::isspace(static_cast<unsigned char>(point[last - 1])))
        --last;
    return point.substr(first, last - first);
}

bool LocaleUsesFullStop(const std::string& decimalPoint)
{
    return strcasecmp(decimalPoint.c_str(), ".") == 0;
}
