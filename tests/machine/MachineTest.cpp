// The machine-wide store: where it keeps its files, Preferences.cfg and the
// list of hot folders, each test with its own scratch warehouse.
#include <gtest/gtest.h>

#include <cstdio>

#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <wx/log.h>
#include <wx/utils.h>

#include "TestKit.h"
#include "db/HFDatabase.h"
#include "db/PathResolver.h"
#include "db/TempFolderCreator.h"
#include "hotfolder/HFTranslations.h"

using db::HFDatabase;
using db::PathResolver;

namespace
{
const std::string kData = HF_TEST_DATA_DIR "/machine/";

inline wxString Wx(const std::string& path)
{
    return wxString::FromUTF8(path);
}

inline unsigned ModeOf(const std::string& path)
{
    struct stat info;
    return ::stat(path.c_str(), &info) == 0 ? (info.st_mode & 07777) : 0xFFFFu;
}

class WarehouseTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        m_hadRoot = wxGetEnv("HOTFOLDER_WAREHOUSE_ROOT", &m_oldRoot);
        wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", Wx(m_root.Path()));
    }
    void TearDown() override
    {
        m_hadRoot ? wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", m_oldRoot)
                  : wxUnsetEnv("HOTFOLDER_WAREHOUSE_ROOT");
    }
    std::string Warehouse() const { return m_root.File("HotFolders"); }

    testkit::ScratchDir m_root;
    bool m_hadRoot = false;
    wxString m_oldRoot;
};

// Runs a block under a restrictive umask and restores the old one.
struct ScopedUmask
{
    const mode_t old = ::umask(077);
    ~ScopedUmask() { ::umask(old); }
};

wxString Resolve(const std::string& function, const std::string& arg)
{
    const wxString path = Wx(arg);
    db::stHFServerInfo server;
    server.m_strServerName = "Shown name";
    server.m_strServerDirectory = Wx(arg.substr(0, arg.find(' ')));
    const std::map<std::string, std::function<wxString()>> functions = {
        {"container", [&] { return PathResolver::GetContainerFolderPath(path); }},
        {"setting-file", [&] { return PathResolver::GetContainerFolder_SettingFilePath(path); }},
        {"server-ppd", [&] { return PathResolver::GetServerPPD_FilePath(path); }},
        {"work", [&] { return PathResolver::GetWorkFolderPath(path); }},
        {"fail", [&] { return PathResolver::GetFailFolderPath(path); }},
        {"default-fail", [&] { return PathResolver::GetDefaultFailFolderPath(path); }},
        {"backup", [&] { return PathResolver::GetBackUpFolderPath(path); }},
        {"container-name", [] { return PathResolver::GetContainerFolderPath(); }},
        {"server-database", [&] { return PathResolver::GetServerDatabasePath(server); }},
        {"preferences", [] { return PathResolver::GetPreferencesPath(); }},
        {"run-service", [] { return PathResolver::GetRunServiceFileName(); }},
        {"stop-all", [] { return PathResolver::GetStopAllHFFilePath().GetFullPath(); }},
        {"settings",
         [&] { return PathResolver::GetSettingsPath(server, Wx(arg.substr(arg.find(' ') + 1))); }},
        {"warehouse",
         [&]
         {
             arg == "(unset)" ? wxUnsetEnv("HOTFOLDER_WAREHOUSE_ROOT")
                              : wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", path);
             return PathResolver::GetWarehousePath();
         }},
        {"temp-name",
         [&]
         {
             wxDateTime moment;
             moment.ParseFormat(path, "%Y-%m-%d %H:%M:%S.%l");
             return utils::TempFolderCreator::FormatName(moment);
         }},
    };
    return functions.at(function)();
}

class Preferences : public WarehouseTest
{
protected:
    std::string File() const { return Warehouse() + "/Preferences.cfg"; }
    void WriteRaw(const std::string& text)
    {
        mkdir(Warehouse().c_str(), 0777);
        testkit::WriteFile(File(), text);
    }
    // What WritePreferences makes of p.
    std::string Written(const db::Preference& p)
    {
        EXPECT_EQ(HFDatabase::WritePreferences(p), 0);
        return testkit::ReadFile(File());
    }
};

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

std::vector<std::string> List(wxArrayString folders = {})
{
    HFDatabase::ReadFoldersList(folders);
    return Std(folders);
}
} // namespace

TEST_F(WarehouseTest, PathsOfTheTable)
{
    for (const testkit::CaseFields& c : testkit::Cases("machine/paths.txt", 4))
    {
        SCOPED_TRACE(c[0] + " | " + c[1]);
        wxString expected = Wx(c[2]);
        expected.Replace("$W", Wx(Warehouse()));
        wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", Wx(m_root.Path()));
        EXPECT_EQ(Resolve(c[0], c[1]), expected) << c[3];
    }
}

namespace
{
// The steps of one case of shared-folders.txt under the scratch folder
// scratch; the modes of the paths asked for, spelt as the table spells them.
std::string SharedFolderModes(const std::string& scratch, const std::string& steps,
                              const std::vector<std::string>& paths)
{
    ::umask(077);
    wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", Wx(scratch));
    for (const std::string& step : testkit::Split(steps, "; "))
    {
        const std::vector<std::string> words = testkit::Split(step, " ");
        if (words[0] == "root")
            wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", Wx(scratch + "/" + words[1]));
        else if (words[0] == "mkdir")
        {
            const std::string made = scratch + "/" + words[1];
            ::mkdir(made.c_str(), 0700);
            ::chmod(made.c_str(), static_cast<mode_t>(std::stoi(words[2], nullptr, 8)));
        }
        else if (words[0] == "marker")
            PathResolver::CreateRunServiceFile();
        else
            Resolve(words[0], "");
    }
    std::string modes;
    for (const std::string& path : paths)
    {
        const unsigned mode = ModeOf(scratch + "/" + path);
        char octal[16];
        std::snprintf(octal, sizeof octal, "%o", mode);
        modes += (modes.empty() ? "" : "; ") + path + " " + (mode == 0xFFFFu ? "none" : octal);
    }
    return modes;
}
} // namespace

TEST_F(WarehouseTest, SharedFoldersAreForEveryUserAndOnlyThey)
{
    for (const testkit::CaseFields& c : testkit::Cases("machine/shared-folders.txt", 3, 7))
    {
        SCOPED_TRACE(c[0]);
        testkit::ScratchDir scratch("hf-shared");
        ASSERT_TRUE(testkit::HandOver(scratch.Path()));
        std::vector<std::string> paths;
        for (const std::string& entry : testkit::Split(c[2], "; "))
            paths.push_back(entry.substr(0, entry.rfind(' ')));
        EXPECT_EQ(
            testkit::AsUnprivileged([&] { return SharedFolderModes(scratch.Path(), c[1], paths); }),
            c[2]);
    }
}

TEST_F(WarehouseTest, TheRunServiceMarkerIsMadeOnceAndRemoved)
{
    EXPECT_TRUE(PathResolver::CreateRunServiceFile());
    const std::string marker = Warehouse() + "/Service/RunService";
    EXPECT_EQ(testkit::ReadFile(marker), "");
    testkit::WriteFile(marker, "service state");
    EXPECT_FALSE(PathResolver::CreateRunServiceFile()); // an existing marker is left alone
    EXPECT_EQ(testkit::ReadFile(marker), "service state");
    EXPECT_TRUE(PathResolver::DeleteRunServiceFile());
    EXPECT_FALSE(PathResolver::DeleteRunServiceFile());
}

TEST(PreferenceModel, DefaultsAndEffectiveUnit)
{
    db::Preference p;
    EXPECT_TRUE(p.GetStatusAutoRefresh());
    EXPECT_EQ(p.GetAutoRefreshPresetValue(), "30");
    EXPECT_FALSE(p.GetStatusCustomLocation());
    EXPECT_EQ(p.GetUnit(), ""); // flag empty: the stored unit, even an empty one
    p.SetUnit("point");
    p.SetUserUnitChanged("False"); // until the user picks one, the system's
    wxString oldAll;
    const bool hadAll = wxGetEnv("LC_ALL", &oldAll);
    wxSetEnv("LC_ALL", "de_DE.UTF-8");
    EXPECT_EQ(p.GetUnit(), HFTranslations::GetInstance()->Translate("mm"));
    wxSetEnv("LC_ALL", "en_US.UTF-8");
    EXPECT_EQ(p.GetUnit(), HFTranslations::GetInstance()->Translate("inch"));
    hadAll ? wxSetEnv("LC_ALL", oldAll) : wxUnsetEnv("LC_ALL");
    p.SetUserUnitChanged("true");
    EXPECT_EQ(p.GetUnit(), "point");
}

TEST_F(Preferences, ReadAndWrittenAgain)
{
    wxLogNull quiet;
    {
        ScopedUmask restrictive;
        EXPECT_EQ(HFDatabase::WritePreferences(db::Preference()), 0);
        EXPECT_EQ(ModeOf(Warehouse()), 0777u);
    }
    db::Preference full;
    WriteRaw(testkit::ReadFile(kData + "PreferencesFull.cfg"));
    ASSERT_EQ(HFDatabase::ReadPreferences(full), -1);
    for (const testkit::CaseFields& c : testkit::Cases("machine/preferences-read.txt", 5))
    {
        SCOPED_TRACE(c[0]);
        unlink(File().c_str());
        if (c[0] != "(missing)")
            WriteRaw(c[0][0] == '<' ? c[0] : testkit::ReadFile(kData + c[0]));
        db::Preference p = c[1] == "new" ? db::Preference() : full;
        EXPECT_EQ(HFDatabase::ReadPreferences(p), std::stoi(c[2]));
        const std::string written = Written(p);
        if (c[3].rfind("has ", 0) == 0)
            EXPECT_NE(written.find(c[3].substr(4)), std::string::npos) << written << c[4];
        else
            EXPECT_EQ(written, testkit::ReadFile(kData + c[3])) << c[4];
    }
}

TEST_F(Preferences, TranslatedUnitWordReadsBackAsInch)
{
    HFTranslations* translations = HFTranslations::GetInstance();
    if (!translations->SelectLanguage("de"))
        GTEST_SKIP() << "no German catalogue";
    db::Preference p;
    p.SetUnit(translations->Translate("point")); // "Punkt"
    p.SetUserUnitChanged("true");
    EXPECT_EQ(HFDatabase::WritePreferences(p), 0);
    db::Preference read;
    HFDatabase::ReadPreferences(read);
    EXPECT_EQ(read.GetStoredUnit(), translations->Translate("inch"));
    translations->SelectLanguage("en");
    EXPECT_NE(read.GetStoredUnit(), "inch"); // the translated word, not the keyword
}

TEST_F(FolderList, AddingTwiceKeepsBothEntriesListingShowsOne)
{
    ScopedUmask restrictive;
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
    for (int p = 0; p < kProcesses; ++p)
        if (fork() == 0)
        {
            int failed = 0;
            for (int i = 0; i < kEach; ++i)
                failed += !HFDatabase::AddToHotfolderList(wxString::Format("/p%d/%d", p, i));
            _exit(failed);
        }
    int status = 0, succeeded = 0;
    while (wait(&status) > 0)
        succeeded += WIFEXITED(status) && WEXITSTATUS(status) == 0;
    EXPECT_EQ(succeeded, kProcesses);
    std::vector<std::string> entries = Entries();
    std::sort(entries.begin(), entries.end());
    entries.erase(std::unique(entries.begin(), entries.end()), entries.end());
    EXPECT_EQ(entries.size(), 1u + kProcesses * kEach); // each one there
}
