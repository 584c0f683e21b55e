// info, init, settings and convert as a user runs them.
#include "HostTestSupport.h"

using namespace host_test;

TEST_F(HostTest, InfoShowsTheModuleAndEveryStatusText)
{
    testkit::ProcessResult info = Host({"info"});
    ASSERT_EQ(info.exitCode, 0) << info.err;
    for (const char* line :
         {"Identifier:                Orv.EPS.1", "Extensions:                .eps",
          "Required server features:  GA2_HOTFOLDERS",
          "Server keys:             GA2_HOTFOLDERS HF_EPS_FILTER", "   -1005  Invalid input file",
          "    1032  Error: CSL library error during conversion"})
        EXPECT_NE(info.out.find(line), std::string::npos) << line << "\n" << info.out;

    testkit::ProcessResult broken = Host({"info", "--module", HF_BAD_MODULE});
    EXPECT_EQ(broken.exitCode, 3);
    EXPECT_NE(broken.err.find("lacks the entry point GetPluginInstance"), std::string::npos);
}

TEST_F(HostTest, InitMakesTheContainerAndListsTheFolderOnce)
{
    std::string folder = scratch + "/hot";
    testkit::ProcessResult init = Host({"init", folder, "--server", kServer, "--name", "Posters"});
    ASSERT_EQ(init.exitCode, 0) << init.err;
    std::string config = ReadFile(Container(folder) + "/Folder.cfg");
    EXPECT_NE(config.find("<HotFolder name=\"Posters\""), std::string::npos);
    EXPECT_NE(config.find("<Workfolder path=\"" + Container(folder) + "/[WorkFolder]/\"/>"),
              std::string::npos)
        << config;
    EXPECT_NE(config.find("<Filter name=\"Orv.EPS.1\">"), std::string::npos);
    EXPECT_NE(config.find("<OUTPUTFILETYPEEPS>1</OUTPUTFILETYPEEPS>"), std::string::npos);
    EXPECT_EQ(ReadFile(Container(folder) + "/ServerDescription.xml"), ReadFile(kServer));

    testkit::ProcessResult again = Host({"init", folder});
    EXPECT_EQ(again.exitCode, 3);
    EXPECT_NE(again.err.find("is a hot folder already"), std::string::npos);
    std::string list = ReadFile(Warehouse() + "/HotFolderList.cfg");
    EXPECT_EQ(list.find("path=\"" + folder + "\""), list.rfind("path=\"" + folder + "\""));
    EXPECT_NE(list.find("path=\"" + folder + "\""), std::string::npos) << list;

    WriteFile(scratch + "/broken.xml", "<ServerDescription>");
    testkit::ProcessResult bad =
        Host({"init", scratch + "/other", "--server", scratch + "/broken.xml"});
    EXPECT_EQ(bad.exitCode, 3);
    EXPECT_FALSE(Exists(Container(scratch + "/other") + "/Folder.cfg"));
}

TEST_F(HostTest, SettingsSetChecksEveryValueBeforeChangingAnything)
{
    std::string folder = MakePostScriptFolder("A4");
    const std::string before = ReadFile(Container(folder) + "/Folder.cfg");

    struct
    {
        std::vector<std::string> assignments;
        const char* message;
    } refused[] = {
        {{"AUTOROTATE=1", "PAPERSIZE=A4"}, "unknown setting PAPERSIZE"},
        {{"AUTOROTATE=1", "FITTOPAGE=maybe"}, "FITTOPAGE takes 1 or 0"},
        {{"FORCEPAGESIZEX=wide"}, "FORCEPAGESIZEX takes a length in points"},
        {{"DEFAULTPAGESIZE=B5"}, "the server offers no paper \"B5\""},
        {{"IMAGEPOSITION=Middle"}, "IMAGEPOSITION takes Top Left"},
        {{"ORIGINALWIDTHUNIT=furlong"}, "takes inch, mm or point"},
        {{"no-equals-sign"}, "needs at least one KEY=VALUE"},
    };
    for (const auto& attempt : refused)
    {
        std::vector<std::string> args = {"settings", folder, "--set"};
        args.insert(args.end(), attempt.assignments.begin(), attempt.assignments.end());
        testkit::ProcessResult set = Host(args);
        EXPECT_EQ(set.exitCode, 2) << attempt.message;
        EXPECT_NE(set.err.find(attempt.message), std::string::npos) << set.err;
    }
    EXPECT_EQ(ReadFile(Container(folder) + "/Folder.cfg"), before);

    // Accepted values are stored in the filter's encoding, "." decimals.
    ASSERT_EQ(Host({"settings", folder, "--set", "AUTOROTATE=yes", "ORIGINALWIDTH=2,5",
                    "DEFAULTPAGESIZE=Tabloid", "FORCEPAGESIZEY=1200", "IMAGEPOSITION=top left"})
                  .exitCode,
              0);
    std::string shown = Host({"settings", folder, "--show"}).out;
    for (const char* line :
         {"AUTOROTATE=1\n", "ORIGINALWIDTH=2.5\n", "DEFAULTPAGESIZE=Tabloid\n",
          "FORCEPAGESIZEX=792.000000\n", "FORCEPAGESIZEY=1200.000000\n",
          "IMAGEEABLESIZEURY=1212.000000\n", "IMAGEPOSITION=Top Left\n",
          "PAGESIZE_COMMAND=<</PageSize [792 1224] /ImagingBBox null>> setpagedevice\n",
          "OUTPUTFILETYPEEPS=0\n"})
        EXPECT_NE(shown.find(line), std::string::npos) << line << shown;
}

TEST_F(HostTest, SettingsWindowEmbedsThePanelAndOkSavesThroughTheFilter)
{
    if (!std::getenv("DISPLAY"))
        GTEST_SKIP() << "needs a display (the suite runs under xvfb-run)";
    std::string folder = MakePostScriptFolder("Legal");
    testkit::ProcessResult accept = Host({"settings", folder, "--accept"});
    ASSERT_EQ(accept.exitCode, 0) << accept.err;
    EXPECT_NE(accept.out.find("saved"), std::string::npos);
    // What the panel loaded it saved back; the folder still converts on Legal.
    std::string shown = Host({"settings", folder, "--show"}).out;
    EXPECT_NE(shown.find("DEFAULTPAGESIZE=Legal\n"), std::string::npos) << shown;
    EXPECT_NE(shown.find("OUTPUTFILETYPEEPS=0\n"), std::string::npos) << shown;
    EXPECT_NE(shown.find("FORCEPAGESIZEY=1008.000000\n"), std::string::npos) << shown;
}

TEST_F(HostTest, ConvertWritesOnePostScriptFileOnTheChosenPaper)
{
    WriteFile(scratch + "/banner.eps", ReadFile(kExamples + "/eps/banner-landscape.eps"));
    testkit::ProcessResult convert =
        Host({"convert", scratch + "/banner.eps", "-o", scratch + "/out/banner.ps", "--server",
              kServer, "--set", "DEFAULTPAGESIZE=Tabloid", "IMAGEPOSITION=Bottom Left"});
    ASSERT_NE(convert.exitCode, 0) << "the output folder does not exist yet";
    mkdir((scratch + "/out").c_str(), 0777);
    convert =
        Host({"convert", scratch + "/banner.eps", "-o", scratch + "/out/banner.ps", "--server",
              kServer, "--set", "DEFAULTPAGESIZE=Tabloid", "IMAGEPOSITION=Bottom Left"});
    ASSERT_EQ(convert.exitCode, 0) << convert.err;
    EXPECT_EQ(ListDirectory(scratch + "/out"), std::vector<std::string>{"banner.ps"});
    hf_test::GhostscriptReport report = hf_test::RunGhostscriptBBox(scratch + "/out/banner.ps");
    ASSERT_FALSE(report.postscriptError) << report.process.err;
    EXPECT_NEAR(report.pageWidth, 792, 0.5);
    EXPECT_NEAR(report.pageHeight, 1224, 0.5);
    // Bottom left of the imageable box, which starts at 12, 12.
    EXPECT_NEAR(report.marks.llx, 12, 1.5);
    EXPECT_NEAR(report.marks.lly, 12, 1.5);

    // Default paper of the server, output next to the input.
    ASSERT_EQ(Host({"convert", scratch + "/banner.eps", "--server", kServer}).exitCode, 0);
    report = hf_test::RunGhostscriptBBox(scratch + "/banner.ps");
    EXPECT_NEAR(report.pageWidth, 612, 0.5);
    EXPECT_NEAR(report.pageHeight, 792, 0.5);
}

TEST_F(HostTest, ConvertRefusesWhatTheFilterDoesNotAccept)
{
    WriteFile(scratch + "/list.eps", ReadFile(kExamples + "/eps/not-really.eps"));
    testkit::ProcessResult convert = Host({"convert", scratch + "/list.eps"});
    EXPECT_EQ(convert.exitCode, 1);
    EXPECT_NE(convert.err.find("is not a file the EPS filter accepts"), std::string::npos);
    EXPECT_EQ(ListDirectory(scratch), std::vector<std::string>{"list.eps"});

    EXPECT_EQ(Host({"convert", scratch + "/absent.eps"}).exitCode, 3);
    EXPECT_EQ(Host({"convert", scratch + "/list.eps", "-o", scratch + "/list.eps"}).exitCode, 2);
    EXPECT_EQ(ReadFile(scratch + "/list.eps"), ReadFile(kExamples + "/eps/not-really.eps"));
}

TEST_F(HostTest, RunRefusesASubmitTargetThatIsNoCupsQueue)
{
    std::string folder = MakePostScriptFolder();
    CopyExample("label.eps", folder);
    for (const char* target : {"lp:office", "cups:", "cups:two words", "cups:a/b", "office"})
    {
        testkit::ProcessResult run = Host({"run", folder, "--submit", target});
        EXPECT_EQ(run.exitCode, 2) << target;
        EXPECT_NE(run.err.find("cups:QUEUE"), std::string::npos) << run.err;
    }
    // Refused before anything was processed.
    EXPECT_TRUE(Exists(folder + "/label.eps"));
    EXPECT_FALSE(Exists(folder + "/Output"));
}
