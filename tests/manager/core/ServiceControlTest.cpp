// The service bar's start, pause and resume on a scratch warehouse: started
// through the fallback (the hotfolder beside this program, detached), the
// state read back after each action; stopped at the end.
#include <sys/stat.h>

#include "CoreTestSupport.h"
#include "core/ServiceControl.h"
#include "db/PathResolver.h"

using namespace core_test;

namespace
{
std::string StateName(ServiceState state)
{
    switch (state)
    {
    case ServiceState::Running:
        return "running";
    case ServiceState::Paused:
        return "paused";
    default:
        return "stopped";
    }
}

class ServiceControl : public CoreTest
{
protected:
    void TearDown() override { Stop(); }

    bool Stop()
    {
        return testkit::RunProgram({HF_HOTFOLDER_EXE, "stop", "--wait", "30"}).exitCode == 0;
    }

    // An action the warehouse refuses to a plain user.
    bool AsNobody(bool (*action)(wxString&))
    {
        const std::string warehouse = scratch + "/machine/HotFolders";
        chmod(scratch.c_str(), 0755);
        chmod((scratch + "/machine").c_str(), 0755);
        chmod(warehouse.c_str(), 0555);
        const std::string result = testkit::AsUnprivileged(
            [&]
            {
                wxString error;
                return action(error) ? std::string("yes") : error.utf8_string();
            });
        chmod(warehouse.c_str(), 0777);
        if (result != "yes")
        {
            EXPECT_NE(result.find("Cannot"), std::string::npos) << result;
        }
        return result == "yes";
    }
};

TEST_F(ServiceControl, StartPauseResumeAsTheServiceBarDoes)
{
    if (testkit::Exists("/run/systemd/system"))
        GTEST_SKIP() << "systemd runs here: start would go through it, not the fallback";
    MakeFolder("served");
    for (const auto& c : testkit::Cases("manager/core-service.txt", 3, 8))
    {
        SCOPED_TRACE(c[0]);
        wxString error;
        bool done = false;
        if (c[0] == "start")
            done = StartService(error);
        else if (c[0] == "pause")
            done = PauseService(error);
        else if (c[0] == "resume")
            done = ResumeService(error);
        else if (c[0] == "stop")
            done = Stop();
        else if (c[0] == "pause-as-nobody")
            done = AsNobody(PauseService);
        else if (c[0] == "resume-as-nobody")
            done = AsNobody(ResumeService);
        else if (c[0] == "start-as-nobody")
            done = AsNobody([](wxString& error) { return StartService(error); });
        else
            FAIL() << "unknown action";
        EXPECT_EQ(done ? "yes" : "no", c[2]) << error;
        EXPECT_EQ(StateName(ReadServiceState()), c[1]);
    }
}
} // namespace
