// Detection and header scan over the table tests/data/engine/detect.txt:
// which files are EPS, where their program lies and which bounding box they
// declare, in the C locale and again under a decimal-comma locale.
#include <dirent.h>

#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "EngineTestSupport.h"
#include "posix/AllocationFailures.h"

using namespace hf_test;

namespace
{
int OpenDescriptorCount()
{
    int count = 0;
    if (DIR* dir = opendir("/proc/self/fd"))
    {
        while (readdir(dir))
            ++count;
        closedir(dir);
    }
    return count;
}

// A table field that differs by locale is "IN C ; UNDER A DECIMAL COMMA".
std::string ForLocale(const std::string& field, bool decimalComma)
{
    const size_t split = field.find(" ; ");
    if (split == std::string::npos)
        return field;
    return decimalComma ? field.substr(split + 3) : field.substr(0, split);
}

void RunTable(bool decimalComma)
{
    testkit::ScratchDir scratch("hf-detect");
    for (const auto& c : testkit::Cases("engine/detect.txt", 7, 41))
    {
        SCOPED_TRACE(c[0]);
        const std::string path = TableInput(scratch, c[1]);
        ASSERT_FALSE(path.empty());
        int skip = 0, fail = 0;
        std::istringstream(c[2]) >> skip >> fail;

        void* context = reinterpret_cast<void*>(0x1); // an earlier value must be overwritten
        testkit::StderrCapture capture;
        posix::SetAllocationFailuresForTesting(skip, fail);
        const unsigned result = IsThisEPS(path.c_str(), &context);
        posix::SetAllocationFailuresForTesting(0, 0);
        const std::string messages = capture.Text();

        EXPECT_EQ(std::to_string(result), ForLocale(c[3], decimalComma));
        EXPECT_EQ(messages, c[6] == "-" ? "" : Unescape(c[6]));
        if (result == 1)
        {
            const EPSinfo_t info = *static_cast<EPSinfo_t*>(context);
            EXPECT_NE(info.epsFile, nullptr);
            EXPECT_EQ(Num(info.boundingBox[0]) + " " + Num(info.boundingBox[1]) + " " +
                          Num(info.boundingBox[2]) + " " + Num(info.boundingBox[3]),
                      ForLocale(c[4], decimalComma));
            const std::string section =
                std::to_string(info.psOffset) + " " + std::to_string(info.psLength);
            EXPECT_TRUE(c[5] == "-" || c[5] == section) << section;
            EPStoPSfreeMemory(&context);
        }
        EXPECT_EQ(context, nullptr);
    }
}
} // namespace

TEST(Detect, TableOfFiles)
{
    RunTable(false);
}

TEST(Detect, TableOfFilesUnderADecimalCommaLocale)
{
    TESTKIT_USE_LOCALE(german, "de_DE.UTF-8");
    RunTable(true);
}

TEST(Detect, DocumentNameIsTheLastPathPartWithItsSlash)
{
    testkit::ScratchDir scratch("hf-detect");
    const std::string text = "%!PS-Adobe-3.0 EPSF-3.0\n%%EndComments\n";
    const std::string longName(100, 'n');
    char previous[4096];
    ASSERT_NE(getcwd(previous, sizeof previous), nullptr);
    ASSERT_EQ(chdir(scratch.Path().c_str()), 0);
    const struct
    {
        std::string path, docName;
    } cases[] = {
        {scratch.File("pic.eps"), "/pic.eps"},
        {scratch.File(longName), "/" + longName.substr(0, 62)}, // cut to 63 characters
        {"bare.eps", "bare.eps"},                               // no slash: the whole path
    };
    for (const auto& c : cases)
    {
        testkit::WriteFile(c.path, text);
        void* context = nullptr;
        ASSERT_EQ(IsThisEPS(c.path.c_str(), &context), 1u);
        EXPECT_EQ(std::string(static_cast<EPSinfo_t*>(context)->docName), c.docName);
        EPStoPSfreeMemory(&context);
    }
    ASSERT_EQ(chdir(previous), 0);
}

TEST(Detect, ReleaseIsSafeAndInputsStayUntouched)
{
    void** noSlot = nullptr;
    EPStoPSfreeMemory(noSlot);
    void* empty = nullptr;
    EPStoPSfreeMemory(&empty);
    EXPECT_EQ(empty, nullptr);
    EXPECT_EQ(IsThisEPS("x.eps", nullptr), 0u);

    testkit::ScratchDir scratch("hf-detect");
    const std::vector<std::string> inputs = {"%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 1 1\n",
                                             "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: (atend)\n",
                                             DosEpsHeader(0xFFFFFFF0u, 0xFFFFFFFFu), "%!PS-Adobe"};
    const int descriptors = OpenDescriptorCount();
    for (const std::string& bytes : inputs)
    {
        const std::string input = scratch.File("in.eps");
        testkit::WriteFile(input, bytes);
        const std::string before = Fingerprint(input);
        void* context = nullptr;
        if (IsThisEPS(input.c_str(), &context) == 1)
        {
            EPStoPSfreeMemory(&context);
            EPStoPSfreeMemory(&context); // a second release does nothing
        }
        EXPECT_EQ(context, nullptr);
        EXPECT_TRUE(Fingerprint(input) == before) << bytes;
    }
    EXPECT_EQ(OpenDescriptorCount(), descriptors);
}
