// The on-disk form of Folder.cfg, which the host and every filter share:
// files written and read are compared with reviewed ones in tests/data/store.
#include <gtest/gtest.h>

#include <wx/log.h>

#include "FolderFixtures.h"

using namespace storetest;

namespace
{
const std::string kData = HF_TEST_DATA_DIR "/store/";

// An XML reader that is not the product's says whether the file loads.
void ExpectWellFormed(const std::string& path)
{
    if (!testkit::ProgramAvailable("xmllint"))
        return;
    const testkit::ProcessResult lint = testkit::RunProgram({"xmllint", "--noout", path});
    EXPECT_EQ(lint.exitCode, 0) << lint.err;
}
} // namespace

TEST(FolderFileFormat, WrittenFilesMatchTheReviewedOnesAndReadBackWhole)
{
    const auto cases = testkit::ReadCaseTable("store/folder-format.txt");
    ASSERT_FALSE(cases.empty());
    for (const testkit::CaseFields& c : cases)
    {
        SCOPED_TRACE(c[0] + " | " + c[1]);
        const std::string golden = testkit::ReadFile(kData + c[1]);
        ASSERT_FALSE(golden.empty());
        testkit::ScratchDir dir;
        ASSERT_EQ(Variant(c[0]).Write(dir.File("Folder.cfg")), 0);
        EXPECT_EQ(testkit::ReadFile(dir.File("Folder.cfg")), golden);
        ExpectWellFormed(dir.File("Folder.cfg"));
        FolderConfig read;
        EXPECT_EQ(read.ReadAll(dir.File("Folder.cfg")), 1);
        EXPECT_EQ(read.Bytes(), golden);
    }
}

TEST(FolderFileFormat, ReadIntoAConfigurationAndWrittenAgain)
{
    wxLogNull quiet; // the loader's error messages are expected here
    for (const testkit::CaseFields& c : testkit::Cases("store/folder-read.txt", 5))
    {
        SCOPED_TRACE(c[0] + " | " + c[1]);
        testkit::ScratchDir dir;
        const std::string path = c[0] == "(missing)"     ? dir.File("none.cfg")
                                 : c[0] == "(directory)" ? dir.Sub("dir.cfg")
                                                         : kData + c[0];
        FolderConfig config = Variant(c[1]);
        EXPECT_EQ(config.ReadAll(path), std::stoi(c[2]));
        EXPECT_EQ(config.Bytes(), testkit::ReadFile(kData + c[3])) << c[4];
    }
}

TEST(FolderFileFormat, CharactersXmlCannotCarryAreLeftOutSoTheFileStillLoads)
{
    testkit::ScratchDir dir;
    FolderConfig config = FullFolderConfig();
    config.setting.SetDescription(wxString("a") + wxUniChar(0x01) + "b" + wxUniChar(0x1F) +
                                  wxUniChar(0xFFFE) + wxUniChar(0xFFFF) +
                                  wxString::FromUTF8("c\t\xc3\xa4") + wxUniChar(0x10000));
    config.job.SaveProperty(wxString("Key") + wxUniChar(0x0B), "v", "v", "v");
    ASSERT_EQ(config.Write(dir.File("Folder.cfg")), 0);
    ExpectWellFormed(dir.File("Folder.cfg"));
    FolderConfig read;
    EXPECT_EQ(read.ReadAll(dir.File("Folder.cfg")), 1);
    // Tab, non-ASCII and astral characters are kept.
    EXPECT_EQ(read.setting.GetDescription(),
              wxString::FromUTF8("abc\t\xc3\xa4") + wxUniChar(0x10000));
    EXPECT_EQ(read.job.GetProperties().count("Key"), 1u);
    EXPECT_EQ(read.setting.GetServerName(), "press-1");
}
