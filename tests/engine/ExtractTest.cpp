// Copying a byte range: chunking, the premature-EOF rule, write failures and
// the copy buffer's degrade steps.
#include <string>

#include <gtest/gtest.h>

#include "posix/AllocationFailures.h"
#include "EngineTestSupport.h"

using namespace hf_test;

namespace
{
constexpr size_t kMegabyte = 1048576;

// Distinct bytes at every position, so a misplaced chunk shows.
std::string Pattern(size_t size)
{
    std::string bytes(size, '\0');
    for (size_t i = 0; i < size; ++i)
        bytes[i] = static_cast<char>((i * 7 + i / 251) & 0xFF);
    return bytes;
}

struct Copy
{
    std::string output;
    std::string messages;
};

class Extract_ : public ::testing::Test
{
protected:
    // Copies through the given streams and closes them; returns stderr.
    static std::string Messages(FILE* inFile, FILE* outFile, long offset, long length)
    {
        StderrCapture capture;
        ExtractEPSfromTIFFpreview(inFile, outFile, offset, length);
        const std::string messages = capture.Text();
        fclose(inFile);
        fclose(outFile);
        return messages;
    }
    Copy Run(const std::string& input, long offset, long length)
    {
        WriteBytes(scratch.File("in.bin"), input);
        Copy copy;
        copy.messages = Messages(fopen(scratch.File("in.bin").c_str(), "rb"),
                                 fopen(scratch.File("out.bin").c_str(), "wb"), offset, length);
        copy.output = testkit::ReadFile(scratch.File("out.bin"));
        return copy;
    }
    ScratchDir scratch;
};
} // namespace

TEST_F(Extract_, CopiesExactRangeInWholeChunks)
{
    const std::string input = Pattern(3000000);
    const Copy whole = Run(input, 0, 3000000);
    EXPECT_EQ(whole.messages, "");
    EXPECT_TRUE(whole.output == input);

    const Copy middle = Run(input, 1234, 2 * kMegabyte + 10);
    EXPECT_EQ(middle.messages, "");
    EXPECT_TRUE(middle.output == input.substr(1234, 2 * kMegabyte + 10));

    EXPECT_EQ(Run(input, 0, 0).output.size(), 0u);
    EXPECT_EQ(Run(input, 0, 0).messages, "");
}

TEST_F(Extract_, ShortFileDropsTheLastPartialChunkAndReportsWhatIsMissing)
{
    // 3 000 000 asked, 500 missing: chunks of 1048576, 1048576, then a short
    // read of 902348 that is not written.
    const std::string input = Pattern(3000000 - 500);
    const Copy copy = Run(input, 0, 3000000);
    EXPECT_EQ(copy.messages, "Premature EOF with leftover BytesToRead = 500\n");
    EXPECT_EQ(copy.output.size(), 2 * kMegabyte);
    EXPECT_TRUE(copy.output == input.substr(0, 2 * kMegabyte));

    // Past the end: nothing copied, the whole count left over.
    const Copy past = Run(Pattern(100), 5000, 777);
    EXPECT_EQ(past.messages, "Premature EOF with leftover BytesToRead = 777\n");
    EXPECT_EQ(past.output.size(), 0u);

    // The count is unsigned: the DOS header's largest length.
    const Copy huge = Run(Pattern(100), 0, 0xFFFFFFFFL);
    EXPECT_EQ(huge.messages, "Premature EOF with leftover BytesToRead = 4294967195\n");
    EXPECT_EQ(huge.output.size(), 0u);
}

TEST_F(Extract_, NegativeOffsetFailsTheSeek)
{
    const Copy copy = Run(Pattern(100), -5, 10);
    EXPECT_EQ(copy.messages, "Error from fseek in ExtractEPSfromTIFFpreview\n");
    EXPECT_EQ(copy.output.size(), 0u);
}

TEST_F(Extract_, WriteAndReadFailuresAreReported)
{
    const std::string in = scratch.File("in.bin");
    WriteBytes(in, Pattern(2 * kMegabyte));
    FILE* full = fopen("/dev/full", "wb");
    ASSERT_NE(full, nullptr);
    EXPECT_EQ(Messages(fopen(in.c_str(), "rb"), full, 0, 2 * kMegabyte),
              "Error from fwrite in ExtractEPSfromTIFFpreview\n");

    // A write-only stream cannot be read from: fread sets the error flag.
    EXPECT_EQ(
        Messages(fopen(in.c_str(), "ab"), fopen(scratch.File("out.bin").c_str(), "wb"), 0, 100),
        "Error from fread in ExtractEPSfromTIFFpreview\n");
}

TEST_F(Extract_, BufferDegradesAndChunkSizeFollows)
{
    // A file 10 bytes short of what is asked: the output ends with the last
    // whole chunk, so its length shows the buffer size in use.
    const std::string input = Pattern(100000);
    const struct
    {
        int failures;
        size_t outputSize;
        const char* messages;
    } steps[] = {
        {0, 0, ""},
        {1, 65536, "1MB not available from malloc; trying smaller amount\n"},
        {2, 98304,
         "1MB not available from malloc; trying smaller amount\n"
         "64KB not available from malloc; trying smaller amount\n"},
        {3, 99840,
         "1MB not available from malloc; trying smaller amount\n"
         "64KB not available from malloc; trying smaller amount\n"
         "4KB not available from malloc; trying smaller amount\n"},
    };
    for (const auto& step : steps)
    {
        posix::SetAllocationFailuresForTesting(0, step.failures);
        const Copy copy = Run(input, 0, 100010);
        posix::SetAllocationFailuresForTesting(0, 0);
        EXPECT_EQ(copy.output.size(), step.outputSize) << step.failures;
        EXPECT_TRUE(copy.output == input.substr(0, step.outputSize));
        EXPECT_EQ(copy.messages,
                  std::string(step.messages) + "Premature EOF with leftover BytesToRead = 10\n");
    }

    posix::SetAllocationFailuresForTesting(0, 4);
    const Copy none = Run(input, 0, 100000);
    posix::SetAllocationFailuresForTesting(0, 0);
    EXPECT_EQ(none.output.size(), 0u);
    EXPECT_EQ(none.messages, "1MB not available from malloc; trying smaller amount\n"
                             "64KB not available from malloc; trying smaller amount\n"
                             "4KB not available from malloc; trying smaller amount\n"
                             "Even 256 bytes not available for copy buffer in "
                             "ExtractEPSfromTIFFpreview\n");
}
