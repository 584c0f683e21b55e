#include "CupsJobOptions.h"

#include <charconv>
#include <sstream>

namespace printing
{
namespace
{
std::string Trimmed(const std::string& text)
{
    const char* blanks = " \t\r\n";
    const size_t first = text.find_first_not_of(blanks);
    if (first == std::string::npos)
        return std::string();
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

// A positive length in points, read and written with "." whatever the
// locale; the settings store lengths as "612.000000", CUPS wants "612".
bool PointsText(const std::string& word, std::string& text)
{
    double value = 0;
    const auto parsed = std::from_chars(word.data(), word.data() + word.size(), value);
    if (parsed.ec != std::errc() || parsed.ptr != word.data() + word.size() || !(value > 0))
        return false;
    char buffer[64];
    const auto written = std::to_chars(buffer, buffer + sizeof buffer, value);
    text.assign(buffer, written.ptr);
    return true;
}

// "W H" in points → "Custom.WxH"; "" when the text is not two lengths.
std::string CustomPageSize(const std::string& size)
{
    std::istringstream words(size);
    std::string width, height, extra;
    if (!(words >> width >> height) || (words >> extra))
        return std::string();
    std::string w, h;
    if (!PointsText(width, w) || !PointsText(height, h))
        return std::string();
    return "Custom." + w + "x" + h;
}

void Set(OptionList& options, const std::string& name, const std::string& value)
{
    for (auto& option : options)
        if (option.first == name)
        {
            option.second = value;
            return;
        }
    options.emplace_back(name, value);
}
} // namespace

OptionList CupsOptionsFromOverrides(const OptionList& overrides)
{
    std::string pageSize;
    std::string customSize;
    OptionList options;
    for (const auto& [key, rawValue] : overrides)
    {
        const std::string name = Trimmed(key);
        const std::string value = Trimmed(rawValue);
        if (name.empty())
            continue;
        if (name == "PageSize")
            pageSize = value;
        else if (name == "CustomPageSize")
            customSize = value;
        else if (!value.empty())
            Set(options, name, value);
    }
    // A custom size without its dimensions cannot be asked for; leave the
    // page size to the queue's default rather than send a bad one.
    const std::string page = pageSize == "Custom" ? CustomPageSize(customSize) : pageSize;
    if (!page.empty())
        options.insert(options.begin(), {"PageSize", page});
    return options;
}
} // namespace printing
