#include "BodyAlignment.h"

namespace
{
// Comment lines stay well within the 255 bytes a DSC line may have.
constexpr size_t kLongestLine = 200;
constexpr size_t kShortestLine = 3; // "%\r\n"
const char kFirstLine[] = "% The document below starts on a 64 KiB boundary of this file";

std::string PaddingLines(size_t size)
{
    std::string lines;
    lines.reserve(size);
    while (size > 0)
    {
        size_t length = size < kLongestLine ? size : kLongestLine;
        // Never leave less than the shortest line for the next one.
        if (size - length > 0 && size - length < kShortestLine)
            length -= kShortestLine;
        std::string line = lines.empty() && length >= sizeof kFirstLine + 1 ? kFirstLine : "%";
        line.append(length - 2 - line.size(), ' ');
        lines += line + "\r\n";
        size -= length;
    }
    return lines;
}
} // namespace

void AlignBodyStart(std::string& header, unsigned long bodyOffset, unsigned long bodyLength)
{
    const size_t beginDocument = header.rfind("%%BeginDocument:");
    if (bodyLength < kAlignedBodyMinimum || beginDocument == std::string::npos)
        return;
    size_t padding =
        (bodyOffset % kBodyAlignment + kBodyAlignment - header.size() % kBodyAlignment) %
        kBodyAlignment;
    if (padding == 0)
        return;
    if (padding < kShortestLine)
        padding += kBodyAlignment;
    header.insert(beginDocument, PaddingLines(padding));
}
