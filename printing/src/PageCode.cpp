#include "PageCode.h"

#include <charconv>
#include <cmath>

namespace printing
{
const char* const kStandardCustomSizeCode =
    " pop pop pop << /PageSize [ 5 -2 roll ] >> setpagedevice";

bool IsPostScriptPageCode(const std::string& code, bool inJclSection)
{
    if (inJclSection)
        return false;
    const size_t start = code.find_first_not_of(" \t\r\n");
    if (start != std::string::npos && code.compare(start, 4, "@PJL") == 0)
        return false;
    return code.find("\x1b%-12345X") == std::string::npos;
}

std::string PointsNumber(double value)
{
    char text[64];
    const auto result = (std::nearbyint(value) == value && std::fabs(value) < 1e9)
                            ? std::to_chars(text, text + sizeof text, static_cast<long>(value))
                            : std::to_chars(text, text + sizeof text, static_cast<float>(value));
    return std::string(text, result.ptr);
}

std::string StandardPageSizeCode(double width, double height)
{
    return "<< /PageSize [" + PointsNumber(width) + " " + PointsNumber(height) +
           "] >> setpagedevice";
}
} // namespace printing
