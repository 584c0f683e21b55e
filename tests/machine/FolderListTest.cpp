// The machine's list of hot folders, HotFolderList.cfg.
#include <gtest/gtest.h>

#include <sys/wait.h>
#include <unistd.h>

#include <wx/log.h>

#include "WarehouseFixture.h"
#include "db/HFDatabase.h"

using db::HFDatabase;
using namespace machinetest;

namespace
{
class FolderList : public WarehouseTest
{
protected:
    std::string File() const { return Warehouse() + "/HotFolderList.cfg"; }

    // The "path" of every entry in file order, read by another XML reader.
    std::vector<std::string> Entries() const
    {
        std::vector<std::string> paths;
        wxXmlDocument document;
        wxLogNull quiet;
        if (document.Load(Wx(File())))
            for (wxXmlNode* n = document.GetRoot()->GetChildren(); n; n = n->GetNext())
                if (n->GetName() == "HotFolder")
                    paths.push_back(n->GetAttribute("path").ToStdString());
        return paths;
    }
    std::string Folder(const std::string& name) const { return m_folders.Sub(name); }
    testkit::ScratchDir m_folders;
};

std::vector<std::string> Std(const wxArrayString& list)
{
    return std::vector<std::string>(list.begin(), list.end());
}

std::vector<std::string> List()
{
    wxArrayString folders;
    HFDatabase::ReadFoldersList(folders);
    return Std(folders);
}
} // namespace

TEST_F(FolderList, AddingTwiceKeepsBothEntriesListingShowsOne)
{
    ScopedUmask restrictive(077);
    const std::string a = Folder("A"), b = Folder("B");
    EXPECT_TRUE(HFDatabase::AddToHotfolderList(a));
    EXPECT_EQ(ModeOf(Warehouse()), 0777u);
    EXPECT_TRUE(HFDatabase::AddToHotfolderList(b));
    EXPECT_TRUE(HFDatabase::AddToHotfolderList(a));
    EXPECT_EQ(Entries(), (std::vector<std::string>{a, b, a}));
    EXPECT_EQ(List(), (std::vector<std::string>{a, b}));
    EXPECT_NE(testkit::ReadFile(File()).find("<HotFolderList>\n  <HotFolder path="),
              std::string::npos);
}

TEST_F(FolderList, ListingDropsVanishedFoldersAndCaseDuplicates)
{
    const std::string kept = Folder("Kept"), gone = Folder("Gone");
    HFDatabase::AddToHotfolderList(gone);
    HFDatabase::AddToHotfolderList(kept);
    ASSERT_EQ(rmdir(gone.c_str()), 0);
    HFDatabase::AddToHotfolderList(m_folders.File("KEPT")); // no such directory here
    wxArrayString folders;
    folders.Add(Wx(m_folders.File("kept")));
    EXPECT_TRUE(HFDatabase::ReadFoldersList(folders));
    EXPECT_EQ(Std(folders), (std::vector<std::string>{m_folders.File("kept")}));

    wxArrayString fromElsewhere;
    EXPECT_TRUE(HFDatabase::GetHotFolderListFromPath(fromElsewhere, Wx(Warehouse())));
    EXPECT_EQ(Std(fromElsewhere), (std::vector<std::string>{kept}));
    EXPECT_FALSE(HFDatabase::GetHotFolderListFromPath(fromElsewhere, Wx(m_folders.Path())));

    wxArrayString list; // adding to a list ignores case
    for (const char* path : {"/a/B", "/A/b", "/a/c"})
        HFDatabase::AddUniqueToList(list, path);
    EXPECT_EQ(Std(list), (std::vector<std::string>{"/a/B", "/a/c"}));
}

TEST_F(FolderList, DeleteAndEditChangeOnlyTheFirstMatch)
{
    EXPECT_FALSE(HFDatabase::DeleteFromHotfolderList("/x")); // no list yet
    EXPECT_FALSE(HFDatabase::EditHotFolderList("/x", "/y"));
    EXPECT_FALSE(testkit::Exists(Warehouse()));
    for (const char* path : {"/x/one", "/x/Two", "/x/two"})
        HFDatabase::AddToHotfolderList(path);
    EXPECT_TRUE(HFDatabase::DeleteFromHotfolderList("/X/TWO"));
    EXPECT_EQ(Entries(), (std::vector<std::string>{"/x/one", "/x/two"}));
    EXPECT_FALSE(HFDatabase::DeleteFromHotfolderList("/x/none"));

    // Edit replaces the entry's attributes with the path alone.
    std::string text = testkit::ReadFile(File());
    text.replace(text.find("path=\"/x/one\""), 13, "extra=\"1\" path=\"/x/one\"");
    testkit::WriteFile(File(), text);
    EXPECT_TRUE(HFDatabase::EditHotFolderList("/X/One", "/y/new"));
    EXPECT_EQ(Entries(), (std::vector<std::string>{"/y/new", "/x/two"}));
    EXPECT_EQ(testkit::ReadFile(File()).find("extra="), std::string::npos);
    EXPECT_FALSE(HFDatabase::EditHotFolderList("/x/none", "/z"));
}

TEST_F(FolderList, UnreadableListIsNeverReplaced)
{
    wxLogNull quiet;
    mkdir(Warehouse().c_str(), 0777);
    const std::string broken = "<HotFolderList><HotFolder path='/a'></HotFolderList>";
    testkit::WriteFile(File(), broken);
    EXPECT_FALSE(HFDatabase::AddToHotfolderList("/b"));
    EXPECT_FALSE(HFDatabase::DeleteFromHotfolderList("/a"));
    EXPECT_FALSE(HFDatabase::EditHotFolderList("/a", "/c"));
    EXPECT_TRUE(List().empty());
    EXPECT_EQ(testkit::ReadFile(File()), broken);
}

TEST_F(FolderList, ConcurrentAddersFromSeveralProcessesLoseNothing)
{
    const int kProcesses = 4, kEach = 40;
    HFDatabase::AddToHotfolderList("/seed"); // every adder starts from an existing list
    std::vector<pid_t> children;
    for (int p = 0; p < kProcesses; ++p)
    {
        const pid_t child = fork();
        ASSERT_NE(child, -1);
        if (child == 0)
        {
            int failed = 0;
            for (int i = 0; i < kEach; ++i)
                failed += !HFDatabase::AddToHotfolderList(wxString::Format("/p%d/%d", p, i));
            _exit(failed);
        }
        children.push_back(child);
    }
    for (pid_t child : children)
    {
        int status = 0;
        EXPECT_TRUE(waitpid(child, &status, 0) == child && WIFEXITED(status) &&
                    WEXITSTATUS(status) == 0);
    }
    std::vector<std::string> entries = Entries();
    std::sort(entries.begin(), entries.end());
    entries.erase(std::unique(entries.begin(), entries.end()), entries.end());
    EXPECT_EQ(entries.size(), 1u + kProcesses * kEach); // each one there
}
