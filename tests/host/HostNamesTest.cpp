// Names a dropper chooses are text, never program: hotfolder run fails and
// then converts a file under each name of tests/data/host/names.txt; every
// line that shows a name reads back to it, and no output runs one.
#include <sys/stat.h>

#include "OutsideNames.h"

using namespace host_test;

namespace
{
class HostNames : public HostTest
{
};

// What Ghostscript printed while it ran the job (under a plain name, which
// Ghostscript can open whatever the job's own name).
std::string GhostscriptSays(const std::string& job, const std::string& scratch)
{
    const std::string plain = scratch + "/job.ps";
    WriteFile(plain, job);
    const testkit::ProcessResult run = testkit::RunProgram(
        {"gs", "-q", "-dSAFER", "-dBATCH", "-dNOPAUSE", "-sDEVICE=nullpage", plain});
    return run.out + run.err;
}

std::vector<std::string> LongCommentLines(const std::string& job)
{
    std::vector<std::string> long_;
    size_t start = 0;
    for (size_t end; (end = job.find("\r\n", start)) != std::string::npos; start = end + 2)
        if (job.compare(start, 2, "%%") == 0 && end - start > 255)
            long_.push_back(job.substr(start, 80));
    return long_;
}
} // namespace

TEST_F(HostNames, ShownInEveryLineReadBackAndNeverRun)
{
    if (!testkit::ProgramAvailable("gs"))
        GTEST_SKIP() << "Ghostscript is not installed";
    const std::vector<DroppedName> names = DroppedNames();
    const std::string folder = MakePostScriptFolder();
    DropUnderEachName(names, folder, ReadFile(kExamples + "/eps/label.eps"));

    // Failed first: the output folder turns into a file once the jobs are found.
    {
        BackgroundHost run({"run", folder, "--delay-jobs", "1000"}, scratch);
        ASSERT_TRUE(WaitFor([&] { return run.Out().find("found ") != std::string::npos; }, 10000));
        ASSERT_EQ(rename((folder + "/Output").c_str(), (scratch + "/kept-output").c_str()), 0);
        WriteFile(folder + "/Output", "no folder");
        EXPECT_EQ(run.Wait(30000), 1);
        EXPECT_EQ(LinesWithControls(run.Out()), std::vector<std::string>()) << run.Out();
        EXPECT_EQ(LinesWithControls(run.Err()), std::vector<std::string>()) << run.Err();
        for (const DroppedName& name : names)
            EXPECT_NE(run.Err().find(posix::ShownText(name.raw) + ": cannot deliver"),
                      std::string::npos)
                << name.line << "\n"
                << run.Err();
    }
    const std::string log = ReadFile(Failed(folder) + "/failed-jobs.log");
    EXPECT_EQ(LinesWithControls(log, true), std::vector<std::string>()) << log;
    EXPECT_EQ(LoggedNames(log, 1), RawNames(names)) << log;
    const testkit::ProcessResult status = Host({"status", "--json"});
    std::string lastFailure;
    ASSERT_TRUE(posix::ReadShownText(JsonString(status.out, "last_failure"), lastFailure))
        << status.out;
    bool named = false;
    for (const DroppedName& name : names)
        named = named || lastFailure.rfind(name.raw + ": cannot deliver", 0) == 0;
    EXPECT_TRUE(named) << status.out;
    const std::string plain = Host({"status"}).out;
    EXPECT_EQ(LinesWithControls(plain), std::vector<std::string>()) << plain;

    // Then converted: retried, every name becomes one output that prints
    // nothing when it runs.
    unlink((folder + "/Output").c_str());
    ASSERT_EQ(rename((scratch + "/kept-output").c_str(), (folder + "/Output").c_str()), 0);
    ASSERT_EQ(Host({"retry", folder}).exitCode, 0);
    const testkit::ProcessResult run = Host({"run", folder});
    EXPECT_EQ(run.exitCode, 0) << run.err;
    EXPECT_EQ(LinesWithControls(run.out), std::vector<std::string>()) << run.out;
    size_t outputs = 0;
    for (const std::string& output : ListDirectory(folder + "/Output"))
    {
        if (output.size() > 11 && output.compare(output.size() - 11, 11, ".Folder.cfg") == 0)
            continue;
        ++outputs;
        const std::string job = ReadFile(folder + "/Output/" + output);
        EXPECT_EQ(GhostscriptSays(job, scratch), "") << posix::ShownText(output);
        EXPECT_EQ(LongCommentLines(job), std::vector<std::string>()) << posix::ShownText(output);
    }
    EXPECT_EQ(outputs, names.size());
}

TEST_F(HostNames, AMovedFolderTakesItsPlacesAlongAndNothingIsMadeWhereItWas)
{
    const std::string old = MakePostScriptFolder("A4", "before");
    const std::string moved = scratch + "/after";
    ASSERT_EQ(rename(old.c_str(), moved.c_str()), 0);
    CopyExample("label.eps", moved);
    const testkit::ProcessResult first = Host({"run", moved});
    EXPECT_EQ(first.exitCode, 0) << first.err;
    EXPECT_NE(first.err.find(moved + " was moved from " + old), std::string::npos) << first.err;
    EXPECT_FALSE(Exists(old));
    EXPECT_TRUE(Exists(Kept(moved) + "/label.eps"));
    const std::string config = ReadFile(Container(moved) + "/Folder.cfg");
    EXPECT_EQ(config.find(old + "/"), std::string::npos) << config;
    EXPECT_NE(config.find("<Hotfolder path=\"" + moved + "\"/>"), std::string::npos) << config;
    const testkit::ProcessResult second = Host({"run", moved});
    EXPECT_EQ(second.err.find("was moved"), std::string::npos) << second.err;
}

TEST_F(HostNames, RootWorksAUsersFolderAsItsOwner)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "needs root";
    ASSERT_EQ(chmod(scratch.c_str(), 0755), 0);
    const mode_t umaskBefore = umask(002); // a group-writable umask, as with user groups
    const std::string folder = MakePostScriptFolder("A4", "theirs");
    umask(umaskBefore);
    struct stat container;
    ASSERT_EQ(stat(Container(folder).c_str(), &container), 0);
    EXPECT_EQ(container.st_mode & 022, 0u) << "init leaves the container writable by others";
    ASSERT_EQ(testkit::RunProgram({"chown", "-R", "65534:65534", folder}).exitCode, 0);
    ASSERT_EQ(testkit::RunProgram({"rm", "-rf", folder + "/Output"}).exitCode, 0);
    CopyExample("label.eps", folder);
    const testkit::ProcessResult run = Host({"run", folder});
    EXPECT_EQ(run.exitCode, 0) << run.err;
    for (const std::string& made : {folder + "/Output", folder + "/Output/label.ps"})
    {
        struct stat info;
        EXPECT_TRUE(stat(made.c_str(), &info) == 0 && info.st_uid == 65534) << made;
    }
}
