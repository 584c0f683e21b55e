// The host's own pieces: argument parsing, setting checks, safe moves and
// the settle rule of the watch.
#include <clocale>
#include <thread>

#include <wx/xml/xml.h>

#include <hotfolder/StatusCodes.h>

#include "cli/CommandLine.h"
#include "folder/FileMoves.h"
#include "module/FilterSettings.h"
#include "folder/FolderWatcher.h"
#include "HostTestSupport.h"
#include "module/SettingCatalogue.h"

using namespace host_test;

TEST(HostArguments, MultiValuedOptionsTakeOnlyAssignments)
{
    ParsedArgs parsed;
    std::string error;
    ASSERT_TRUE(ParseArgs(
        {"in.eps", "--set", "A=1", "B=x y", "--out=/tmp/o", "later", "--watch"},
        {{"--set", false, true, ""}, {"--out", true, false, ""}, {"--watch", false, false, ""}},
        parsed, error))
        << error;
    EXPECT_EQ(parsed.All("--set"), (std::vector<std::string>{"A=1", "B=x y"}));
    EXPECT_EQ(parsed.Get("--out"), "/tmp/o");
    EXPECT_TRUE(parsed.Has("--watch"));
    EXPECT_EQ(parsed.positionals, (std::vector<std::string>{"in.eps", "later"}));
}

TEST(HostArguments, MistakesAreNamed)
{
    const std::vector<OptionSpec> specs = {
        {"--out", true, false, "-o"}, {"--set", false, true, ""}, {"--watch", false, false, ""}};
    struct
    {
        std::vector<std::string> args;
        const char* message;
    } cases[] = {{{"--nope"}, "unknown option --nope"},
                 {{"-o"}, "-o needs a value"},
                 {{"--set", "plain"}, "--set needs at least one KEY=VALUE"},
                 {{"--watch=1"}, "--watch takes no value"}};
    for (const auto& c : cases)
    {
        ParsedArgs parsed;
        std::string error;
        EXPECT_FALSE(ParseArgs(c.args, specs, parsed, error));
        EXPECT_EQ(error, c.message);
    }
    ParsedArgs parsed;
    std::string error;
    ASSERT_TRUE(ParseArgs({"--", "--watch"}, specs, parsed, error));
    EXPECT_EQ(parsed.positionals, std::vector<std::string>{"--watch"});
}

TEST(HostSettingValues, StoredFormsUseTheFiltersEncodingInAnyLocale)
{
    // A decimal-comma locale must not leak into stored numbers.
    const char* previous = std::setlocale(LC_ALL, "de_DE.UTF-8");
    struct
    {
        const char* key;
        const char* value;
        const char* stored;
    } accepted[] = {{"AUTOROTATE", "Yes", "1"},
                    {"FITTOPAGE", "off", "0"},
                    {"FORCEPAGESIZEX", "612", "612.000000"},
                    {"FORCEPAGESIZEY", "841,89", "841.890000"},
                    {"ORIGINALWIDTH", " 2,5 ", "2.5"},
                    {"CUSTOMPAGETUNIT", "1", "1"},
                    {"IMAGEPOSITION", "bottom RIGHT", "Bottom Right"}};
    for (const auto& c : accepted)
    {
        wxString stored, error;
        EXPECT_TRUE(NormaliseSettingValue(c.key, c.value, stored, error)) << c.key << error;
        EXPECT_EQ(stored, c.stored) << c.key;
    }
    const char* refused[][2] = {{"FORCEPAGESIZEX", "-1"},  {"FORCEPAGESIZEX", "12pt"},
                                {"ORIGINALWIDTH", "0"},    {"ORIGINALWIDTH", "nan"},
                                {"CUSTOMPAGETUNIT", "3"},  {"ORIGINALWIDTHUNIT", "Inch"},
                                {"DEFAULTPAGESIZE", "  "}, {"orientationpotrait", "1"}};
    for (const auto& c : refused)
    {
        wxString stored = "untouched", error;
        EXPECT_FALSE(NormaliseSettingValue(c[0], c[1], stored, error)) << c[0] << "=" << c[1];
        EXPECT_FALSE(error.empty());
    }
    std::setlocale(LC_ALL, previous ? previous : "C");
}

TEST(HostSettingValues, APaperBringsItsPageKeysButExplicitValuesWin)
{
    stPageAttribute a4;
    a4.PaperName = "A4";
    a4.PaperDisplayName = "A4 (210 x 297 mm)";
    a4.Left = 10;
    a4.Top = 11;
    a4.Right = 585;
    a4.Bottom = 832;
    a4.Width = 595;
    a4.Height = 842;
    a4.PSCommand = "a4";
    wxXmlNode filter(wxXML_ELEMENT_NODE, "Filter");
    wxString error;
    ASSERT_TRUE(ApplySettingAssignments(
        &filter, {"FORCEPAGESIZEY=900", "DEFAULTPAGESIZE=A4 (210 x 297 mm)"}, {a4}, error))
        << error;
    std::map<wxString, wxString> settings;
    for (const auto& entry : ReadFilterSettings(&filter))
        settings[entry.first] = entry.second;
    EXPECT_EQ(settings["DEFAULTPAGESIZE"], "A4");
    EXPECT_EQ(settings["FORCEPAGESIZEX"], "595.000000");
    EXPECT_EQ(settings["FORCEPAGESIZEY"], "900.000000");
    EXPECT_EQ(settings["IMAGEEABLESIZELLY"], "11.000000");
    EXPECT_EQ(settings["PAGESIZE_COMMAND"], "a4");
    EXPECT_EQ(settings["CUSTOMPAGESIZE"], "0");

    // One bad assignment and nothing changes.
    const size_t before = ReadFilterSettings(&filter).size();
    EXPECT_FALSE(
        ApplySettingAssignments(&filter, {"AUTOROTATE=1", "DEFAULTPAGESIZE=A5"}, {a4}, error));
    EXPECT_EQ(ReadFilterSettings(&filter).size(), before);
    // Without a server every paper name is taken as it is.
    EXPECT_TRUE(ApplySettingAssignments(&filter, {"DEFAULTPAGESIZE=A5"}, {}, error));
}

class HostFilesTest : public HostTest
{
};

TEST_F(HostFilesTest, MovesNeverReplaceAndNeverLoseTheSource)
{
    mkdir((scratch + "/to").c_str(), 0777);
    WriteFile(scratch + "/to/a.b.ps", "old");
    WriteFile(scratch + "/a.b.ps", "new");
    wxString moved, error;
    ASSERT_TRUE(MoveIntoDirectory(scratch + "/a.b.ps", scratch + "/to", "a.b.ps", moved, error));
    EXPECT_EQ(moved, scratch + "/to/a.b (2).ps");
    EXPECT_EQ(ReadFile(scratch + "/to/a.b.ps"), "old");
    EXPECT_EQ(ReadFile(scratch + "/to/a.b (2).ps"), "new");
    EXPECT_EQ(NumberedName("README", 3), "README (3)");

    WriteFile(scratch + "/keep.eps", "precious");
    EXPECT_FALSE(
        MoveIntoDirectory(scratch + "/keep.eps", scratch + "/absent", "keep.eps", moved, error));
    EXPECT_NE(error.find("cannot move"), wxString::npos);
    EXPECT_EQ(ReadFile(scratch + "/keep.eps"), "precious");

    // Across file systems (/dev/shm is tmpfs) the move copies, then unlinks.
    char shared[] = "/dev/shm/hf-host-move-XXXXXX";
    if (mkdtemp(shared))
    {
        ASSERT_TRUE(MoveIntoDirectory(scratch + "/keep.eps", shared, "keep.eps", moved, error))
            << error;
        EXPECT_EQ(ReadFile(std::string(shared) + "/keep.eps"), "precious");
        EXPECT_FALSE(Exists(scratch + "/keep.eps"));
        EXPECT_EQ(ListDirectory(shared), std::vector<std::string>{"keep.eps"});
        nftw(shared, RemoveEntry, 8, FTW_DEPTH | FTW_PHYS);
    }
}

TEST_F(HostFilesTest, AFileSettlesOnlyWhenItStopsChanging)
{
    const std::string path = scratch + "/growing.eps";
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

    mkdir((scratch + "/sub").c_str(), 0777);
    WriteFile(scratch + "/.hidden.eps", "x");
    EXPECT_EQ(ListFolderFiles(scratch), std::vector<wxString>{wxString(path)});
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
