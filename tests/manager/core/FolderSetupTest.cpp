// Adding, rebinding and removing folders through the manager, with a PPD, a
// queue of a scheduler of the test's own, and no printer; the list read back.
#include <sys/stat.h>

#include <memory>

#include "CoreTestSupport.h"
#include "PrivateCupsd.h"
#include "core/FolderRows.h"

using namespace core_test;

namespace
{
PrinterChoice Choice(const std::string& field, const std::string& folder = "")
{
    PrinterChoice choice;
    const size_t space = field.find(' ');
    const std::string kind = field.substr(0, space);
    const std::string value = space == std::string::npos ? "" : field.substr(space + 1);
    if (kind == "queue")
        choice = {PrinterChoice::Kind::Queue, value};
    else if (kind == "ppd")
        choice = {PrinterChoice::Kind::PpdFile,
                  value == "(stored)" ? folder + "/[_Orv_HotFolder_]/server.ppd"
                  : value[0] == '/'   ? value
                                      : std::string(HF_TEST_DATA_DIR) + "/ppd/" + value};
    return choice;
}

std::string Described(const PrinterChoice& choice)
{
    switch (choice.kind)
    {
    case PrinterChoice::Kind::Queue:
        return "queue " + choice.value;
    case PrinterChoice::Kind::PpdFile:
        return "ppd";
    default:
        return "none";
    }
}

std::string ListedName(const std::string& folder)
{
    for (const FolderRow& row : ReadFolderRows())
        if (row.path == folder || row.path == folder + "/")
            return std::string(row.name.utf8_str());
    return "(not listed)";
}

class FolderSetup : public CoreTest
{
protected:
    // One scheduler for the whole run: the client library keeps its
    // connection to the first one it reached.
    static void SetUpTestSuite()
    {
        if (!cups_test::PrivateCupsd::Installed())
            return;
        cupsRoot = std::make_unique<testkit::ScratchDir>("hf-manager-cups");
        // The scheduler's filters run as its own user and must reach the spool.
        chmod(cupsRoot->Path().c_str(), 0755);
        cups = std::make_unique<cups_test::PrivateCupsd>(cupsRoot->Sub("cups"));
        std::string problem;
        if (!cups->Start(problem) ||
            !cups->AddFileQueue("office", HF_TEST_DATA_DIR "/ppd/test-postscript.ppd",
                                cupsRoot->File("device.ps"), problem))
        {
            ADD_FAILURE() << problem;
            cups.reset();
            return;
        }
        setenv("CUPS_SERVER", cups->Server().c_str(), 1);
    }
    static void TearDownTestSuite()
    {
        unsetenv("CUPS_SERVER");
        cups.reset();
        cupsRoot.reset();
    }

    // Rows naming a queue need the scheduler.
    bool Skipped(const testkit::CaseFields& c)
    {
        for (const std::string& field : c)
            if (field.rfind("queue", 0) == 0 && !cups)
                return true;
        return false;
    }

    static inline std::unique_ptr<testkit::ScratchDir> cupsRoot;
    static inline std::unique_ptr<cups_test::PrivateCupsd> cups;
};

TEST_F(FolderSetup, AddsFoldersAsInitDoesAndListsThemInOrder)
{
    std::vector<std::pair<std::string, std::string>> listed;
    int number = 0;
    for (const auto& c : testkit::Cases("manager/core-setup.txt", 7, 6))
    {
        SCOPED_TRACE(c[0] + " | " + c[1]);
        if (Skipped(c))
            continue;
        const std::string folderName = "f" + std::to_string(++number);
        const std::string folder = scratch + "/" + folderName;
        wxString warnings, error;
        const bool created =
            CreateHotFolder(folder, c[1] == "-" ? "" : wxString::FromUTF8(c[1].c_str()),
                            Choice(c[0]), HF_MODULE_PATH, warnings, error);
        ASSERT_EQ(created ? "yes" : "no", c[2]) << error;
        if (!created)
        {
            EXPECT_NE(error.utf8_string().find(c[6]), std::string::npos) << error;
            EXPECT_FALSE(testkit::Exists(Container(folder) + "/Folder.cfg"));
            continue;
        }
        listed.emplace_back(folder, c[3] == "(folder)" ? folderName : c[3]);
        EXPECT_EQ(Described(CurrentPrinterChoice(folder)), c[4] != "-"     ? "queue " + c[4]
                                                           : c[5] == "yes" ? "ppd"
                                                                           : "none");
        EXPECT_EQ(testkit::Exists(Container(folder) + "/server.ppd"), c[5] == "yes");
    }
    const std::vector<FolderRow> rows = ReadFolderRows();
    ASSERT_EQ(rows.size(), listed.size());
    for (size_t i = 0; i < rows.size(); ++i)
    {
        EXPECT_EQ(rows[i].path.utf8_string(), listed[i].first);
        EXPECT_EQ(rows[i].name.utf8_string(), listed[i].second);
        EXPECT_EQ(rows[i].status.name.utf8_string(), listed[i].second); // stored, not made up
        EXPECT_EQ(rows[i].status.problem, "");
    }

    // Off the list, the folder and its configuration stay; a second time it is not listed.
    wxString error;
    ASSERT_TRUE(RemoveFolderFromList(listed[0].first, error)) << error;
    EXPECT_EQ(ReadFolderRows().size(), listed.size() - 1);
    EXPECT_TRUE(testkit::Exists(Container(listed[0].first) + "/Folder.cfg"));
    EXPECT_FALSE(RemoveFolderFromList(listed[0].first, error));
}

TEST_F(FolderSetup, RebindsAndRenamesOrChangesNothing)
{
    int number = 0;
    for (const auto& c : testkit::Cases("manager/core-rebind.txt", 6, 6))
    {
        SCOPED_TRACE(c[0] + " -> " + c[1]);
        if (Skipped(c))
            continue;
        const std::string folder = MakeFolder("r" + std::to_string(++number), Choice(c[0]));
        const std::string start = ListedName(folder);
        wxString error;
        const bool changed = ChangeFolderSetup(folder, wxString::FromUTF8(c[2].c_str()),
                                               Choice(c[1], folder), error);
        EXPECT_EQ(changed ? "yes" : "no", c[3]) << error;
        EXPECT_EQ(Described(CurrentPrinterChoice(folder)), c[4]);
        EXPECT_EQ(ListedName(folder), c[5] == "start" ? start : c[5]);
    }
}

TEST_F(FolderSetup, PanelServerComesFromTheChosenPrinter)
{
    wxString xml, error;
    ASSERT_TRUE(LoadPrinterServer(Choice("none"), xml, error));
    EXPECT_TRUE(xml.empty());
    ASSERT_TRUE(LoadPrinterServer(Choice("ppd test-postscript.ppd"), xml, error)) << error;
    EXPECT_NE(xml.Find("ServerName"), wxNOT_FOUND);
    EXPECT_FALSE(LoadPrinterServer(Choice("ppd missing.ppd"), xml, error));
    EXPECT_TRUE(xml.empty());
}
} // namespace
