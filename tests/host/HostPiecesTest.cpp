// The host's own pieces: safe moves, the settle rule of the watch and the
// status texts.
#include <thread>

#include <hotfolder/StatusCodes.h>

#include "HostTestSupport.h"
#include "folder/FileMoves.h"
#include "folder/FolderWatcher.h"

using namespace host_test;

TEST(HostFiles, MovesNeverReplaceAndNeverLoseTheSource)
{
    testkit::ScratchDir dir;
    const std::string to = dir.Sub("to");
    WriteFile(to + "/a.b.ps", "old");
    WriteFile(dir.File("a.b.ps"), "new");
    wxString moved, error;
    ASSERT_TRUE(MoveIntoDirectory(dir.File("a.b.ps"), to, "a.b.ps", moved, error));
    EXPECT_EQ(moved, to + "/a.b (2).ps");
    EXPECT_EQ(ReadFile(to + "/a.b.ps"), "old");
    EXPECT_EQ(ReadFile(to + "/a.b (2).ps"), "new");
    EXPECT_EQ(NumberedName("README", 3), "README (3)");

    WriteFile(dir.File("keep.eps"), "precious");
    EXPECT_FALSE(
        MoveIntoDirectory(dir.File("keep.eps"), dir.File("absent"), "keep.eps", moved, error));
    EXPECT_NE(error.find("cannot move"), wxString::npos);
    EXPECT_EQ(ReadFile(dir.File("keep.eps")), "precious");

    // Across file systems (/dev/shm is tmpfs) the move copies, then unlinks.
    setenv("TMPDIR", "/dev/shm", 1);
    testkit::ScratchDir shared("hf-host-move");
    unsetenv("TMPDIR");
    if (shared.Path().empty())
        return;
    ASSERT_TRUE(MoveIntoDirectory(dir.File("keep.eps"), shared.Path(), "keep.eps", moved, error))
        << error;
    EXPECT_EQ(ReadFile(shared.File("keep.eps")), "precious");
    EXPECT_FALSE(Exists(dir.File("keep.eps")));
    EXPECT_EQ(ListDirectory(shared.Path()), std::vector<std::string>{"keep.eps"});
}

TEST(HostFiles, AFileSettlesOnlyWhenItStopsChanging)
{
    testkit::ScratchDir dir;
    const std::string path = dir.File("growing.eps");
    WriteFile(path, "part");
    SettleTracker tracker(std::chrono::milliseconds(300));
    EXPECT_TRUE(tracker.Settled({path}).empty());
    std::this_thread::sleep_for(std::chrono::milliseconds(200));
    WriteFile(path, "part and more");
    EXPECT_TRUE(tracker.Settled({path}).empty());
    std::this_thread::sleep_for(std::chrono::milliseconds(200));
    EXPECT_TRUE(tracker.Settled({path}).empty()) << "the change restarted the wait";
    std::this_thread::sleep_for(std::chrono::milliseconds(200));
    EXPECT_EQ(tracker.Settled({path}), std::vector<wxString>{wxString(path)});

    dir.Sub("sub");
    WriteFile(dir.File(".hidden.eps"), "x");
    EXPECT_EQ(ListFolderFiles(dir.Path()), std::vector<wxString>{wxString(path)});
}

TEST(HostStatusCodes, TheTableHasTheFamilysCodesOnly)
{
    std::vector<long> codes;
    for (const HFStatusText& entry : kHFStatusTexts)
        codes.push_back(entry.code);
    EXPECT_EQ(codes.size(), 29u);
    EXPECT_EQ(std::count(codes.begin(), codes.end(), -1010), 1);
    EXPECT_EQ(std::count(codes.begin(), codes.end(), 1016), 0);
    EXPECT_EQ(std::count(codes.begin(), codes.end(), -1001), 0);
}
