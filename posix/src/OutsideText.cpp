#include "posix/OutsideText.h"

namespace posix
{
namespace
{
const char kHex[] = "0123456789ABCDEF";

void AppendEscaped(std::string& out, unsigned char byte)
{
    out += "\\x";
    out += kHex[byte >> 4];
    out += kHex[byte & 15];
}

// The length of the well-formed UTF-8 sequence at text[at], 0 when there is
// none (overlong forms, surrogates and code points above U+10FFFF included).
size_t Utf8Length(std::string_view text, size_t at)
{
    const auto byte = [&](size_t i) { return static_cast<unsigned char>(text[at + i]); };
    const unsigned char lead = byte(0);
    const size_t left = text.size() - at;
    const auto continuation = [&](size_t i) { return i < left && (byte(i) & 0xC0) == 0x80; };
    if (lead < 0x80)
        return 1;
    if (lead >= 0xC2 && lead <= 0xDF)
        return continuation(1) ? 2 : 0;
    if (lead >= 0xE0 && lead <= 0xEF)
    {
        if (!continuation(1) || !continuation(2))
            return 0;
        if ((lead == 0xE0 && byte(1) < 0xA0) || (lead == 0xED && byte(1) >= 0xA0))
            return 0;
        return 3;
    }
    if (lead >= 0xF0 && lead <= 0xF4)
    {
        if (!continuation(1) || !continuation(2) || !continuation(3))
            return 0;
        if ((lead == 0xF0 && byte(1) < 0x90) || (lead == 0xF4 && byte(1) >= 0x90))
            return 0;
        return 4;
    }
    return 0;
}

int HexValue(char c)
{
    if (c >= '0' && c <= '9')
        return c - '0';
    if (c >= 'A' && c <= 'F')
        return c - 'A' + 10;
    return -1;
}

std::string ShowBytes(std::string_view raw, bool doubleBackslash)
{
    std::string out;
    out.reserve(raw.size());
    for (size_t at = 0; at < raw.size();)
    {
        const auto byte = static_cast<unsigned char>(raw[at]);
        const size_t length = Utf8Length(raw, at);
        if (byte < 0x20 || byte == 0x7F || length == 0)
        {
            AppendEscaped(out, byte);
            ++at;
            continue;
        }
        if (byte == '\\' && doubleBackslash)
            out += '\\';
        out.append(raw, at, length);
        at += length;
    }
    return out;
}

} // namespace

std::string ShownText(std::string_view raw)
{
    return ShowBytes(raw, true);
}

bool ReadShownText(std::string_view shown, std::string& raw)
{
    raw.clear();
    for (size_t at = 0; at < shown.size(); ++at)
    {
        if (shown[at] != '\\')
        {
            raw += shown[at];
            continue;
        }
        if (at + 1 < shown.size() && shown[at + 1] == '\\')
        {
            raw += '\\';
            ++at;
            continue;
        }
        if (at + 3 >= shown.size() || shown[at + 1] != 'x')
            return false;
        const int high = HexValue(shown[at + 2]), low = HexValue(shown[at + 3]);
        if (high < 0 || low < 0)
            return false;
        raw += static_cast<char>(high * 16 + low);
        at += 3;
    }
    return true;
}

std::string DscCommentValue(std::string_view prefix, std::string_view raw)
{
    const size_t kLongestLine = 255;
    std::string shown = ShowBytes(raw, false);
    if (prefix.size() >= kLongestLine)
        return std::string();
    size_t keep = kLongestLine - prefix.size();
    if (shown.size() <= keep)
        return shown;
    // Back to the start of a character, and never inside an escape.
    while (keep > 0 && (static_cast<unsigned char>(shown[keep]) & 0xC0) == 0x80)
        --keep;
    for (size_t back = 1; back <= 3 && back <= keep; ++back)
        if (shown.compare(keep - back, 2, "\\x") == 0)
        {
            keep -= back;
            break;
        }
    shown.resize(keep);
    return shown;
}
} // namespace posix
