// Broken files in a hot folder over the table tests/data/host/broken.txt:
// each one done, failed into the failed folder with its reason, or refused
// with its reason, after one "hotfolder run" as an unprivileged user.
#include <map>
#include <sstream>

#include "HostTestSupport.h"

using namespace host_test;

namespace
{
// Table text to bytes: \n and \xHH.
std::string Unescape(const std::string& text)
{
    std::string bytes;
    for (size_t i = 0; i < text.size(); ++i)
        if (text.compare(i, 2, "\\n") == 0)
            bytes += '\n', ++i;
        else if (text.compare(i, 2, "\\x") == 0)
            bytes += static_cast<char>(std::stoi(text.substr(i + 2, 2), nullptr, 16)), i += 3;
        else
            bytes += text[i];
    return bytes;
}

uint32_t HeaderField(const std::string& bytes, size_t at)
{
    uint32_t value = 0;
    for (int i = 3; i >= 0; --i)
        value = value << 8 | static_cast<unsigned char>(bytes[at + i]);
    return value;
}

std::string Replace(std::string text, const std::string& from, const std::string& to)
{
    for (size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
    return text;
}

size_t Count(const std::string& text, const std::string& part)
{
    size_t count = 0;
    for (size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1))
        ++count;
    return count;
}

// True when text holds no control character but tabs and line ends.
bool OnlyPrintable(const std::string& text)
{
    for (const char c : text)
        if ((static_cast<unsigned char>(c) < 0x20 && c != '\t' && c != '\n') || c == 0x7F)
            return false;
    return true;
}

class HostBrokenInput : public HostTest
{
protected:
    // The bytes a file column describes, before its "; mode" part.
    std::string Make(const std::string& description)
    {
        std::vector<std::string> parts = testkit::Split(description, "; ");
        const std::string& first = parts[0];
        const size_t blank = first.find(' ');
        const std::string kind = first.substr(0, blank);
        const std::string argument = blank == std::string::npos ? "" : first.substr(blank + 1);
        std::string bytes;
        if (kind == "example")
            bytes = ReadFile(kExamples + "/eps/" + argument);
        else if (kind == "epstool")
            bytes = EpstoolBinary(argument);
        else if (kind == "box")
            bytes = "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: " + Unescape(argument) +
                    "\n%%EndComments\n0 0 moveto 72 72 lineto stroke\n";
        else if (kind == "bytes")
            bytes = Unescape(argument);
        else
            ADD_FAILURE() << "unknown file kind " << kind;
        for (size_t i = 1; i < parts.size(); ++i)
        {
            std::istringstream words(parts[i]);
            std::string field, value;
            words >> field >> value;
            if (field != "offset" && field != "length")
                continue;
            const size_t at = field == "offset" ? 4 : 8;
            const uint32_t number = value[0] == '+'
                                        ? HeaderField(bytes, at) + std::stoul(value.substr(1))
                                        : static_cast<uint32_t>(std::stoul(value));
            for (int b = 0; b < 4; ++b)
                bytes[at + b] = static_cast<char>((number >> (8 * b)) & 0xFF);
        }
        return bytes;
    }

    // A DOS EPS binary epstool makes from an example, made once per example.
    std::string EpstoolBinary(const std::string& example)
    {
        std::string& made = m_epstool[example];
        if (made.empty())
        {
            const std::string path = scratch + "/epstool-" + example;
            const testkit::ProcessResult run =
                testkit::RunProgram({"epstool", "--add-tiff-preview", "--device", "tiffg3",
                                     kExamples + "/eps/" + example, path});
            EXPECT_EQ(run.exitCode, 0) << run.err;
            made = ReadFile(path);
            unlink(path.c_str());
            EXPECT_EQ(made.compare(0, 4, "\xC5\xD0\xD3\xC6"), 0) << "epstool made no DOS EPS";
        }
        return made;
    }

    std::map<std::string, std::string> m_epstool;
};
} // namespace

TEST_F(HostBrokenInput, EachFileEndsAsTheTableSaysWithItsReason)
{
    if (!testkit::ProgramAvailable("epstool") ||
        (testkit::RunsAsRoot() && !testkit::ProgramAvailable("setpriv")))
        GTEST_SKIP() << "needs epstool, and setpriv when run as root";
    const std::string folder = MakePostScriptFolder();
    const auto rows = testkit::Cases("host/broken.txt", 5, 20);
    std::map<std::string, std::string> expected; // name -> reason with its numbers
    size_t done = 0, failed = 0, refused = 0;
    for (const auto& c : rows)
    {
        const std::string path = folder + "/" + c[0];
        const std::string bytes = Make(c[1]);
        ASSERT_TRUE(WriteFile(path, bytes)) << c[0];
        if (c[1].find("; mode 000") != std::string::npos)
        {
            ASSERT_EQ(chmod(path.c_str(), 0), 0);
        }
        std::string reason = Replace(c[3], "$SIZE", std::to_string(bytes.size()));
        if (bytes.size() >= 12)
        {
            reason = Replace(reason, "$OFFSET", std::to_string(HeaderField(bytes, 4)));
            reason = Replace(reason, "$LENGTH", std::to_string(HeaderField(bytes, 8)));
        }
        expected[c[0]] = reason;
        done += c[2] == "done";
        failed += c[2] == "failed";
        refused += c[2] == "refused";
    }
    // Everything belongs to the unprivileged user, who may enter every folder.
    ASSERT_EQ(chmod(scratch.c_str(), 0755), 0);
    ASSERT_TRUE(testkit::HandOver(scratch));

    const testkit::ProcessResult run =
        testkit::RunProgram(testkit::Unprivileged({kHost, "run", folder}));
    EXPECT_EQ(run.exitCode, failed > 0 ? 1 : 0) << run.err;
    const std::string log = ReadFile(Failed(folder) + "/failed-jobs.log");
    EXPECT_NE(run.out.find(std::to_string(done) + " done, " + std::to_string(failed) + " failed, " +
                           std::to_string(refused) + " refused"),
              std::string::npos)
        << run.out;
    EXPECT_TRUE(OnlyPrintable(log) && OnlyPrintable(run.out) && OnlyPrintable(run.err))
        << log << run.out << run.err;

    for (const auto& c : rows)
    {
        SCOPED_TRACE(c[0] + ": " + c[4]);
        const std::string& name = c[0];
        const std::string& reason = expected[name];
        const std::string stem = name.substr(0, name.rfind('.'));
        const std::string refusal = "refused (left in place): " + folder + "/" + name;
        EXPECT_EQ(Exists(folder + "/" + name), c[2] == "refused");
        EXPECT_EQ(Exists(Kept(folder) + "/" + name), c[2] == "done");
        EXPECT_EQ(Exists(folder + "/Output/" + stem + ".ps"), c[2] == "done");
        EXPECT_EQ(Exists(Failed(folder) + "/" + name), c[2] == "failed");
        // Exactly one line of the failure log, one refusal, for what failed or was refused.
        EXPECT_EQ(Count(log, "\t" + name + "\t"), c[2] == "failed" ? 1u : 0u);
        EXPECT_EQ(Count(run.out, refusal), c[2] == "refused" ? 1u : 0u) << run.out;
        if (c[2] == "failed")
        {
            EXPECT_EQ(Count(log, "\t" + name + "\t" + reason), 1u) << log;
            EXPECT_EQ(Count(run.err, name + ": " + reason), 1u) << run.err;
        }
        if (c[2] == "refused")
        {
            EXPECT_EQ(Count(run.out, refusal + ": " + reason + "\n"), 1u) << run.out;
        }
    }
}
