// run --submit cups:QUEUE against a CUPS scheduler of the test's own: the
// delivered output reaches the queue's device on the job's paper, and a
// queue that refuses leaves the output delivered and fails the run.
#include "PpdSources.h"
#include "SchedulerFixture.h"

using namespace host_test;

namespace
{
const char* const kQueue = "hotfolder_run";
const char* const kFilter = "/usr/lib/cups/filter/pstops";

class HostSubmit : public HostWithScheduler
{
protected:
    void SetUp() override
    {
        HostWithScheduler::SetUp();
        if (!Ready())
            return;
        if (access(kFilter, X_OK) != 0)
            GTEST_SKIP() << kFilter << " missing (package cups-core-drivers)";
        std::string problem;
        device = scratch + "/device.ps";
        ASSERT_TRUE(scheduler->AddFileQueue(kQueue, ppd_sources::TestPpd(), device, problem))
            << problem;
    }

    // A hot folder bound to the queue's printer, converting on paper.
    std::string MakePrinterFolder(const std::string& paper)
    {
        const std::string folder = scratch + "/hot";
        testkit::ProcessResult init = Host({"init", folder, "--ppd", ppd_sources::TestPpd()});
        EXPECT_EQ(init.exitCode, 0) << init.err;
        testkit::ProcessResult set = Host({"settings", folder, "--set", "OUTPUTFILETYPEEPS=0",
                                           "OUTPUTFILETYPEPS=1", "DEFAULTPAGESIZE=" + paper});
        EXPECT_EQ(set.exitCode, 0) << set.err;
        return folder;
    }

    std::string device;
};
} // namespace

TEST_F(HostSubmit, TheOutputIsPrintedOnTheJobsPaper)
{
    // Letter, not the queue's default A4: the paper travels with the job.
    const std::string folder = MakePrinterFolder("Letter");
    CopyExample("label.eps", folder);
    testkit::ProcessResult run = Host({"run", folder, "--submit", std::string("cups:") + kQueue});
    ASSERT_EQ(run.exitCode, 0) << run.err << scheduler->Log();
    EXPECT_NE(run.out.find(std::string("queued on ") + kQueue + " as CUPS job "), std::string::npos)
        << run.out;
    EXPECT_NE(run.out.find("1 done, 0 failed"), std::string::npos) << run.out;
    EXPECT_TRUE(Exists(folder + "/Output/label.ps"));
    EXPECT_TRUE(Exists(Kept(folder) + "/label.eps"));

    // The device file is written once the queue's filters are through.
    const std::string selected = "%%BeginFeature: *PageSize Letter\n"
                                 "<</PageSize[612 792]/ImagingBBox null>>setpagedevice";
    EXPECT_TRUE(
        WaitFor([&] { return ReadFile(device).find(selected) != std::string::npos; }, 60000))
        << ReadFile(device) << scheduler->Log();
    // The job is the filter's output (the EPS placed on a page), not the
    // original EPS.
    const std::string printed = ReadFile(device);
    EXPECT_NE(printed.find("%%BeginDocument: /label.eps"), std::string::npos) << printed;
    EXPECT_NE(printed.find("(Hot folder) show"), std::string::npos) << printed;
}

TEST_F(HostSubmit, ARefusedSubmissionKeepsTheOutputAndFailsTheRun)
{
    const std::string folder = MakePrinterFolder("A4");
    CopyExample("label.eps", folder);
    testkit::ProcessResult run = Host({"run", folder, "--submit", "cups:no_such_queue"});
    EXPECT_EQ(run.exitCode, 1) << run.out << run.err;
    EXPECT_NE(run.err.find("submission to no_such_queue failed: "), std::string::npos) << run.err;
    EXPECT_NE(run.out.find("0 done, 1 failed"), std::string::npos) << run.out;
    // Processed all the same: output and ticket delivered, original kept.
    EXPECT_TRUE(Exists(folder + "/Output/label.ps"));
    EXPECT_TRUE(Exists(folder + "/Output/label.ps.Folder.cfg"));
    EXPECT_EQ(ListDirectory(Kept(folder)), std::vector<std::string>{"label.eps"});
    EXPECT_NE(ReadFile(Failed(folder) + "/failed-jobs.log").find("submission to no_such_queue"),
              std::string::npos);
    EXPECT_FALSE(Exists(device));
}
