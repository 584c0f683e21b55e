#include "preview/PpmImage.h"

#include <cctype>
#include <cstring>
#include <limits>

namespace
{
// Reads the header's next number, passing white space and "#" comments.
bool ReadNumber(const std::string& bytes, size_t& at, unsigned long& number)
{
    for (;;)
    {
        while (at < bytes.size() && std::isspace(static_cast<unsigned char>(bytes[at])))
            ++at;
        if (at >= bytes.size() || bytes[at] != '#')
            break;
        while (at < bytes.size() && bytes[at] != '\n')
            ++at;
    }
    if (at >= bytes.size() || !std::isdigit(static_cast<unsigned char>(bytes[at])))
        return false;
    number = 0;
    for (; at < bytes.size() && std::isdigit(static_cast<unsigned char>(bytes[at])); ++at)
    {
        if (number > 100000000)
            return false;
        number = number * 10 + static_cast<unsigned long>(bytes[at] - '0');
    }
    return true;
}
} // namespace

wxImage DecodePpm(const std::string& bytes)
{
    size_t at = 2;
    unsigned long width = 0, height = 0, maximum = 0;
    if (bytes.compare(0, 2, "P6") != 0 || !ReadNumber(bytes, at, width) ||
        !ReadNumber(bytes, at, height) || !ReadNumber(bytes, at, maximum) || maximum != 255 ||
        width == 0 || height == 0 || width > 100000 || height > 100000 || at >= bytes.size() ||
        !std::isspace(static_cast<unsigned char>(bytes[at])))
        return wxImage();
    ++at; // the one white-space byte before the samples
    const unsigned long long samples = 3ull * width * height;
    if (bytes.size() - at < samples ||
        samples > static_cast<unsigned long long>(std::numeric_limits<int>::max()))
        return wxImage();
    wxImage image(static_cast<int>(width), static_cast<int>(height), false);
    if (!image.IsOk())
        return wxImage();
    std::memcpy(image.GetData(), bytes.data() + at, static_cast<size_t>(samples));
    return image;
}
