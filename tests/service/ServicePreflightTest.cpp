// The preflight under the service: switched on and off while a folder is
// served, each artwork delivered or failed by the switch in effect.
#include <map>

#include "ServiceTestSupport.h"

using namespace service_test;

TEST_F(ServiceTest, ThePreflightSwitchAppliesFromTheNextJob)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript is not installed";
    const std::string head = "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 36 18\n%%EndComments\n";
    const std::map<std::string, std::string> artworks = {
        {"label", label}, {"undefined", head + "foo\n%%EOF\n"}, {"blank", head + "%%EOF\n"}};
    const std::string folder = MakePostScriptFolder("A4", "hot");
    auto host = Serve(1);
    std::string preflight = "off";
    int row = 0;
    for (const testkit::CaseFields& c : testkit::Cases("service/preflight.txt", 4, 4))
    {
        SCOPED_TRACE(c[0] + " | " + c[1] + " | " + c[3]);
        if (c[0] != preflight)
        {
            const size_t served = Count(host->Err(), "<6>serving " + folder);
            ASSERT_EQ(Host({"settings", folder, "--preflight", c[0]}).exitCode, 0);
            ASSERT_TRUE(
                WaitFor([&] { return Count(host->Err(), "<6>serving " + folder) > served; }, 10000))
                << host->Err();
            preflight = c[0];
        }
        const std::string name = std::to_string(++row) + "-" + c[1];
        WriteFile(scratch + "/staging.eps", artworks.at(c[1]));
        ASSERT_EQ(
            rename((scratch + "/staging.eps").c_str(), (folder + "/" + name + ".eps").c_str()), 0);
        const std::string output = folder + "/Output/" + name + ".ps";
        const std::string log = Failed(folder) + "/failed-jobs.log";
        // The failure's line is written before the original moves: wait for the move.
        const std::string failed = Failed(folder) + "/" + name + ".eps";
        ASSERT_TRUE(WaitFor([&] { return Exists(output) || Exists(failed); }, 30000))
            << host->Err();
        if (c[2] == "delivered")
            EXPECT_TRUE(Exists(output)) << ReadFile(log);
        else
        {
            EXPECT_FALSE(Exists(output));
            EXPECT_NE(ReadFile(log).find("\t" + name + ".eps\t" + c[2].substr(7) + "\n"),
                      std::string::npos)
                << ReadFile(log);
            EXPECT_TRUE(Exists(failed));
        }
    }
}

TEST_F(ServiceTest, GhostscriptRunsWithTheFolderOwnersRightsOnly)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "needs root, as the service runs";
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript is not installed";
    ASSERT_EQ(chmod(scratch.c_str(), 0755), 0);
    const std::string folder = MakePostScriptFolder("A4", "user");
    ASSERT_EQ(Host({"settings", folder, "--preflight", "on"}).exitCode, 0);
    ASSERT_EQ(testkit::RunProgram({"chown", "-R", "65534:65534", folder}).exitCode, 0);
    const std::string log = Failed(folder) + "/failed-jobs.log";
    {
        // Ghostscript itself reads what the owner's job made.
        auto host = Serve(1);
        WriteFile(folder + "/mine.eps", label);
        EXPECT_TRUE(WaitFor([&] { return Exists(folder + "/Output/mine.ps"); }, 20000))
            << host->Err() << ReadFile(log);
        host->Signal(SIGTERM);
        EXPECT_EQ(host->Wait(20000), 0);
    }
    setenv("HOTFOLDER_GHOSTSCRIPT", HF_IDENTITY_STAND_IN, 1);
    auto host = Serve(1);
    unsetenv("HOTFOLDER_GHOSTSCRIPT");
    WriteFile(folder + "/who.eps", label);
    EXPECT_TRUE(WaitFor([&] { return ReadFile(log).find("who.eps") != std::string::npos; }, 20000))
        << host->Err();
    EXPECT_NE(ReadFile(log).find("\twho.eps\tGhostscript ended with exit status 1: uid 65534 "
                                 "65534 65534 gid 65534 65534 65534 groups 65534\n"),
              std::string::npos)
        << ReadFile(log);
}
