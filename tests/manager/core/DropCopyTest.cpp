// Drops copied into a hot folder: whole, under a free name, never over a
// waiting file, nothing left behind when they fail.
#include <sys/stat.h>

#include <wx/filename.h>

#include "CoreTestSupport.h"
#include "core/DropCopy.h"
#include "folder/FolderWatcher.h"

using namespace core_test;

namespace
{
// Every entry, hidden ones too, but the container and the output folder.
std::vector<std::string> Entries(const std::string& folder)
{
    std::vector<std::string> names;
    if (DIR* dir = opendir(folder.c_str()))
    {
        while (const dirent* entry = readdir(dir))
        {
            const std::string name = entry->d_name;
            if (name != "." && name != ".." && name != "[_Orv_HotFolder_]")
                names.push_back(name);
        }
        closedir(dir);
    }
    std::sort(names.begin(), names.end());
    return names;
}

class DropCopy : public CoreTest
{
};

TEST_F(DropCopy, CopiesWholeUnderAFreeNameOrLeavesNothing)
{
    const std::string bytes(200000, 'e'); // more than one read of the copy
    int number = 0;
    for (const auto& c : testkit::Cases("manager/core-drops.txt", 5, 8))
    {
        SCOPED_TRACE(c[0] + " into " + c[1]);
        const std::string sources = scratchDir.Sub("s" + std::to_string(++number));
        const std::string target = c[1] == "hot" ? MakeFolder("h" + std::to_string(number))
                                                 : scratchDir.Sub("p" + std::to_string(number));
        std::vector<std::string> waiting;
        if (c[2] != "-")
            waiting = testkit::Split(c[2], ", ");
        for (const std::string& name : waiting)
            testkit::WriteFile(target + "/" + name, "waiting " + name);
        std::string source = sources + "/" + c[0];
        if (c[0] == "(folder)")
            mkdir(source.c_str(), 0755);
        else if (c[0] != "(missing)")
            testkit::WriteFile(source, bytes);
        if (c[0] == "(unreadable)")
            chmod(source.c_str(), 0);
        const std::vector<std::string> before = Entries(target);

        const auto copy = [&]() -> std::string
        {
            wxString copiedAs, error;
            return CopyIntoHotFolder(wxString::FromUTF8(source.c_str()),
                                     wxString::FromUTF8(target.c_str()), copiedAs, error)
                       ? "copied as " + wxFileName(copiedAs).GetFullName().utf8_string()
                       : error.utf8_string();
        };
        // Root reads any file: the unreadable one is tried as a plain user.
        const std::string result =
            c[0] == "(unreadable)" && testkit::RunsAsRoot()
                ? (testkit::HandOver(scratch) ? testkit::AsUnprivileged(copy) : "no hand-over")
                : copy();
        if (c[3] == "copied")
        {
            ASSERT_EQ(result, "copied as " + c[4]);
            EXPECT_EQ(testkit::ReadFile(target + "/" + c[4]), bytes);
            for (const std::string& name : waiting)
                EXPECT_EQ(testkit::ReadFile(target + "/" + name), "waiting " + name);
            std::vector<std::string> after = before;
            after.push_back(c[4]);
            std::sort(after.begin(), after.end());
            EXPECT_EQ(Entries(target), after);
        }
        else
        {
            EXPECT_NE(result.find(c[4]), std::string::npos) << result;
            EXPECT_EQ(Entries(target), before);
        }
    }
}

TEST_F(DropCopy, TheHiddenCopyIsNoJobYet)
{
    const std::string folder = MakeFolder("hot");
    testkit::WriteFile(folder + "/.hf-drop-a1b2c3", "half a file");
    testkit::WriteFile(folder + "/whole.eps", "whole");
    const std::vector<wxString> listed = ListFolderFiles(folder);
    ASSERT_EQ(listed.size(), 1u);
    EXPECT_EQ(wxFileName(listed[0]).GetFullName(), "whole.eps");
}
} // namespace
