// The on-disk form of Folder.cfg, which the host and every filter share.
#include <gtest/gtest.h>

#include "FolderFixtures.h"
#include "StoreTestSupport.h"
#include "XmlHelper.h"

using namespace storetest;

namespace
{
std::unique_ptr<wxXmlDocument> LoadRaw(const std::string& path)
{
    auto document = std::make_unique<wxXmlDocument>();
    EXPECT_TRUE(document->Load(wxString::FromUTF8(path), "UTF-8"));
    return document;
}

std::vector<std::string> AttributeNames(const wxXmlNode* node)
{
    std::vector<std::string> names;
    for (const wxXmlAttribute* a = node->GetAttributes(); a; a = a->GetNext())
        names.push_back(a->GetName().ToStdString());
    return names;
}

std::vector<std::string> ChildNames(const wxXmlNode* node)
{
    std::vector<std::string> names;
    for (const wxXmlNode* c = node->GetChildren(); c; c = c->GetNext())
        if (c->GetType() == wxXML_ELEMENT_NODE)
            names.push_back(c->GetName().ToStdString());
    return names;
}

const std::vector<std::string> kRootAttributesWithJobExpert = {"name",
                                                               "description",
                                                               "server_ip",
                                                               "server_name",
                                                               "server_version",
                                                               "server_textversion",
                                                               "server_type",
                                                               "BaseVirtualPrinter",
                                                               "BaseVirtualPrinterName",
                                                               "BaseVirtualPrinterDisplayName",
                                                               "HFPresetName",
                                                               "PPDVersion",
                                                               "ServerTypeAndJPDefaultKeyInfo",
                                                               "Quickset_Supported",
                                                               "Quickset_Enabled",
                                                               "Quickset",
                                                               "IsWidthBased",
                                                               "JobExpert_Supported",
                                                               "JobExpert",
                                                               "JobExpertRule",
                                                               "JobExpertRuleDisplayValue",
                                                               "Enable",
                                                               "Centralized",
                                                               "Isjobpresetattached",
                                                               "IsCustomInterval",
                                                               "TimeInterval"};

const std::vector<std::string> kBlocks = {"InputFormatsSummary", "Paths",
                                          "JobSetting",          "ImposeSetting",
                                          "FilterSetting",       "PreflightSettings"};

// Structure as an independent parser sees it: one line per element, tag then
// attribute names in document order, indented by depth.
const char* const kStructureScript = R"(
import sys, xml.etree.ElementTree as ET
raw = open(sys.argv[1], 'rb').read()
raw.decode('utf-8')
if not raw.startswith(b'<?xml version="1.0" encoding="UTF-8"?>'):
    sys.exit('bad declaration')
def walk(e, depth):
    print(' ' * depth + e.tag + ':' + ','.join(e.attrib.keys()))
    for c in e:
        walk(c, depth + 1)
walk(ET.fromstring(raw), 0)
)";
} // namespace

TEST(FolderFileFormat, RootAttributesInTableOrderWithBothFlagEncodings)
{
    TempDir dir;
    FolderConfig config = FullFolderConfig();
    config.setting.EnableQuickSets(false);
    ASSERT_EQ(config.Write(dir.wx("Folder.cfg")), 0);
    auto document = LoadRaw(dir / "Folder.cfg");
    const wxXmlNode* root = document->GetRoot();
    EXPECT_EQ(root->GetName(), "HotFolder");
    EXPECT_EQ(AttributeNames(root), kRootAttributesWithJobExpert);
    EXPECT_EQ(root->GetAttribute("server_version"), "5000000000");
    EXPECT_EQ(root->GetAttribute("Quickset_Supported"), "1");
    EXPECT_EQ(root->GetAttribute("Quickset_Enabled"), "0");
    EXPECT_EQ(root->GetAttribute("JobExpert"), "1");
    EXPECT_EQ(root->GetAttribute("Enable"), "1");
    EXPECT_EQ(root->GetAttribute("TimeInterval"), "45");
    EXPECT_EQ(ChildNames(root), kBlocks);
}

TEST(FolderFileFormat, JobExpertAttributesOnlyWithSupport)
{
    TempDir dir;
    FolderConfig config = FullFolderConfig();
    config.setting.SetJobExpertSupported(false); // rule and switch stay set
    ASSERT_EQ(config.Write(dir.wx("Folder.cfg")), 0);
    std::vector<std::string> expected = kRootAttributesWithJobExpert;
    expected.erase(expected.begin() + 18, expected.begin() + 21);
    auto document = LoadRaw(dir / "Folder.cfg");
    EXPECT_EQ(AttributeNames(document->GetRoot()), expected);
    EXPECT_EQ(document->GetRoot()->GetAttribute("JobExpert_Supported"), "0");
}

TEST(FolderFileFormat, BlocksHoldEntriesInOrderWithTheirAttributeNames)
{
    TempDir dir;
    ASSERT_EQ(FullFolderConfig().Write(dir.wx("Folder.cfg")), 0);
    auto document = LoadRaw(dir / "Folder.cfg");
    wxXmlNode* root = document->GetRoot();

    wxXmlNode* formats = CXmlNodeHelper::Find(root, "InputFormatsSummary");
    ASSERT_EQ(ChildNames(formats), std::vector<std::string>(2, "InputFormat"));
    EXPECT_EQ(AttributeNames(formats->GetChildren()),
              (std::vector<std::string>{"ShortName", "DisplayName"}));
    EXPECT_EQ(formats->GetChildren()->GetAttribute("ShortName"), "EPS");

    wxXmlNode* paths = CXmlNodeHelper::Find(root, "Paths");
    EXPECT_EQ(ChildNames(paths),
              (std::vector<std::string>{"Failfolder", "Workfolder", "Movefolder", "Hotfolder"}));
    EXPECT_EQ(CXmlNodeHelper::Find(paths, "Movefolder")->GetAttribute("path"), "/hf/keep");

    wxXmlNode* job = CXmlNodeHelper::Find(root, "JobSetting");
    ASSERT_EQ(ChildNames(job), std::vector<std::string>(2, "KEYVALUE"));
    EXPECT_EQ(AttributeNames(job->GetChildren()),
              (std::vector<std::string>{"Key", "Value", "KeyDisplayValue", "LocDisplayValue"}));
    EXPECT_EQ(job->GetChildren()->GetAttribute("Key"), "Copies"); // key order

    wxXmlNode* impose = CXmlNodeHelper::Find(root, "ImposeSetting");
    EXPECT_EQ(AttributeNames(impose->GetChildren()),
              (std::vector<std::string>{"Key", "Value", "KeyDisplayValue"}));
    EXPECT_EQ(impose->GetChildren()->GetAttribute("Key"), "Creep");

    wxXmlNode* preflight = CXmlNodeHelper::Find(root, "PreflightSettings");
    EXPECT_EQ(ChildNames(preflight), std::vector<std::string>(2, "Preflight"));
    EXPECT_EQ(AttributeNames(preflight->GetChildren()), (std::vector<std::string>{"Key", "Value"}));
    EXPECT_EQ(preflight->GetChildren()->GetAttribute("Key"), "Status"); // list order
}

TEST(FolderFileFormat, EmptyListsStillWriteTheirBlocks)
{
    TempDir dir;
    FolderConfig empty;
    ASSERT_EQ(empty.Write(dir.wx("Folder.cfg")), 0);
    auto document = LoadRaw(dir / "Folder.cfg");
    wxXmlNode* root = document->GetRoot();
    // No stored filter node: the block is left out, every other one is there.
    EXPECT_EQ(ChildNames(root),
              (std::vector<std::string>{"InputFormatsSummary", "Paths", "JobSetting",
                                        "ImposeSetting", "PreflightSettings"}));
    for (const char* block :
         {"InputFormatsSummary", "JobSetting", "ImposeSetting", "PreflightSettings"})
        EXPECT_EQ(CXmlNodeHelper::Find(root, block)->GetChildren(), nullptr) << block;
    EXPECT_EQ(root->GetAttribute("server_version"), "-1");
    EXPECT_EQ(root->GetAttribute("Enable"), "0");
}

TEST(FolderFileFormat, FilterNodeUnderAnotherNameIsNotWritten)
{
    TempDir dir;
    FolderConfig config = FullFolderConfig();
    config.filter.SetFilterSettingNode(
        ParseNode("<FilterSettings><Filter name='x'/></FilterSettings>"));
    ASSERT_EQ(config.Write(dir.wx("Folder.cfg")), 0);
    auto document = LoadRaw(dir / "Folder.cfg");
    EXPECT_EQ(CXmlNodeHelper::Find(document->GetRoot(), "FilterSettings", true), nullptr);
    EXPECT_EQ(CXmlNodeHelper::Find(document->GetRoot(), "Filter", true), nullptr);
}

TEST(FolderFileFormat, SavedPathAndIndentationOfTwo)
{
    TempDir dir;
    FolderConfig config = FullFolderConfig();
    wxString saved;
    ASSERT_EQ(db::HFDatabase::WriteFolderProperties(dir.wx("Folder.cfg"), config.setting,
                                                    config.job, config.folders, config.filter,
                                                    config.impose, config.preflight, saved),
              0);
    EXPECT_EQ(saved, dir.wx("Folder.cfg"));
    const std::string text = ReadFile(dir / "Folder.cfg");
    EXPECT_EQ(text.rfind("<?xml version=\"1.0\" encoding=\"UTF-8\"?>", 0), 0u);
    EXPECT_NE(text.find("\n  <Paths>\n    <Failfolder path=\"/hf/fail\"/>"), std::string::npos);
}

TEST(FolderFileFormat, IndependentParserSeesWellFormedUtf8InTableOrder)
{
    TempDir dir;
    ASSERT_EQ(FullFolderConfig().Write(dir.wx("Folder.cfg")), 0);
    if (HaveProgram("xmllint"))
    {
        std::string output;
        EXPECT_EQ(storetest::Run({"xmllint", "--noout", "--encode", "UTF-8", dir / "Folder.cfg"},
                                 &output),
                  0)
            << output;
    }
    if (!HaveProgram("python3"))
        GTEST_SKIP() << "python3 not available";
    std::string structure;
    ASSERT_EQ(storetest::Run({"python3", "-c", kStructureScript, dir / "Folder.cfg"}, &structure),
              0)
        << structure;
    std::string rootLine = "HotFolder:";
    for (size_t i = 0; i < kRootAttributesWithJobExpert.size(); ++i)
        rootLine += (i ? "," : "") + kRootAttributesWithJobExpert[i];
    const std::string expected = rootLine + "\n" +
                                 " InputFormatsSummary:\n"
                                 "  InputFormat:ShortName,DisplayName\n"
                                 "  InputFormat:ShortName,DisplayName\n"
                                 " Paths:\n"
                                 "  Failfolder:path\n"
                                 "  Workfolder:path\n"
                                 "  Movefolder:path\n"
                                 "  Hotfolder:path\n"
                                 " JobSetting:\n"
                                 "  KEYVALUE:Key,Value,KeyDisplayValue,LocDisplayValue\n"
                                 "  KEYVALUE:Key,Value,KeyDisplayValue,LocDisplayValue\n"
                                 " ImposeSetting:\n"
                                 "  KEYVALUE:Key,Value,KeyDisplayValue\n"
                                 "  KEYVALUE:Key,Value,KeyDisplayValue\n"
                                 " FilterSetting:\n"
                                 "  Filter:name\n"
                                 "   UI:\n"
                                 "    OUTPUTFILETYPEEPS:\n"
                                 "    PAGESIZE:\n"
                                 " PreflightSettings:\n"
                                 "  Preflight:Key,Value\n"
                                 "  Preflight:Key,Value\n";
    EXPECT_EQ(structure, expected);
}

TEST(FolderFileFormat, WrittenAndReadBackEveryField)
{
    TempDir dir;
    const FolderConfig written = FullFolderConfig();
    ASSERT_EQ(written.Write(dir.wx("Folder.cfg")), 0);
    ExpectSameConfig(ReadAll(dir.wx("Folder.cfg")), written);

    // The opposite value of every switch survives as well.
    FolderConfig flipped = written;
    db::Setting& s = flipped.setting;
    s.SetQuickSetsSupported(false);
    s.EnableQuickSets(false);
    s.SetIsWidthBased(false);
    s.EnableJobExpert(false);
    s.SetStatusEnable(false);
    s.SetStatusCentralized(false);
    s.SetJobPresetAttched(false);
    s.SetCustomInterval(false);
    s.SetServerVersion(-42);
    ASSERT_EQ(flipped.Write(dir.wx("Folder.cfg")), 0);
    ExpectSameConfig(ReadAll(dir.wx("Folder.cfg")), flipped);
}

TEST(FolderFileFormat, CharactersXmlCannotCarryAreLeftOutSoTheFileStillLoads)
{
    TempDir dir;
    FolderConfig config = FullFolderConfig();
    config.setting.SetDescription(wxString("a") + wxUniChar(0x01) + "b" + wxUniChar(0x1F) +
                                  wxUniChar(0xFFFE) + wxUniChar(0xFFFF) +
                                  wxString::FromUTF8("c\t\xc3\xa4") + wxUniChar(0x10000));
    config.job.SaveProperty(wxString("Key") + wxUniChar(0x0B), "v", "v", "v");
    ASSERT_EQ(config.Write(dir.wx("Folder.cfg")), 0);
    FolderConfig read = ReadAll(dir.wx("Folder.cfg"));
    EXPECT_EQ(read.setting.GetDescription(),
              wxString::FromUTF8("abc\t\xc3\xa4") +
                  wxUniChar(0x10000)); // tab, non-ASCII and astral kept
    EXPECT_EQ(read.job.GetProperties().count("Key"), 1u);
    EXPECT_EQ(read.setting.GetServerName(), config.setting.GetServerName());
}
