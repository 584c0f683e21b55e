#include <gtest/gtest.h>

#include <unistd.h>

#include "WarehouseFixture.h"
#include "db/HFDatabase.h"
#include "db/PathResolver.h"
#include "db/TempFolderCreator.h"

using db::PathResolver;
using machinetest::ScopedUmask;
using machinetest::WarehouseTest;
using storetest::ReadFile;
using storetest::TempDir;
using storetest::WriteFile;

TEST(PathResolverLayout, WarehouseRootDefaultsToVarLib)
{
    wxString old;
    const bool had = wxGetEnv("HOTFOLDER_WAREHOUSE_ROOT", &old);
    wxUnsetEnv("HOTFOLDER_WAREHOUSE_ROOT");
    EXPECT_EQ(PathResolver::GetWarehousePath(), "/var/lib/HotFolders/");
    wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", "/srv/store");
    EXPECT_EQ(PathResolver::GetWarehousePath(), "/srv/store/HotFolders/");
    if (had)
        wxSetEnv("HOTFOLDER_WAREHOUSE_ROOT", old);
    else
        wxUnsetEnv("HOTFOLDER_WAREHOUSE_ROOT");
}

TEST(PathResolverLayout, ContainerPathsWithAndWithoutTrailingSeparator)
{
    for (const char* hotFolder : {"/jobs/In", "/jobs/In/"})
    {
        SCOPED_TRACE(hotFolder);
        EXPECT_EQ(PathResolver::GetContainerFolderPath(hotFolder), "/jobs/In/[_Orv_HotFolder_]/");
        EXPECT_EQ(PathResolver::GetContainerFolder_SettingFilePath(hotFolder),
                  "/jobs/In/[_Orv_HotFolder_]/Folder.cfg");
        EXPECT_EQ(PathResolver::GetServerPPD_FilePath(hotFolder),
                  "/jobs/In/[_Orv_HotFolder_]/server.ppd");
        EXPECT_EQ(PathResolver::GetWorkFolderPath(hotFolder),
                  "/jobs/In/[_Orv_HotFolder_]/[WorkFolder]/");
        EXPECT_EQ(PathResolver::GetFailFolderPath(hotFolder),
                  "/jobs/In/[_Orv_HotFolder_]/[FailedFolder]/");
        EXPECT_EQ(PathResolver::GetBackUpFolderPath(hotFolder),
                  "/jobs/In/[_Orv_HotFolder_]/[MoveFolder]/");
        EXPECT_EQ(PathResolver::GetDefaultKeepOriginalPath(hotFolder),
                  PathResolver::GetBackUpFolderPath(hotFolder));
        EXPECT_EQ(PathResolver::GetDefaultFailFolderPath(hotFolder),
                  PathResolver::GetFailFolderPath(hotFolder));
    }
    EXPECT_EQ(PathResolver::GetContainerFolderPath(), "[_Orv_HotFolder_]");
    EXPECT_EQ(PathResolver::GetOldContainerFolderPath(), "[_Orv_HotFolder_Old]");
    EXPECT_EQ(PathResolver::GetMACOldContainerFolderPath(), "_Orv_HotFolder_");
}

TEST_F(WarehouseTest, ServerDatabaseAndSettingFiles)
{
    db::stHFServerInfo server;
    server.m_strServerName = "Shown name";
    server.m_strServerDirectory = "press_1";
    EXPECT_EQ(PathResolver::GetServerDatabasePath(server), Warehouse() + "/press_1/");
    EXPECT_EQ(PathResolver::GetSettingsPath(server, "Proofs"), Warehouse() + "/press_1/Proofs.cfg");
    db::Setting setting;
    setting.SetName("v1.2");
    EXPECT_EQ(PathResolver::GetSettingsPath(server, setting), Warehouse() + "/press_1/v1.2.cfg");
}

TEST_F(WarehouseTest, SharedDirectoriesAreWorldWritableDespiteUmask)
{
    ScopedUmask restrictive(077);
    EXPECT_EQ(PathResolver::GetPreferencesPath(), Warehouse() + "/Preference/");
    EXPECT_EQ(ModeOf(Warehouse()), 0777u);
    EXPECT_EQ(ModeOf(Warehouse() + "/Preference"), 0777u);

    EXPECT_EQ(PathResolver::GetRunServiceFileName(), Warehouse() + "/Service/RunService");
    EXPECT_EQ(ModeOf(Warehouse() + "/Service"), 0777u);
    EXPECT_EQ(PathResolver::GetStopAllHFFilePath().GetFullPath(), Warehouse() + "/StopHF");
}

TEST_F(WarehouseTest, ExistingDirectoriesKeepTheirMode)
{
    ASSERT_EQ(mkdir(Warehouse().c_str(), 0750), 0);
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
    EXPECT_EQ(ReadFile(marker), "");
    WriteFile(marker, "service state");
    EXPECT_FALSE(PathResolver::CreateRunServiceFile()); // existing marker left alone
    EXPECT_EQ(ReadFile(marker), "service state");
    EXPECT_TRUE(PathResolver::DeleteRunServiceFile());
    EXPECT_FALSE(PathResolver::DeleteRunServiceFile());
}

TEST(TempFolderName, UnpaddedFieldsOfLocalTimeDownToTheMillisecond)
{
    const wxDateTime moment(5, wxDateTime::Jan, 2024, 7, 8, 9, 45);
    EXPECT_EQ(utils::TempFolderCreator::FormatName(moment), "20241578945");
    const wxDateTime later(31, wxDateTime::Dec, 2024, 23, 59, 59, 999);
    EXPECT_EQ(utils::TempFolderCreator::FormatName(later), "20241231235959999");
    // Same millisecond, same name: callers accept the rare clash.
    EXPECT_EQ(utils::TempFolderCreator::FormatName(moment),
              utils::TempFolderCreator::FormatName(wxDateTime(moment)));
    const wxString now = utils::TempFolderCreator::GetTempFolder();
    EXPECT_TRUE(now.IsNumber()) << now;
    EXPECT_TRUE(now.StartsWith(wxString::Format("%d", wxDateTime::Now().GetYear())));
}

TEST_F(WarehouseTest, TempLocationIsBelowTheRecordedWorkFolder)
{
    TempDir hotFolder;
    ASSERT_EQ(mkdir(PathResolver::GetContainerFolderPath(hotFolder.wx()).fn_str(), 0755), 0);
    db::Setting setting;
    db::FolderConfiguration folders;
    folders.SetWorkFolder("/spool/work");
    wxString saved;
    ASSERT_EQ(db::HFDatabase::WriteFolderProperties(
                  PathResolver::GetContainerFolder_SettingFilePath(hotFolder.wx()), setting,
                  db::JobConfiguration(), folders, db::FilterConfiguration(),
                  db::ImposeConfiguration(), db::PreflightConfiguration(), saved),
              0);
    const wxString temp = PathResolver::GetTempLocationForWorkFolder(hotFolder.wx());
    ASSERT_TRUE(temp.StartsWith("/spool/work/")) << temp;
    ASSERT_TRUE(temp.EndsWith("/")) << temp;
    const wxString name = temp.Mid(12, temp.length() - 13);
    EXPECT_TRUE(name.IsNumber()) << temp;
    EXPECT_FALSE(wxFileName::DirExists(temp));
}
