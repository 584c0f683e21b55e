#include <gtest/gtest.h>

#include <sys/wait.h>
#include <unistd.h>

#include <wx/log.h>

#include "WarehouseFixture.h"
#include "db/HFDatabase.h"

using db::HFDatabase;
using machinetest::ScopedUmask;
using storetest::ReadFile;
using storetest::TempDir;
using storetest::WriteFile;

namespace
{
class FolderList : public machinetest::WarehouseTest
{
protected:
    std::string File() const { return Warehouse() + "/HotFolderList.cfg"; }

    // The "path" of every entry in file order, read independently.
    std::vector<std::string> Entries() const
    {
        std::vector<std::string> paths;
        wxXmlDocument document;
        wxLogNull quiet;
        if (!document.Load(wxString::FromUTF8(File())))
            return paths;
        for (wxXmlNode* n = document.GetRoot()->GetChildren(); n; n = n->GetNext())
            if (n->GetName() == "HotFolder")
                paths.push_back(n->GetAttribute("path").ToStdString());
        return paths;
    }
    std::string Folder(const std::string& name)
    {
        const std::string path = m_folders / name;
        mkdir(path.c_str(), 0755);
        return path;
    }
    TempDir m_folders;
};

wxArrayString List()
{
    wxArrayString folders;
    HFDatabase::ReadFoldersList(folders);
    return folders;
}

std::vector<std::string> Std(const wxArrayString& list)
{
    std::vector<std::string> out;
    for (const wxString& s : list)
        out.push_back(s.ToStdString());
    return out;
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
    EXPECT_EQ(Std(List()), (std::vector<std::string>{a, b}));
    EXPECT_NE(ReadFile(File()).find("<HotFolderList>\n  <HotFolder path="), std::string::npos);
}

TEST_F(FolderList, ListingDropsVanishedFoldersAndCaseDuplicates)
{
    const std::string kept = Folder("Kept"), gone = Folder("Gone");
    HFDatabase::AddToHotfolderList(gone);
    HFDatabase::AddToHotfolderList(kept);
    ASSERT_EQ(rmdir(gone.c_str()), 0);
    const std::string upper = m_folders / "KEPT";
    HFDatabase::AddToHotfolderList(upper); // names no directory on a case-sensitive disk
    wxArrayString folders;
    folders.Add(wxString::FromUTF8(m_folders / "kept"));
    EXPECT_TRUE(HFDatabase::ReadFoldersList(folders));
    EXPECT_EQ(Std(folders), (std::vector<std::string>{m_folders / "kept"}));

    wxArrayString fromElsewhere;
    EXPECT_TRUE(
        HFDatabase::GetHotFolderListFromPath(fromElsewhere, wxString::FromUTF8(Warehouse())));
    EXPECT_EQ(Std(fromElsewhere), (std::vector<std::string>{kept}));
    EXPECT_FALSE(HFDatabase::GetHotFolderListFromPath(fromElsewhere, m_folders.wx()));
}

TEST_F(FolderList, AddUniqueIgnoresCase)
{
    wxArrayString list;
    HFDatabase::AddUniqueToList(list, "/a/B");
    HFDatabase::AddUniqueToList(list, "/A/b");
    HFDatabase::AddUniqueToList(list, "/a/c");
    EXPECT_EQ(Std(list), (std::vector<std::string>{"/a/B", "/a/c"}));
}

TEST_F(FolderList, DeleteAndEditChangeOnlyTheFirstMatch)
{
    HFDatabase::AddToHotfolderList("/x/one");
    HFDatabase::AddToHotfolderList("/x/Two");
    HFDatabase::AddToHotfolderList("/x/two");
    EXPECT_TRUE(HFDatabase::DeleteFromHotfolderList("/X/TWO"));
    EXPECT_EQ(Entries(), (std::vector<std::string>{"/x/one", "/x/two"}));
    EXPECT_FALSE(HFDatabase::DeleteFromHotfolderList("/x/none"));

    // Edit replaces the entry's attributes with the path alone.
    std::string text = ReadFile(File());
    text.replace(text.find("path=\"/x/one\""), 13, "extra=\"1\" path=\"/x/one\"");
    WriteFile(File(), text);
    EXPECT_TRUE(HFDatabase::EditHotFolderList("/X/One", "/y/new"));
    EXPECT_EQ(Entries(), (std::vector<std::string>{"/y/new", "/x/two"}));
    EXPECT_EQ(ReadFile(File()).find("extra="), std::string::npos);
    EXPECT_FALSE(HFDatabase::EditHotFolderList("/x/none", "/z"));
}

TEST_F(FolderList, WithoutListDeleteAndEditDoNothing)
{
    EXPECT_FALSE(HFDatabase::DeleteFromHotfolderList("/x"));
    EXPECT_FALSE(HFDatabase::EditHotFolderList("/x", "/y"));
    EXPECT_TRUE(List().empty());
    EXPECT_NE(access(Warehouse().c_str(), F_OK), 0);
}

TEST_F(FolderList, UnreadableListIsNeverReplaced)
{
    wxLogNull quiet;
    mkdir(Warehouse().c_str(), 0777);
    const std::string broken = "<HotFolderList><HotFolder path='/a'></HotFolderList>";
    WriteFile(File(), broken);
    EXPECT_FALSE(HFDatabase::AddToHotfolderList("/b"));
    EXPECT_FALSE(HFDatabase::DeleteFromHotfolderList("/a"));
    EXPECT_FALSE(HFDatabase::EditHotFolderList("/a", "/c"));
    EXPECT_TRUE(List().empty());
    EXPECT_EQ(ReadFile(File()), broken);
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
        ASSERT_EQ(waitpid(child, &status, 0), child);
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    }
    std::vector<std::string> entries = Entries();
    ASSERT_EQ(entries.size(), 1u + kProcesses * kEach);
    std::sort(entries.begin(), entries.end());
    for (int p = 0; p < kProcesses; ++p)
        for (int i = 0; i < kEach; ++i)
            EXPECT_TRUE(std::binary_search(entries.begin(), entries.end(),
                                           wxString::Format("/p%d/%d", p, i).ToStdString()));
}
