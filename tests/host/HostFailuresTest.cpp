// Unusable folders, configurations, modules and output places: one clear
// message, a non-zero status, and every input file still where it was.
#include "HostTestSupport.h"

using namespace host_test;

namespace
{
int CountLines(const std::string& text)
{
    return std::count(text.begin(), text.end(), '\n');
}
} // namespace

class HostFailureTest : public HostTest
{
protected:
    void SetUp() override
    {
        HostTest::SetUp();
        folder = MakePostScriptFolder();
        CopyExample("label.eps", folder);
        original = ReadFile(folder + "/label.eps");
    }

    // The run refused to start: status 3, one message, the input untouched.
    void ExpectRefusedRun(const std::vector<std::string>& args, const std::string& message)
    {
        testkit::ProcessResult run = Host(args);
        EXPECT_EQ(run.exitCode, 3) << run.err;
        EXPECT_NE(run.err.find(message), std::string::npos) << run.err;
        EXPECT_EQ(CountLines(run.err), 1) << run.err;
        EXPECT_EQ(ReadFile(folder + "/label.eps"), original);
        EXPECT_TRUE(ListDirectory(Kept(folder)).empty());
    }

    std::string folder;
    std::string original;
};

TEST_F(HostFailureTest, AMissingFolder)
{
    ExpectRefusedRun({"run", scratch + "/nowhere"}, "no such folder: " + scratch + "/nowhere");
}

TEST_F(HostFailureTest, AFolderThatIsNotAHotFolder)
{
    mkdir((scratch + "/plain").c_str(), 0777);
    ExpectRefusedRun({"run", scratch + "/plain"}, "is not a hot folder");
}

TEST_F(HostFailureTest, AnUnreadableFolderConfiguration)
{
    WriteFile(Container(folder) + "/Folder.cfg", "<HotFolder name=\"x\"");
    ExpectRefusedRun({"run", folder}, "cannot read the folder configuration");
}

TEST_F(HostFailureTest, AMalformedServerDescription)
{
    WriteFile(Container(folder) + "/ServerDescription.xml", "<ServerDescription><SheetInfo>");
    ExpectRefusedRun({"run", folder}, "is not well-formed XML");
}

TEST_F(HostFailureTest, AModulePathThatDoesNotLoad)
{
    ExpectRefusedRun({"run", folder, "--module", scratch + "/missing.so"},
                     "cannot load the filter module " + scratch + "/missing.so");
    WriteFile(scratch + "/text.so", "not a shared object");
    setenv("HOTFOLDER_MODULE", (scratch + "/text.so").c_str(), 1);
    ExpectRefusedRun({"run", folder}, "cannot load the filter module " + scratch + "/text.so");
}

TEST_F(HostFailureTest, AModuleWithoutAnEntryPoint)
{
    ExpectRefusedRun({"run", folder, "--module", HF_BAD_MODULE},
                     "lacks the entry point GetPluginInstance");
}

TEST_F(HostFailureTest, AnOutputDirectoryThatCannotBeWritten)
{
    WriteFile(scratch + "/occupied", "a file where a folder should be");
    ExpectRefusedRun({"run", folder, "--out", scratch + "/occupied/out"},
                     "unusable output directory");
}

TEST_F(HostFailureTest, ABadCommandLineIsAUsageError)
{
    testkit::ProcessResult run = Host({"run", folder, "--bogus"});
    EXPECT_EQ(run.exitCode, 2);
    EXPECT_NE(run.err.find("unknown option --bogus"), std::string::npos);
    EXPECT_EQ(Host({"frobnicate"}).exitCode, 2);
    EXPECT_EQ(Host({"run", folder, "--settle", "soon"}).exitCode, 2);
    testkit::ProcessResult intoItself = Host({"run", folder, "--out", folder + "/"});
    EXPECT_EQ(intoItself.exitCode, 2);
    EXPECT_NE(intoItself.err.find("cannot be the hot folder itself"), std::string::npos);
    EXPECT_EQ(ReadFile(folder + "/label.eps"), original);
}
