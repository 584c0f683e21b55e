// Why a file cannot be printed, over the table tests/data/engine/reasons.txt:
// the step that stops it, the kind of trouble and the operator's sentence.
#include <fcntl.h>
#include <sys/stat.h>

#include <cstdio>
#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "EngineTestSupport.h"
#include "posix/AllocationFailures.h"

using namespace hf_test;

namespace
{
const char* const kKindNames[] = {"none",    "missing", "unreadable", "not-eps",
                                  "damaged", "bad-box", "resources"};

std::string Record(const char* step)
{
    const int kind = EPStoPSFailureKind();
    const bool known = kind >= 0 && kind < static_cast<int>(std::size(kKindNames));
    return std::string(step) + " | " + (known ? kKindNames[kind] : "?") + " | " +
           (*EPStoPSFailureReason() ? EPStoPSFailureReason() : "-");
}

// Detects, checks and converts until a step fails: "STEP | KIND | REASON".
std::string Evaluate(const std::string& input, const std::string& output, int skip, int fail)
{
    void* context = nullptr;
    posix::SetAllocationFailuresForTesting(skip, fail);
    const unsigned detected = IsThisEPS(input.c_str(), &context);
    posix::SetAllocationFailuresForTesting(0, 0);
    if (!detected)
        return Record("detect");
    if (!CheckEPSInput(context))
    {
        EPStoPSfreeMemory(&context);
        return Record("check");
    }
    std::string spd;
    const EPStoPSparams_t params = Params("", spd);
    if (!ConvertEPStoPS(&context, &params, output.c_str()))
        return Record("convert");
    return Record("none");
}
} // namespace

TEST(FailureReason, TableOfFiles)
{
    testkit::ScratchDir scratch("hf-reasons");
    // Only the file's own mode may keep an unprivileged reader out.
    ASSERT_EQ(chmod(scratch.Path().c_str(), 0755), 0);
    for (const auto& c : testkit::Cases("engine/reasons.txt", 7, 40))
    {
        SCOPED_TRACE(c[0]);
        const std::string input = TableInput(scratch, c[1]);
        ASSERT_FALSE(input.empty());
        int skip = 0, fail = 0;
        std::istringstream(c[2]) >> skip >> fail;
        const std::string output = scratch.File("out.ps");
        std::string seen;
        if (c[3] == "-" || c[3].find('_') != std::string::npos)
        {
            testkit::ScopedLocale locale(c[3] == "-" ? "C" : c[3].c_str());
            if (!locale)
            {
                std::printf("%s: %s\n", c[0].c_str(), locale.Reason().c_str());
                continue;
            }
            testkit::StderrCapture quiet; // the engine's messages are detect.txt's
            seen = Evaluate(input, output, skip, fail);
        }
        else
        {
            ASSERT_EQ(chmod(input.c_str(), std::stoi(c[3], nullptr, 8)), 0);
            ASSERT_EQ(chmod(scratch.Path().c_str(), 0777), 0); // for the reader's output
            seen = testkit::AsUnprivileged(
                [&]
                {
                    dup2(open("/dev/null", O_WRONLY), 2);
                    return Evaluate(input, output, skip, fail);
                });
            chmod(scratch.Path().c_str(), 0755);
            unlink(output.c_str());
        }
        EXPECT_EQ(seen, c[4] + " | " + c[5] + " | " + c[6]);
    }
}

TEST(FailureReason, EachCallStartsAfresh)
{
    testkit::ScratchDir scratch("hf-reasons");
    const std::string bad = scratch.File("bad.eps"), good = scratch.File("good.eps");
    testkit::WriteFile(bad, "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 nan 1\n");
    testkit::WriteFile(good, FilledBoxEps(0, 0, 10, 10));
    void* context = nullptr;
    ASSERT_EQ(IsThisEPS(bad.c_str(), &context), 1u);
    EXPECT_EQ(CheckEPSInput(context), 0);
    // A later call that succeeds leaves no reason behind, whichever it is.
    void* other = nullptr;
    ASSERT_EQ(IsThisEPS(good.c_str(), &other), 1u);
    EXPECT_EQ(Record("detect"), "detect | none | -");
    EXPECT_EQ(CheckEPSInput(context), 0);
    EXPECT_EQ(CheckEPSInput(other), 1);
    EXPECT_EQ(Record("check"), "check | none | -");
    // The check leaves the context to the caller, unchanged.
    EXPECT_NE(static_cast<EPSinfo_t*>(context)->epsFile, nullptr);
    EXPECT_EQ(std::string(static_cast<EPSinfo_t*>(context)->boxLine), "%%BoundingBox: 0 0 nan 1");
    EPStoPSfreeMemory(&context);
    EPStoPSfreeMemory(&other);
    EXPECT_EQ(CheckEPSInput(nullptr), 0);
    EXPECT_EQ(Record("check"), "check | resources | no file description was given");
    EXPECT_EQ(IsThisEPS(good.c_str(), nullptr), 0u);
    EXPECT_EQ(EPStoPSFailureKind(), EPS_FAILURE_RESOURCES);
    testkit::StderrCapture quiet;
    EXPECT_EQ(IsThisEPS(nullptr, &context), 0u);
    EXPECT_EQ(Record("detect"), "detect | missing | no file was named");
}
