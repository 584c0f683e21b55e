// The preflight's verdict on outputs, with the Ghostscript installed (the
// whole road with hotfolder run is in tests/data/host/preflight.txt).
#include <cstdlib>

#include "HostTestSupport.h"
#include "jobs/Preflight.h"

using namespace host_test;

namespace
{
std::string Expanded(std::string text, const std::string& scratch)
{
    for (size_t at = text.find("\\n"); at != std::string::npos; at = text.find("\\n", at + 1))
        text.replace(at, 2, "\n");
    for (size_t at = text.find("$S"); at != std::string::npos; at = text.find("$S", at + 1))
        text.replace(at, 2, scratch);
    return text;
}

// Sets one variable for a case and puts the old value back.
class ScopedVariable
{
public:
    explicit ScopedVariable(const std::string& assignment)
    {
        if (assignment == "-")
            return;
        m_name = assignment.substr(0, assignment.find('='));
        const char* old = std::getenv(m_name.c_str());
        m_had = old != nullptr;
        m_old = old ? old : "";
        setenv(m_name.c_str(), assignment.substr(m_name.size() + 1).c_str(), 1);
    }
    ~ScopedVariable()
    {
        if (m_name.empty())
            return;
        if (m_had)
            setenv(m_name.c_str(), m_old.c_str(), 1);
        else
            unsetenv(m_name.c_str());
    }

private:
    std::string m_name, m_old;
    bool m_had = false;
};
} // namespace

TEST(HostPreflight, OutputsAsGhostscriptSeesThem)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript is not installed";
    testkit::ScratchDir scratch("hf-preflight");
    scratch.Sub("empty");
    for (const testkit::CaseFields& c : testkit::Cases("host/preflight-outputs.txt", 4, 10))
    {
        SCOPED_TRACE(c[0] + " | " + c[3]);
        const std::string output = scratch.File("output.ps");
        ASSERT_TRUE(WriteFile(output, Expanded(c[0], scratch.Path())));
        const ScopedVariable variable(Expanded(c[1], scratch.Path()));
        const std::string reason = PreflightProblem(output);
        const std::string expected = Expanded(c[2].substr(1), scratch.Path());
        if (c[2][0] == '=')
            EXPECT_EQ(reason, expected);
        else
            EXPECT_NE(reason.find(expected), std::string::npos) << reason;
    }
}
