// The bytes of the generated job: the cases of tests/data/engine/output.txt
// against golden files, CR LF line ends, "." decimal points under any
// locale, the trailer after a short copy, and failure results.
#include <cstdlib>
#include <regex>
#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "EngineTestSupport.h"

using namespace hf_test;

namespace
{
// The creation date changes with every run; its shape is checked, then it
// is replaced by a fixed mark.
std::string MaskCreationDate(const std::string& output)
{
    static const std::regex date("%%CreationDate: (\\d\\d)/(\\d\\d)/(\\d\\d) "
                                 "(\\d\\d):(\\d\\d) (AM|PM)\r\n");
    EXPECT_TRUE(std::regex_search(output, date)) << "no well-formed creation date";
    return std::regex_replace(output, date, "%%CreationDate: <date>\r\n",
                              std::regex_constants::format_first_only);
}

// Converts an EPS filling box; checks that the input stays untouched, that
// the EPS bytes are copied unchanged and that everything else ends its lines
// with CR LF and never prints "-0", "inf" or "nan". Returns the job's bytes.
std::string Convert(const testkit::ScratchDir& scratch, const std::string& name,
                    const std::string& box, const std::string& options)
{
    double b[4] = {0, 0, 0, 0};
    std::istringstream(box) >> b[0] >> b[1] >> b[2] >> b[3];
    const std::string eps = FilledBoxEps(b[0], b[1], b[2], b[3]);
    const std::string input = scratch.File(name), output = scratch.File("out.ps");
    testkit::WriteFile(input, eps);
    const std::string before = Fingerprint(input);
    std::string spd;
    unlink(output.c_str());
    EXPECT_EQ(DetectAndConvert(input, Params(options == "-" ? "" : options, spd), output), 1);
    EXPECT_TRUE(Fingerprint(input) == before) << "input changed";

    const std::string job = testkit::ReadFile(output);
    const size_t begin = job.find("%%BeginDocument:");
    const size_t body = job.find("\r\n", begin) + 2;
    EXPECT_NE(begin, std::string::npos);
    EXPECT_EQ(job.compare(body, eps.size(), eps), 0) << "EPS bytes not copied unchanged";
    const std::string wrapper = job.substr(0, body) + job.substr(body + eps.size());
    for (size_t i = 0; i < wrapper.size(); ++i)
    {
        EXPECT_FALSE(wrapper[i] == '\n' && (i == 0 || wrapper[i - 1] != '\r'))
            << "bare LF at " << i;
        EXPECT_FALSE(wrapper[i] == '\r' && wrapper[i + 1] != '\n') << "bare CR at " << i;
    }
    EXPECT_EQ(std::regex_search(wrapper, std::regex("[ \\[]-0[ \r\\]]")), false) << "-0 printed";
    EXPECT_EQ(std::regex_search(wrapper, std::regex("[ \\[-](inf|nan)[ \r\\]]")), false)
        << "a number no printer reads";
    return job;
}
} // namespace

TEST(ConvertOutput, TableOfJobs)
{
    testkit::ScratchDir scratch("hf-output");
    for (const auto& c : testkit::Cases("engine/output.txt", 6, 11))
    {
        SCOPED_TRACE(c[0]);
        const std::string job = Convert(scratch, c[1], c[2], c[3]);
        EXPECT_NE(job.find(Unescape(c[5])), std::string::npos);
        if (c[4] == "-")
            continue;
        const std::string masked = MaskCreationDate(job);
        const std::string golden = std::string(HF_TEST_DATA_DIR) + "/engine/golden/" + c[4];
        if (std::getenv("HF_UPDATE_GOLDEN"))
            testkit::WriteFile(golden, masked);
        EXPECT_EQ(masked, testkit::ReadFile(golden)) << "differs from " << golden;
    }
}

TEST(ConvertOutput, CommaLocaleStillWritesFullStops)
{
    testkit::ScratchDir scratch("hf-output");
    const std::string box = "0.5 0.25 300.75 200.5";
    const std::string options = "page 595.5 842.25; pos 4; auto; fit; "
                                "spd << /PageSize [595,5 842,25] >> setpagedevice";
    const std::string inC = MaskCreationDate(Convert(scratch, "x.eps", box, options));
    TESTKIT_USE_LOCALE(german, "de_DE.UTF-8");
    const std::string inGerman = MaskCreationDate(Convert(scratch, "x.eps", box, options));
    const std::string commaName = Convert(scratch, "pic,1.eps", box, options);

    // Only the texts change: the locale's decimal point becomes "." in them.
    std::string expected = inC;
    expected.replace(expected.find("[595,5 842,25]"), 14, "[595.5 842.25]");
    EXPECT_EQ(inGerman, expected);
    EXPECT_NE(inGerman.find("%%HiResBoundingBox: 0 0 595.5 842.25\r\n"), std::string::npos);
    EXPECT_NE(commaName.find("%%Title: /pic.1.eps\r\n"), std::string::npos);
    EXPECT_NE(commaName.find("%%BeginDocument: /pic.1.eps\r\n"), std::string::npos);
}

TEST(ConvertOutput, ShortCopyStillEndsWithTheTrailer)
{
    // A DOS header whose section runs past the end of the file.
    testkit::ScratchDir scratch("hf-output");
    const std::string body = FilledBoxEps(0, 0, 10, 10);
    const std::string input = scratch.File("short.eps");
    testkit::WriteFile(input, DosEpsHeader(30, 5000) + body);
    std::string spd;
    testkit::StderrCapture capture;
    EXPECT_EQ(DetectAndConvert(input, Params("", spd), scratch.File("out.ps")), 1);
    EXPECT_EQ(capture.Text(), "Premature EOF with leftover BytesToRead = " +
                                  std::to_string(5000 - body.size()) + "\n");
    const std::string out = testkit::ReadFile(scratch.File("out.ps"));
    const std::string trailer = "%%EndDocument\r\ncount @ST_count sub\r\n{ pop }\r\nrepeat\r\n"
                                "countdictstack @ST_countdictstack sub\r\n{ end }\r\nrepeat\r\n"
                                "@ST_save\r\nend\r\nrestore\r\nshowpage\r\n%%Trailer\r\n%%EOF\r\n";
    ASSERT_GE(out.size(), trailer.size());
    EXPECT_EQ(out.substr(out.size() - trailer.size()), trailer);
    EXPECT_NE(out.find("%%BeginDocument: /short.eps\r\n%%EndDocument"), std::string::npos);
}

TEST(ConvertOutput, FailuresReleaseTheContextExceptForAnEmptySlot)
{
    testkit::ScratchDir scratch("hf-output");
    std::string spd;
    const EPStoPSparams_t p = Params("", spd);
    EXPECT_EQ(ConvertEPStoPS(nullptr, &p, scratch.File("a.ps").c_str()), 0);
    void* empty = nullptr;
    EXPECT_EQ(ConvertEPStoPS(&empty, &p, scratch.File("a.ps").c_str()), 0);
    EXPECT_STREQ(EPStoPSFailureReason(), "no file description was given");

    const std::string input = scratch.File("in.eps");
    testkit::WriteFile(input, FilledBoxEps(0, 0, 10, 10));
    // No folder for the output, no parameters, a full disk: no complete job,
    // and the reason recorded.
    const struct
    {
        const char* output;
        const char* reason;
    } cases[] = {{"no/such/folder/a.ps", "cannot write a.ps: No such file or directory"},
                 {"", "no output was given"},
                 {"/dev/full", "cannot write full: No space left on device"}};
    for (const auto& c : cases)
    {
        SCOPED_TRACE(c.output);
        void* context = nullptr;
        ASSERT_EQ(IsThisEPS(input.c_str(), &context), 1u);
        const std::string path = *c.output == '/' ? c.output : scratch.File(c.output);
        EXPECT_EQ(ConvertEPStoPS(&context, *c.output ? &p : nullptr, path.c_str()), 0);
        EXPECT_EQ(context, nullptr);
        EXPECT_EQ(EPStoPSFailureKind(), EPS_FAILURE_RESOURCES);
        EXPECT_STREQ(EPStoPSFailureReason(), c.reason);
    }
}
