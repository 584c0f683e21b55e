// Where the store keeps its files, and the machine-wide folders it makes.
#include <gtest/gtest.h>

#include <unistd.h>

#include "WarehouseFixture.h"
#include "db/PathResolver.h"
#include "db/TempFolderCreator.h"
#include "posix/Directories.h"

using db::PathResolver;
using namespace machinetest;

namespace
{
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
    const auto found = functions.find(function);
    return found == functions.end() ? wxString("unknown function") : found->second();
}
} // namespace

TEST_F(WarehouseTest, PathsOfTheTable)
{
    const auto cases = testkit::ReadCaseTable("machine/paths.txt");
    ASSERT_FALSE(cases.empty());
    for (const testkit::CaseFields& c : cases)
    {
        ASSERT_EQ(c.size(), 4u);
        SCOPED_TRACE(c[0] + " | " + c[1]);
        wxString expected = Wx(c[2]);
        expected.Replace("$W", Wx(Warehouse()));
        wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", Wx(m_root.Path()));
        EXPECT_EQ(Resolve(c[0], c[1]), expected) << c[3];
    }
}

TEST_F(WarehouseTest, SharedDirectoriesAreWorldWritableDespiteUmaskExistingOnesKeepTheirMode)
{
    {
        ScopedUmask restrictive(077);
        PathResolver::GetPreferencesPath();
        PathResolver::GetRunServiceFileName();
    }
    for (const char* made : {"", "/Preference", "/Service"})
        EXPECT_EQ(ModeOf(Warehouse() + made), 0777u) << made;
    ASSERT_EQ(chmod(Warehouse().c_str(), 0750), 0);
    ASSERT_EQ(rmdir((Warehouse() + "/Preference").c_str()), 0);
    PathResolver::GetPreferencesPath();
    EXPECT_EQ(ModeOf(Warehouse()), 0750u);
    EXPECT_EQ(ModeOf(Warehouse() + "/Preference"), 0777u);
}

TEST_F(WarehouseTest, RunServiceMarkerIsCreatedOnceAndRemoved)
{
    ScopedUmask restrictive(077);
    const std::string marker = Warehouse() + "/Service/RunService";
    EXPECT_TRUE(PathResolver::CreateRunServiceFile());
    EXPECT_EQ(ModeOf(marker), 0666u);
    EXPECT_EQ(testkit::ReadFile(marker), "");
    testkit::WriteFile(marker, "service state");
    EXPECT_FALSE(PathResolver::CreateRunServiceFile()); // existing marker left alone
    EXPECT_EQ(testkit::ReadFile(marker), "service state");
    EXPECT_TRUE(PathResolver::DeleteRunServiceFile());
    EXPECT_FALSE(PathResolver::DeleteRunServiceFile());
}

// A tree goes whole: files first, then the folders that held them.
TEST(RemoveTree, RemovesNestedFoldersAndFiles)
{
    testkit::ScratchDir dir;
    dir.Sub("tree/a/b");
    testkit::WriteFile(dir.File("tree/a/b/file"), "x");
    testkit::WriteFile(dir.File("tree/top"), "x");
    EXPECT_EQ(posix::RemoveTree(dir.File("tree")), 0);
    EXPECT_FALSE(testkit::Exists(dir.File("tree")));
}
