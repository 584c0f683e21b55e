// hotfolder run on fixture folders: outputs, tickets, moved originals,
// refused and failed files, and the PostScript as Ghostscript sees it.
#include <algorithm>
#include <cmath>

#include "HostTestSupport.h"

using namespace host_test;

namespace
{
// The artwork's size in either orientation, centred in the imageable box.
void ExpectCentredArtwork(const std::string& ps, double pageWidth, double pageHeight,
                          hf_test::Box imageable, double artworkWidth, double artworkHeight)
{
    hf_test::GhostscriptReport report = hf_test::RunGhostscriptBBox(ps);
    ASSERT_FALSE(report.postscriptError) << report.process.err;
    ASSERT_TRUE(report.pageSeen);
    EXPECT_NEAR(report.pageWidth, pageWidth, 0.5);
    EXPECT_NEAR(report.pageHeight, pageHeight, 0.5);
    ASSERT_TRUE(report.marked);
    double width = report.marks.urx - report.marks.llx;
    double height = report.marks.ury - report.marks.lly;
    double longSide = std::max(width, height), shortSide = std::min(width, height);
    EXPECT_NEAR(longSide, std::max(artworkWidth, artworkHeight), 1.5);
    EXPECT_NEAR(shortSide, std::min(artworkWidth, artworkHeight), 1.5);
    EXPECT_NEAR((report.marks.llx + report.marks.urx) / 2, (imageable.llx + imageable.urx) / 2,
                1.5);
    EXPECT_NEAR((report.marks.lly + report.marks.ury) / 2, (imageable.lly + imageable.ury) / 2,
                1.5);
}

std::string TicketOf(const std::string& output)
{
    return output + ".Folder.cfg";
}
} // namespace

TEST_F(HostTest, RunConvertsTheEpsFilesAndLeavesTheRefusedOneInPlace)
{
    std::string folder = MakePostScriptFolder("A4");
    for (const char* name : {"label.eps", "label-with-preview.eps", "banner-landscape.eps",
                             "tiny.eps", "not-really.eps"})
        CopyExample(name, folder);

    testkit::ProcessResult run = Host({"run", folder});
    EXPECT_EQ(run.exitCode, 0) << run.err;
    EXPECT_NE(run.out.find("4 done, 0 failed, 1 refused"), std::string::npos) << run.out;
    EXPECT_NE(run.out.find("refused (left in place): " + folder + "/not-really.eps"),
              std::string::npos);

    // Only the refused file stays; the others were kept as originals.
    EXPECT_EQ(ListDirectory(folder),
              (std::vector<std::string>{"Output", kContainer, "not-really.eps"}));
    EXPECT_EQ(ListDirectory(Kept(folder)),
              (std::vector<std::string>{"banner-landscape.eps", "label-with-preview.eps",
                                        "label.eps", "tiny.eps"}));
    EXPECT_EQ(ReadFile(Kept(folder) + "/label.eps"), ReadFile(kExamples + "/eps/label.eps"));
    EXPECT_TRUE(ListDirectory(Container(folder) + "/[WorkFolder]").empty());

    const std::string output = folder + "/Output";
    EXPECT_EQ(ListDirectory(output).size(), 8u);
    const hf_test::Box a4Imageable{12, 12, 583, 830};
    ExpectCentredArtwork(output + "/label.ps", 595, 842, a4Imageable, 288, 144);
    ExpectCentredArtwork(output + "/label-with-preview.ps", 595, 842, a4Imageable, 288, 144);
    ExpectCentredArtwork(output + "/banner-landscape.ps", 595, 842, a4Imageable, 500, 250);
    ExpectCentredArtwork(output + "/tiny.ps", 595, 842, a4Imageable, 36, 18);
}

TEST_F(HostTest, TheTicketIsTheFolderConfigurationWithThePaperAsOverride)
{
    std::string folder = MakePostScriptFolder("Letter");
    CopyExample("label.eps", folder);
    ASSERT_EQ(Host({"run", folder}).exitCode, 0);

    std::string ticket = ReadFile(TicketOf(folder + "/Output/label.ps"));
    EXPECT_NE(ticket.find("<HotFolder name=\"hot\""), std::string::npos) << ticket;
    EXPECT_NE(ticket.find("Key=\"PageSize\" Value=\"Letter\""), std::string::npos) << ticket;
    // The override belongs to the job: the folder's own file has none.
    EXPECT_EQ(ReadFile(Container(folder) + "/Folder.cfg").find("Key=\"PageSize\""),
              std::string::npos);
    ExpectCentredArtwork(folder + "/Output/label.ps", 612, 792, {12, 12, 600, 780}, 288, 144);
}

TEST_F(HostTest, PassThroughDeliversTheOriginalBytes)
{
    std::string folder = scratch + "/hot";
    ASSERT_EQ(Host({"init", folder, "--server", kServer}).exitCode, 0);
    CopyExample("label-with-preview.eps", folder);
    testkit::ProcessResult run = Host({"run", folder, "--out", scratch + "/delivered"});
    EXPECT_EQ(run.exitCode, 0) << run.err;
    EXPECT_EQ(ReadFile(scratch + "/delivered/label-with-preview.eps"),
              ReadFile(kExamples + "/eps/label-with-preview.eps"));
    EXPECT_TRUE(Exists(TicketOf(scratch + "/delivered/label-with-preview.eps")));
    EXPECT_TRUE(Exists(Kept(folder) + "/label-with-preview.eps"));
}

TEST_F(HostTest, OutputsWithTheSameNameAreNumberedNotReplaced)
{
    std::string folder = MakePostScriptFolder();
    CopyExample("label.eps", folder);
    ASSERT_EQ(Host({"run", folder}).exitCode, 0);
    CopyExample("tiny.eps", folder);
    rename((folder + "/tiny.eps").c_str(), (folder + "/label.EPS").c_str());
    ASSERT_EQ(Host({"run", folder}).exitCode, 0);

    EXPECT_EQ(ListDirectory(folder + "/Output"),
              (std::vector<std::string>{"label (2).ps", "label (2).ps.Folder.cfg", "label.ps",
                                        "label.ps.Folder.cfg"}));
    EXPECT_EQ(ListDirectory(Kept(folder)), (std::vector<std::string>{"label.EPS", "label.eps"}));
}

TEST_F(HostTest, AFileSpoiltAfterSniffingFailsIntoTheFailedFolderWithALogLine)
{
    std::string folder = MakePostScriptFolder();
    CopyExample("label.eps", folder);
    CopyExample("tiny.eps", folder);
    BackgroundHost host({"run", folder, "--delay-jobs", "1500"}, scratch);
    ASSERT_TRUE(host.Started());
    ASSERT_TRUE(
        WaitFor([&] { return host.Out().find("found 2 job(s)") != std::string::npos; }, 10000));
    WriteFile(folder + "/label.eps", "no longer PostScript\n");
    EXPECT_EQ(host.Wait(20000), 1);

    EXPECT_EQ(ListDirectory(Failed(folder)),
              (std::vector<std::string>{"failed-jobs.log", "label.eps"}));
    EXPECT_EQ(ReadFile(Failed(folder) + "/label.eps"), "no longer PostScript\n");
    std::string log = ReadFile(Failed(folder) + "/failed-jobs.log");
    EXPECT_NE(log.find("label.eps\tInvalid input file (-1005)"), std::string::npos) << log;
    EXPECT_NE(host.Err().find("Invalid input file"), std::string::npos);
    EXPECT_NE(host.Out().find("1 done, 1 failed, 0 refused"), std::string::npos) << host.Out();
    EXPECT_TRUE(Exists(folder + "/Output/tiny.ps"));
    EXPECT_FALSE(Exists(folder + "/Output/label.ps"));
}

TEST_F(HostTest, AFileDeletedAfterSniffingIsReportedAndTheOthersGoOn)
{
    std::string folder = MakePostScriptFolder();
    CopyExample("label.eps", folder);
    CopyExample("tiny.eps", folder);
    BackgroundHost host({"run", folder, "--delay-jobs", "1500"}, scratch);
    ASSERT_TRUE(
        WaitFor([&] { return host.Out().find("found 2 job(s)") != std::string::npos; }, 10000));
    unlink((folder + "/label.eps").c_str());
    EXPECT_EQ(host.Wait(20000), 1);
    EXPECT_NE(host.Err().find(folder + "/label.eps vanished between sniffing and processing"),
              std::string::npos)
        << host.Err();
    EXPECT_TRUE(Exists(folder + "/Output/tiny.ps"));
    EXPECT_TRUE(ListDirectory(Failed(folder)).empty() ||
                ListDirectory(Failed(folder)) == std::vector<std::string>{"failed-jobs.log"});
}

TEST_F(HostTest, StatsReportTheTimeOutsideTheFilter)
{
    std::string folder = MakePostScriptFolder();
    CopyExample("tiny.eps", folder);
    testkit::ProcessResult run = Host({"run", folder, "--stats"});
    ASSERT_EQ(run.exitCode, 0);
    double total = -1, sniff = -1, inside = -1, outside = -1, share = -1;
    size_t at = run.out.find("Timing:");
    ASSERT_NE(at, std::string::npos) << run.out;
    ASSERT_EQ(std::sscanf(run.out.c_str() + at,
                          "Timing: total %lf s, sniffing %lf s, inside Process %lf s, outside "
                          "Process %lf s (%lf%%",
                          &total, &sniff, &inside, &outside, &share),
              5);
    EXPECT_GT(inside, 0);
    EXPECT_NEAR(inside + outside, total, 0.002);
    EXPECT_NE(run.out.find("Throughput: 1 jobs"), std::string::npos);
}
