// Folders bound to CUPS queues by name (init --printer) and the list of
// queues (printers), against a scheduler of the test's own.
#include "PpdSources.h"
#include "SchedulerFixture.h"

using namespace host_test;

namespace
{
const char* const kPdfPpd = "/usr/share/ppd/cupsfilters/HP-Color_LaserJet_CM3530_MFP-PDF.ppd";

class HostPrinters : public HostWithScheduler
{
protected:
    void SetUp() override
    {
        HostWithScheduler::SetUp();
        if (!Ready())
            return;
        std::string problem;
        ASSERT_TRUE(scheduler->AddFileQueue("ps_queue", ppd_sources::TestPpd(), scratch + "/ps.out",
                                            problem))
            << problem;
        hasPdfQueue = access(kPdfPpd, R_OK) == 0 &&
                      scheduler->AddFileQueue("pdf_queue", kPdfPpd, scratch + "/pdf.out", problem);
    }

    bool hasPdfQueue = false;
};
} // namespace

TEST_F(HostPrinters, InitBindsTheFolderAndRunPrintsThereWithoutSubmit)
{
    const std::string folder = scratch + "/hot";
    testkit::ProcessResult init = Host({"init", folder, "--printer", "ps_queue"});
    ASSERT_EQ(init.exitCode, 0) << init.err << scheduler->Log();
    EXPECT_NE(init.out.find("ps_queue"), std::string::npos) << init.out;
    EXPECT_EQ(ReadFile(Container(folder) + "/PrinterQueue.txt"), "ps_queue\n");
    // The queue's PPD, papers and PostScript code as the test printer has them.
    const std::string server = ReadFile(Container(folder) + "/ServerDescription.xml");
    EXPECT_NE(server.find("<PaperName>Tab</PaperName>"), std::string::npos) << server;
    EXPECT_NE(server.find("/ImagingBBox null&gt;&gt;setpagedevice"), std::string::npos);
    EXPECT_NE(ReadFile(Container(folder) + "/server.ppd").find("*PageSize Tab"), std::string::npos);

    testkit::ProcessResult set = Host({"settings", folder, "--set", "OUTPUTFILETYPEEPS=0",
                                       "OUTPUTFILETYPEPS=1", "DEFAULTPAGESIZE=A4"});
    ASSERT_EQ(set.exitCode, 0) << set.err;
    CopyExample("label.eps", folder);
    testkit::ProcessResult run = Host({"run", folder});
    EXPECT_EQ(run.exitCode, 0) << run.err;
    EXPECT_NE(run.out.find("queued on ps_queue as CUPS job "), std::string::npos) << run.out;
    // --submit still names another queue.
    CopyExample("label.eps", folder);
    run = Host({"run", folder, "--submit", "cups:no_such_queue"});
    EXPECT_NE(run.err.find("submission to no_such_queue failed"), std::string::npos) << run.err;

    if (hasPdfQueue)
    {
        const std::string pdf = scratch + "/pdf";
        init = Host({"init", pdf, "--printer", "pdf_queue"});
        ASSERT_EQ(init.exitCode, 0) << init.err;
        const std::string description = ReadFile(Container(pdf) + "/ServerDescription.xml");
        EXPECT_EQ(description.find("@PJL"), std::string::npos);
        EXPECT_NE(description.find("&lt;&lt; /PageSize [595 842] &gt;&gt; setpagedevice"),
                  std::string::npos);
    }

    testkit::ProcessResult list = Host({"printers"});
    ASSERT_EQ(list.exitCode, 0) << list.err;
    EXPECT_NE(list.out.find("Generic Test PostScript & Co      folder " + folder),
              std::string::npos)
        << list.out;
    EXPECT_NE(list.out.find("folder " + folder + "\n"), std::string::npos) << list.out;
    if (hasPdfQueue)
    {
        EXPECT_NE(list.out.find("folder " + scratch + "/pdf\n"), std::string::npos) << list.out;
    }
}

TEST_F(HostPrinters, UnknownQueueAndStoppedSchedulerMakeNothing)
{
    const std::string folder = scratch + "/hot";
    testkit::ProcessResult unknown = Host({"init", folder, "--printer", "no_such_queue"});
    EXPECT_EQ(unknown.exitCode, 3);
    EXPECT_NE(unknown.err.find("no queue \"no_such_queue\""), std::string::npos) << unknown.err;
    EXPECT_NE(unknown.err.find(scheduler->Server()), std::string::npos) << unknown.err;
    EXPECT_FALSE(Exists(folder));

    scheduler->Stop();
    testkit::ProcessResult stopped = Host({"init", folder, "--printer", "ps_queue"});
    EXPECT_EQ(stopped.exitCode, 3);
    EXPECT_NE(stopped.err.find("cannot reach the CUPS scheduler at " + scheduler->Server()),
              std::string::npos)
        << stopped.err;
    EXPECT_NE(stopped.err.find("\"ps_queue\""), std::string::npos) << stopped.err;
    EXPECT_FALSE(Exists(folder));
    testkit::ProcessResult list = Host({"printers"});
    EXPECT_EQ(list.exitCode, 3);
    EXPECT_NE(list.err.find(scheduler->Server()), std::string::npos) << list.err;
}
