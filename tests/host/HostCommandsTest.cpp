// The host's commands as a user runs them, from the tables of tests/data/host.
#include "HostScript.h"

using host_test::HostScript;

TEST_F(HostScript, Commands)
{
    Run("commands.txt");
}
TEST_F(HostScript, RefusedRuns)
{
    Run("failures.txt");
}
TEST_F(HostScript, Runs)
{
    Run("run.txt");
}
TEST_F(HostScript, Preflight)
{
    Run("preflight.txt");
}

TEST_F(HostScript, SettingsWindow)
{
    if (!std::getenv("DISPLAY"))
        GTEST_SKIP() << "needs a display (the suite runs under xvfb-run)";
    Run("window.txt");
}
TEST_F(HostScript, RefusalsAndWarnings)
{
    Run("guards.txt");
}
