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
        ASSERT_TRUE(WaitFor(
            [&] { return Exists(output) || ReadFile(log).find(name) != std::string::npos; }, 30000))
            << host->Err();
        if (c[2] == "delivered")
            EXPECT_TRUE(Exists(output)) << ReadFile(log);
        else
        {
            EXPECT_FALSE(Exists(output));
            EXPECT_NE(ReadFile(log).find("\t" + name + ".eps\t" + c[2].substr(7) + "\n"),
                      std::string::npos)
                << ReadFile(log);
            EXPECT_TRUE(Exists(Failed(folder) + "/" + name + ".eps"));
        }
    }
}
