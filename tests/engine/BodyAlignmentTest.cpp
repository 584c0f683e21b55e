// Where the embedded document starts in the output: the tables
// tests/data/engine/body-alignment.txt (whole conversions) and
// body-padding.txt (the header's padding alone).
#include <string>

#include <gtest/gtest.h>

#include "BodyAlignment.h"
#include "EngineTestSupport.h"

using namespace hf_test;

namespace
{
const char kBeginDocument[] = "%%BeginDocument: a name\r\n";

// The longest line of text, line ends included.
size_t LongestLine(const std::string& text)
{
    size_t longest = 0;
    for (size_t start = 0; start < text.size();)
    {
        const size_t end = std::min(text.find('\n', start), text.size() - 1) + 1;
        longest = std::max(longest, end - start);
        start = end;
    }
    return longest;
}
} // namespace

TEST(BodyAlignment, LargeBodiesStartOnTheInputsOffsetModulo64KiB)
{
    testkit::ScratchDir scratch("body-alignment");
    for (const auto& c : testkit::Cases("engine/body-alignment.txt", 3, 3))
    {
        SCOPED_TRACE(c[0]);
        const std::string input = TableInput(scratch, c[1]);
        const std::string bytes = testkit::ReadFile(input);
        const bool dos = bytes.compare(0, 4, "\xC5\xD0\xD3\xC6") == 0;
        // The section's place, as the DOS header gives it.
        size_t offset = 0, length = bytes.size();
        if (dos)
        {
            offset = static_cast<unsigned char>(bytes[4]) |
                     static_cast<unsigned char>(bytes[5]) << 8 |
                     static_cast<size_t>(static_cast<unsigned char>(bytes[6])) << 16;
            length = static_cast<unsigned char>(bytes[8]) |
                     static_cast<unsigned char>(bytes[9]) << 8 |
                     static_cast<size_t>(static_cast<unsigned char>(bytes[10])) << 16;
        }
        std::string spd;
        const std::string output = scratch.File("out.ps");
        ASSERT_EQ(1, DetectAndConvert(input, Params("page 612 792", spd), output));
        const std::string written = testkit::ReadFile(output);
        const size_t body = written.find("%%BeginDocument:");
        ASSERT_NE(std::string::npos, body);
        const size_t start = written.find("\r\n", body) + 2;
        EXPECT_EQ(bytes.substr(offset, length), written.substr(start, length));
        EXPECT_EQ(0u, written.compare(start + length, 15, "%%EndDocument\r\n"));
        const std::string header = written.substr(0, start);
        EXPECT_LE(LongestLine(header), 255u);
        const bool padded = header.find("\r\n% The document below") != std::string::npos;
        EXPECT_EQ(c[2] == "yes", padded);
        if (c[2] == "yes")
        {
            EXPECT_EQ(offset % kBodyAlignment, start % kBodyAlignment);
        }
    }
}

TEST(BodyAlignment, PaddingIsCommentLinesBeforeTheDocumentsOwnLine)
{
    for (const auto& c : testkit::Cases("engine/body-padding.txt", 5, 5))
    {
        SCOPED_TRACE(c[0]);
        const std::string prefix(std::stoul(c[1]) - (sizeof kBeginDocument - 1), 'x');
        std::string header = prefix + kBeginDocument;
        AlignBodyStart(header, std::stoul(c[2]), std::stoul(c[3]));
        EXPECT_EQ(std::stoul(c[4]), header.size() - prefix.size() - (sizeof kBeginDocument - 1));
        ASSERT_EQ(0u, header.compare(0, prefix.size(), prefix));
        EXPECT_EQ(0u, header.compare(header.size() - (sizeof kBeginDocument - 1), std::string::npos,
                                     kBeginDocument));
        const std::string padding = header.substr(prefix.size(), header.size() - prefix.size() -
                                                                     (sizeof kBeginDocument - 1));
        for (size_t at = 0; at < padding.size(); at = padding.find("\r\n", at) + 2)
            EXPECT_EQ('%', padding[at]) << "a padding line is no comment at " << at;
        EXPECT_LE(LongestLine(padding), 255u);
    }
}
