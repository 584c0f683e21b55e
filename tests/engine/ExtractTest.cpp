// Copying a byte range over the table tests/data/engine/extract.txt, and
// the read and write failures.
#include <sys/resource.h>

#include <csignal>
#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "EngineTestSupport.h"
#include "posix/AllocationFailures.h"

using namespace hf_test;

namespace
{
// Distinct bytes at every position, so a misplaced chunk shows.
std::string Pattern(size_t size)
{
    std::string bytes(size, '\0');
    for (size_t i = 0; i < size; ++i)
        bytes[i] = static_cast<char>((i * 7 + i / 251) & 0xFF);
    return bytes;
}

// Copies through the given streams and closes them; returns stderr.
std::string Copy(FILE* in, FILE* out, long offset, long length)
{
    testkit::StderrCapture capture;
    ExtractEPSfromTIFFpreview(in, out, offset, length);
    const std::string messages = capture.Text();
    fclose(in);
    fclose(out);
    return messages;
}

// Lowers the file size limit for one scope; a write past it fails with
// EFBIG instead of killing the process.
class FileSizeLimit
{
public:
    explicit FileSizeLimit(rlim_t bytes)
    {
        getrlimit(RLIMIT_FSIZE, &saved_);
        savedSignal_ = signal(SIGXFSZ, SIG_IGN);
        struct rlimit lowered = saved_;
        lowered.rlim_cur = bytes;
        setrlimit(RLIMIT_FSIZE, &lowered);
    }
    ~FileSizeLimit()
    {
        setrlimit(RLIMIT_FSIZE, &saved_);
        signal(SIGXFSZ, savedSignal_);
    }
    FileSizeLimit(const FileSizeLimit&) = delete;
    FileSizeLimit& operator=(const FileSizeLimit&) = delete;

private:
    struct rlimit saved_;
    void (*savedSignal_)(int);
};
} // namespace

TEST(Extract, TableOfRanges)
{
    testkit::ScratchDir scratch("hf-extract");
    const std::string in = scratch.File("in.bin"), out = scratch.File("out.bin");
    for (const auto& c : testkit::Cases("engine/extract.txt", 7, 11))
    {
        SCOPED_TRACE(c[0]);
        const std::string input = Pattern(std::stoul(c[1]));
        testkit::WriteFile(in, input);
        int skip = 0, fail = 0;
        std::istringstream(c[4]) >> skip >> fail;
        posix::SetAllocationFailuresForTesting(skip, fail);
        const std::string messages = Copy(fopen(in.c_str(), "rb"), fopen(out.c_str(), "wb"),
                                          std::stol(c[2]), std::stol(c[3]));
        posix::SetAllocationFailuresForTesting(0, 0);
        EXPECT_EQ(messages, c[6] == "-" ? "" : Unescape(c[6]));
        const std::string output = testkit::ReadFile(out);
        EXPECT_EQ(output.size(), std::stoul(c[5]));
        EXPECT_TRUE(output.empty() || output == input.substr(std::stoul(c[2]), output.size()));
    }
}

TEST(Extract, WriteAndReadFailuresAreReported)
{
    testkit::ScratchDir scratch("hf-extract");
    const std::string in = scratch.File("in.bin");
    testkit::WriteFile(in, Pattern(2097152));
    FILE* full = fopen("/dev/full", "wb");
    ASSERT_NE(full, nullptr);
    EXPECT_EQ(Copy(fopen(in.c_str(), "rb"), full, 0, 2097152),
              "Error from fwrite in ExtractEPSfromTIFFpreview\n");
    // A write-only stream cannot be read from: fread sets the error flag.
    EXPECT_EQ(Copy(fopen(in.c_str(), "ab"), fopen(scratch.File("out.bin").c_str(), "wb"), 0, 100),
              "Error from fread in ExtractEPSfromTIFFpreview\n");
}

// The kernel copy stops at the limit half-way; the buffered copy that takes
// over starts again right behind what was written before and reports its
// own failed write. The output holds the right bytes up to the limit.
TEST(Extract, WriteFailingHalfWayThroughTheKernelCopyIsReported)
{
    testkit::ScratchDir scratch("hf-extract");
    const std::string in = scratch.File("in.bin"), out = scratch.File("out.bin");
    const std::string input = Pattern(3000000);
    testkit::WriteFile(in, input);
    const std::string header = "header written before the copy\n";
    const rlim_t limit = 2500000;
    std::string messages;
    {
        const FileSizeLimit lowered(limit);
        FILE* output = fopen(out.c_str(), "wb");
        ASSERT_NE(output, nullptr);
        fputs(header.c_str(), output);
        messages = Copy(fopen(in.c_str(), "rb"), output, 0, 3000000);
    }
    EXPECT_EQ(messages, "Error from fwrite in ExtractEPSfromTIFFpreview\n");
    EXPECT_EQ(testkit::ReadFile(out), header + input.substr(0, limit - header.size()));
}
