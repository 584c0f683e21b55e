// Detection and header scan: which files are EPS, where their program lies
// and which bounding box they declare.
#include <dirent.h>
#include <sys/wait.h>

#include <clocale>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "posix/AllocationFailures.h"
#include "EngineTestSupport.h"

using namespace hf_test;

namespace
{
struct Detection
{
    unsigned result = 0;
    EPSinfo_t info{}; // copy taken before release; epsFile is stale then
    std::string messages;
};

Detection Detect(const std::string& path)
{
    Detection d;
    void* context = reinterpret_cast<void*>(0x1); // an earlier value must be overwritten
    {
        StderrCapture capture;
        d.result = IsThisEPS(path.c_str(), &context);
        d.messages = capture.Text();
    }
    if (d.result == 1)
    {
        EXPECT_NE(context, nullptr);
        d.info = *static_cast<EPSinfo_t*>(context);
        EXPECT_NE(d.info.epsFile, nullptr);
        EPStoPSfreeMemory(&context);
    }
    EXPECT_EQ(context, nullptr);
    return d;
}

void ExpectBox(const EPSinfo_t& info, double llx, double lly, double urx, double ury)
{
    EXPECT_DOUBLE_EQ(info.boundingBox[0], llx);
    EXPECT_DOUBLE_EQ(info.boundingBox[1], lly);
    EXPECT_DOUBLE_EQ(info.boundingBox[2], urx);
    EXPECT_DOUBLE_EQ(info.boundingBox[3], ury);
}

// Bytes of a literal that holds NULs.
template <size_t N> std::string Bytes(const char (&text)[N])
{
    return std::string(text, N - 1);
}

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

class Detect_ : public ::testing::Test
{
protected:
    std::string Write(const std::string& name, const std::string& bytes)
    {
        const std::string path = scratch.File(name);
        WriteBytes(path, bytes);
        return path;
    }
    ScratchDir scratch;
};
} // namespace

TEST_F(Detect_, PlainFileGivesWholeFileAndItsBox)
{
    const std::string text = "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 612 792\n%%EndComments\n";
    const Detection d = Detect(Write("plain.eps", text));
    ASSERT_EQ(d.result, 1u);
    EXPECT_EQ(d.info.psOffset, 0);
    EXPECT_EQ(d.info.psLength, static_cast<int64_t>(text.size()));
    ExpectBox(d.info, 0, 0, 612, 792);
    EXPECT_EQ(d.messages, "");
}

TEST_F(Detect_, HighResolutionBoxWinsAndEndsTheScan)
{
    const std::string head = "%!PS-Adobe-3.0 EPSF-3.0\n";
    Detection after = Detect(Write("a.eps", head + "%%BoundingBox: 0 0 612 792\n"
                                                   "%%HiResBoundingBox: 0.5 0.5 611.5 791.5\n"));
    ASSERT_EQ(after.result, 1u);
    ExpectBox(after.info, 0.5, 0.5, 611.5, 791.5);

    Detection before = Detect(Write("b.eps", head + "%%HiResBoundingBox: 0.5 0.5 611.5 791.5\n"
                                                    "%%BoundingBox: 0 0 612 792\n"));
    ASSERT_EQ(before.result, 1u);
    ExpectBox(before.info, 0.5, 0.5, 611.5, 791.5);

    // Nothing after the scan's end is read, not even a malformed box.
    Detection ended = Detect(Write("c.eps", head + "%%BoundingBox: 1 2 3 4\n%%EndComments\n"
                                                   "%%BoundingBox: (atend)\n"));
    ASSERT_EQ(ended.result, 1u);
    ExpectBox(ended.info, 1, 2, 3, 4);

    // A later plain box replaces an earlier one.
    Detection later = Detect(Write("d.eps", head + "%%BoundingBox: 1 2 3 4\n"
                                                   "%%BoundingBox: -5 -6 7 8\n%%EndComments\n"));
    ASSERT_EQ(later.result, 1u);
    ExpectBox(later.info, -5, -6, 7, 8);
}

TEST_F(Detect_, BoxesWithoutFourNumbersRejectTheFile)
{
    const std::string head = "%!PS-Adobe-3.0 EPSF-3.0\n";
    for (const char* box : {"%%BoundingBox: (atend)\n", "%%BoundingBox: 0 0 10\n",
                            "%%HiResBoundingBox: (atend)\n", "%%BoundingBox:\n"})
    {
        const Detection d = Detect(Write("box.eps", head + box + "%%EndComments\n"));
        EXPECT_EQ(d.result, 0u) << box;
        EXPECT_EQ(d.messages, "") << box;
    }
}

TEST_F(Detect_, FirstLineMustBeAnEpsSignature)
{
    const struct
    {
        const char* line;
        unsigned expected;
    } cases[] = {
        {"%!PS-Adobe-3.0 EPSF-3.0", 1},
        {"%!PS-Adobe-2.0\tEPSF-1.2", 1},
        {"%!PS-Adobe-3.0 EPSF3", 1},
        {"%!PS-Adobe-3.0", 0},
        {"%!PS-Adobe-3.0 EPSF", 0},
        {"%!PS-Adobe EPSF-3.0", 0},
        {"%!PS-Adobe-3.0  EPSF-3.0", 1},
        {"%!PS-Adobe-3.0 eps-3.0", 0},
        {"%!PS", 0},
        {"garbage that is long enough", 0},
    };
    for (const auto& c : cases)
    {
        const Detection d = Detect(Write("sig.eps", std::string(c.line) + "\n%%EndComments\n"));
        EXPECT_EQ(d.result, c.expected) << c.line;
        EXPECT_EQ(d.messages, "") << c.line;
    }
    // EPSF on the second line does not count.
    const Detection split = Detect(Write("split.eps", "%!PS-Adobe-3.0\rEPSF-3.0\n"));
    EXPECT_EQ(split.result, 0u);
}

TEST_F(Detect_, MissingBoxGivesZeroBox)
{
    const Detection d = Detect(Write("nobox.eps", "%!PS-Adobe-3.0 EPSF-3.0\n%%EndComments\n"));
    ASSERT_EQ(d.result, 1u);
    ExpectBox(d.info, 0, 0, 0, 0);
}

TEST_F(Detect_, DosBinaryHeaderLocatesThePostScriptSection)
{
    std::string body = "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 10 20 30 40\n%%EndComments\n";
    body.resize(1000, ' ');
    const Detection d = Detect(Write("dos.eps", DosEpsHeader(30, 1000) + body + "PREVIEW"));
    ASSERT_EQ(d.result, 1u);
    EXPECT_EQ(d.info.psOffset, 30);
    EXPECT_EQ(d.info.psLength, 1000);
    ExpectBox(d.info, 10, 20, 30, 40);

    // Offset or length 0: rejected silently.
    EXPECT_EQ(Detect(Write("len0.eps", DosEpsHeader(30, 0) + body)).result, 0u);
    EXPECT_EQ(Detect(Write("off0.eps", DosEpsHeader(0, 1000) + body)).result, 0u);

    // A section beyond the end has no signature to find.
    const Detection past = Detect(Write("past.eps", DosEpsHeader(1u << 30, 1000) + body));
    EXPECT_EQ(past.result, 0u);
    EXPECT_EQ(past.messages, "");

    // A section far behind a large preview is found too, and its header is
    // scanned from the section's start, not from the file's.
    const std::string preview(200000, '\n');
    const std::string decoy = "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 9 9 9 9\n";
    const Detection far =
        Detect(Write("far.eps", DosEpsHeader(30 + 200000, 1000) + preview + body));
    ASSERT_EQ(far.result, 1u);
    ExpectBox(far.info, 10, 20, 30, 40);
    std::string early = DosEpsHeader(30 + 100, 1000) + decoy;
    early.resize(30 + 100, ' ');
    const Detection shifted = Detect(Write("shifted.eps", early + body));
    ASSERT_EQ(shifted.result, 1u);
    ExpectBox(shifted.info, 10, 20, 30, 40);

    // The largest length is taken as it is; copying finds out later.
    const Detection huge = Detect(Write("huge.eps", DosEpsHeader(30, 0xFFFFFFFFu) + body));
    ASSERT_EQ(huge.result, 1u);
    EXPECT_EQ(huge.info.psLength, 0xFFFFFFFFLL);
}

TEST_F(Detect_, DocumentNameIsTheLastPathPartWithItsSlash)
{
    const std::string text = "%!PS-Adobe-3.0 EPSF-3.0\n%%EndComments\n";
    EXPECT_STREQ(Detect(Write("pic.eps", text)).info.docName, "/pic.eps");

    const std::string longName(100, 'n');
    const Detection cut = Detect(Write(longName, text));
    ASSERT_EQ(cut.result, 1u);
    EXPECT_EQ(std::string(cut.info.docName), "/" + longName.substr(0, 62));

    char previous[4096];
    ASSERT_NE(getcwd(previous, sizeof previous), nullptr);
    ASSERT_EQ(chdir(scratch.Path().c_str()), 0);
    const Detection bare = Detect("pic.eps");
    ASSERT_EQ(chdir(previous), 0);
    EXPECT_STREQ(bare.info.docName, "pic.eps");
}

TEST_F(Detect_, LineBreaksOfEveryKindSeparateLines)
{
    for (const char* br : {"\r", "\n", "\r\n", "\n\n\r\r\n"})
    {
        const std::string b = br;
        const Detection d =
            Detect(Write("br.eps", "%!PS-Adobe-3.0 EPSF-3.0" + b + "%%BoundingBox: 1 2 3 4" + b +
                                       "%%EndComments" + b));
        ASSERT_EQ(d.result, 1u);
        ExpectBox(d.info, 1, 2, 3, 4);
    }
    // The last line needs no break at all.
    const Detection last =
        Detect(Write("last.eps", "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 5 6 7 8"));
    ASSERT_EQ(last.result, 1u);
    ExpectBox(last.info, 5, 6, 7, 8);
}

TEST_F(Detect_, ScanReadsAtMostAThousandLines)
{
    auto fileWithBoxOnLine = [&](int lineNumber)
    {
        std::string text = "%!PS-Adobe-3.0 EPSF-3.0\n";
        for (int line = 2; line < lineNumber; ++line)
            text += (line % 2) ? "%%Filler: comment\n" : "plain line\n";
        return Write("limit.eps", text + "%%BoundingBox: 1 2 3 4\n");
    };
    const Detection within = Detect(fileWithBoxOnLine(1000));
    ASSERT_EQ(within.result, 1u);
    ExpectBox(within.info, 1, 2, 3, 4);
    const Detection beyond = Detect(fileWithBoxOnLine(1001));
    ASSERT_EQ(beyond.result, 1u);
    ExpectBox(beyond.info, 0, 0, 0, 0);
}

TEST_F(Detect_, VeryLongLinesAreSkippedAndScanningGoesOn)
{
    for (size_t length : {size_t(300), size_t(65534), size_t(65535), size_t(10) << 20})
    {
        const std::string text = "%!PS-Adobe-3.0 EPSF-3.0\n%" + std::string(length, 'x') +
                                 "\n%%BoundingBox: 1 2 3 4\n%%EndComments\n";
        const Detection d = Detect(Write("long.eps", text));
        ASSERT_EQ(d.result, 1u) << length;
        ExpectBox(d.info, 1, 2, 3, 4);
        EXPECT_EQ(d.messages, "");
    }
}

TEST_F(Detect_, NulBytesInTheHeaderAreHarmless)
{
    const std::string nulInComment = Bytes("%!PS-Adobe-3.0 EPSF-3.0\n%%Bounding\0Box: 1 2 3 4\n"
                                           "%%BoundingBox: 5 6\0 7 8\n%%EndComments\n");
    const Detection comment = Detect(Write("nul1.eps", nulInComment));
    // The box line is cut at the NUL and so lacks numbers.
    EXPECT_EQ(comment.result, 0u);

    const std::string nulLines = Bytes("%!PS-Adobe-3.0 EPSF-3.0\n\0\0\0\n%%BoundingBox: 1 2 3 4\n");
    const Detection lines = Detect(Write("nul2.eps", nulLines));
    ASSERT_EQ(lines.result, 1u);
    ExpectBox(lines.info, 1, 2, 3, 4);

    const std::string nulSignature = Bytes("%!PS-Adobe-3.0\0EPSF-3.0\n");
    EXPECT_EQ(Detect(Write("nul3.eps", nulSignature)).result, 0u);
}

TEST_F(Detect_, NumbersParseWithFullStopUnderACommaLocale)
{
    const char* previous = setlocale(LC_ALL, nullptr);
    const std::string saved = previous ? previous : "C";
    if (!setlocale(LC_ALL, "de_DE.UTF-8"))
        GTEST_SKIP() << "de_DE.UTF-8 locale not installed (scripts/setup.sh makes it)";
    const Detection d = Detect(Write("de.eps", "%!PS-Adobe-3.0 EPSF-3.0\n"
                                               "%%HiResBoundingBox: 0.5 1.25 611.5 791.75\n"));
    setlocale(LC_ALL, saved.c_str());
    ASSERT_EQ(d.result, 1u);
    ExpectBox(d.info, 0.5, 1.25, 611.5, 791.75);
}

TEST_F(Detect_, UnusableInputsAreRejectedWithTheirMessage)
{
    const Detection missing = Detect(scratch.File("missing.eps"));
    EXPECT_EQ(missing.result, 0u);
    EXPECT_EQ(missing.messages, "Error from fopen in IsThisEPS\n");

    const Detection shortFile = Detect(Write("short.eps", "%!PS-Adobe-"));
    EXPECT_EQ(shortFile.result, 0u);
    EXPECT_EQ(shortFile.messages, "");

    const Detection empty = Detect(Write("empty.eps", ""));
    EXPECT_EQ(empty.result, 0u);
    EXPECT_EQ(empty.messages, "");

    // Linux opens a folder for reading; the read then fails.
    const Detection folder = Detect(scratch.Path());
    EXPECT_EQ(folder.result, 0u);
    EXPECT_EQ(folder.messages, "Error from fread of header in IsThisEPS\n");

    const Detection truncated = Detect(Write("trunc.eps", "%!PS-Adobe-3.0 EPSF-3.0\n%%Boundi"));
    EXPECT_EQ(truncated.result, 1u);
    ExpectBox(truncated.info, 0, 0, 0, 0);
}

TEST_F(Detect_, UnreadableFileIsRejected)
{
    const std::string path = Write("secret.eps", "%!PS-Adobe-3.0 EPSF-3.0\n%%EndComments\n");
    ASSERT_EQ(chmod(path.c_str(), 0600), 0);
    if (geteuid() != 0)
    {
        EXPECT_EQ(Detect(path).result, 1u); // owner may read; nothing to drop
        GTEST_SKIP() << "needs root to test as another user";
    }
    // A child running as nobody must be refused by the kernel itself.
    const pid_t child = fork();
    ASSERT_GE(child, 0);
    if (child == 0)
    {
        if (setgid(65534) != 0 || setuid(65534) != 0)
            _exit(90);
        StderrCapture capture;
        void* context = nullptr;
        const unsigned result = IsThisEPS(path.c_str(), &context);
        const bool message = capture.Text() == "Error from fopen in IsThisEPS\n";
        _exit(result == 0 && context == nullptr && message ? 0 : 91);
    }
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 0);
}

TEST_F(Detect_, LineBufferDegradesStepByStep)
{
    // Boxes far from the start make the small buffers refill many times.
    std::string text = "%!PS-Adobe-3.0 EPSF-3.0\n";
    for (int i = 0; i < 60; ++i)
        text += "%%Comment: line number " + std::to_string(i) + " of the header\n";
    text += "%%BoundingBox: 11 12 13 14\n%%EndComments\n";
    const std::string path = Write("degrade.eps", text);

    const struct
    {
        int failures;
        unsigned result;
        const char* messages;
    } steps[] = {
        {1, 1, "64KB not available from malloc; trying smaller amount\n"},
        {2, 1,
         "64KB not available from malloc; trying smaller amount\n"
         "4KB not available from malloc; trying smaller amount\n"},
        {3, 0,
         "64KB not available from malloc; trying smaller amount\n"
         "4KB not available from malloc; trying smaller amount\n"
         "Even 256 bytes not available for copy buffer in ExtractEPSfromTIFFpreview\n"},
    };
    for (const auto& step : steps)
    {
        posix::SetAllocationFailuresForTesting(1, step.failures); // the context itself succeeds
        const Detection d = Detect(path);
        posix::SetAllocationFailuresForTesting(0, 0);
        EXPECT_EQ(d.result, step.result) << step.failures;
        EXPECT_EQ(d.messages, step.messages);
        if (step.result == 1)
            ExpectBox(d.info, 11, 12, 13, 14);
    }

    posix::SetAllocationFailuresForTesting(0, 1);
    const Detection noContext = Detect(path);
    posix::SetAllocationFailuresForTesting(0, 0);
    EXPECT_EQ(noContext.result, 0u);
    EXPECT_EQ(noContext.messages, "Error from malloc in IsThisEPS\n");
}

TEST_F(Detect_, SmallestBufferReadsLinesAcrossRefills)
{
    // Lines of every length around the 256-byte buffer's edges.
    std::string text = "%!PS-Adobe-3.0 EPSF-3.0\n";
    for (int length = 240; length < 262; ++length)
        text += "%" + std::string(length, 'a' + length % 26) + "\n";
    text += "%%BoundingBox: 21 22 23 24\n";
    for (int length = 1; length < 300; length += 37)
        text += "%" + std::string(length, 'z') + "\r\n";
    text += "%%HiResBoundingBox: 1.5 2.5 3.5 4.5\n";
    const std::string path = Write("refill.eps", text);
    posix::SetAllocationFailuresForTesting(1, 2);
    const Detection d = Detect(path);
    posix::SetAllocationFailuresForTesting(0, 0);
    ASSERT_EQ(d.result, 1u);
    ExpectBox(d.info, 1.5, 2.5, 3.5, 4.5);
}

TEST_F(Detect_, ReleaseIsSafeAndInputsStayUntouched)
{
    void** noSlot = nullptr;
    EPStoPSfreeMemory(noSlot);
    void* empty = nullptr;
    EPStoPSfreeMemory(&empty);
    EXPECT_EQ(empty, nullptr);

    const std::vector<std::string> inputs = {
        Write("ok.eps", "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 1 1\n"),
        Write("atend.eps", "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: (atend)\n"),
        Write("dos.eps", DosEpsHeader(0xFFFFFFF0u, 0xFFFFFFFFu)),
        Write("tiny.eps", "%!PS-Adobe"),
    };
    const int descriptors = OpenDescriptorCount();
    for (const std::string& input : inputs)
    {
        const Fingerprint before = TakeFingerprint(input);
        void* context = nullptr;
        if (IsThisEPS(input.c_str(), &context) == 1)
        {
            EPStoPSfreeMemory(&context);
            EPStoPSfreeMemory(&context); // a second release does nothing
        }
        EXPECT_EQ(context, nullptr);
        EXPECT_TRUE(TakeFingerprint(input) == before) << input;
    }
    EXPECT_EQ(OpenDescriptorCount(), descriptors);
}
