// Loads the built module exactly as a host does: dlopen, then the entry
// points by name, then the interface only. Its dynamic symbol table holds
// exactly the names of tests/data/frame/exported-symbols.txt.
#include <cstring>
#include <set>
#include <sstream>

#include <gtest/gtest.h>
#include <hotfolder/HFPlugin.h>
#include <wx/arrstr.h>
#include <wx/xml/xml.h>

#include "ModuleFixture.h"
#include "TestKit.h"

using LoadedModule = hf_test::ModuleTest;

TEST_F(LoadedModule, CallingOrderOfAHost)
{
    auto info = Entry<GetPluginInfoFn>("GetPluginInfo");
    auto init = Entry<InitializePluginFn>("InitializePlugin");
    auto uninit = Entry<UninitializePluginFn>("UninitializePlugin");
    ASSERT_TRUE(info && init && uninit);
    // The description is appended to the host's record, the host's own field left alone.
    PluginInfo record;
    EXPECT_EQ(record.m_llKind, 0); // a host's fresh record: no kind yet
    record.m_arrExtensions.Add(".tif");
    record.m_strHostReserved = "host's own";
    init();
    info(&record);
    EXPECT_EQ(record.m_llKind, 1);
    EXPECT_EQ(record.m_strVersion + "|" + record.m_strIdentifier + "|" + record.m_strDisplayName +
                  "|" + wxJoin(record.m_arrExtensions, ',') + "|" + record.m_strHostReserved + "|" +
                  wxJoin(record.m_arrRequiredServerFeatures, ','),
              "1.0.0.1|Orv.EPS.1|EPS|.tif,.eps|host's own|GA2_HOTFOLDERS");

    NewPlugin();
    EXPECT_EQ(plugin->Initialize("<Server><GA2_HOTFOLDERS>yes</GA2_HOTFOLDERS></Server>"), 0);
    wxXmlNode preference(wxXML_ELEMENT_NODE, "Filter");
    EXPECT_EQ(plugin->InitilaizeFromPreference(&preference), 0);
    wxString version, display, shortName;
    plugin->GetVersion(version);
    plugin->GetDisplayName(display);
    plugin->GetShortName(shortName);
    EXPECT_EQ(version + "|" + display + "|" + shortName, "1.0.0.1|EPS|Orv.EPS.1");
    EXPECT_EQ(plugin->GetGroupType(), 1);
    EXPECT_TRUE(plugin->IsInitialized());
    // Its own extension first, the host's after; the second list is emptied.
    wxArrayString extensions = wxSplit("ps,pdf", ','), second = wxSplit("left over", ',');
    plugin->GetSupportedFileExtensions(extensions, second);
    EXPECT_EQ(wxJoin(extensions, ',') + "|" + wxJoin(second, ','), "eps,ps,pdf|");
    wxArrayString keys = wxSplit("existing", ',');
    plugin->GetServerKeys(keys);
    EXPECT_EQ(wxJoin(keys, ','), "existing,GA2_HOTFOLDERS,HF_EPS_FILTER");
    plugin->EnableMerge(true);
    EXPECT_FALSE(plugin->IsMergeEnabled());
    EXPECT_EQ(plugin->DeInitialize(), 0);
    EXPECT_TRUE(plugin->IsInitialized());
    EXPECT_EQ(plugin->Initialize(""), 0); // again on the same object after DeInitialize
    // Every instance is its own; a null name is an empty name.
    HFPlugin* other = make(nullptr);
    ASSERT_TRUE(other && other != plugin);
    other->Initialize("<Server><SubstrateFamilySupported>on</SubstrateFamilySupported></Server>");
    release(other);
    release(nullptr); // harmless
    plugin->GetShortName(shortName);
    EXPECT_EQ(shortName, "Orv.EPS.1");
    uninit();
}

TEST_F(LoadedModule, ErrorTextsThroughTheInterface)
{
    const auto cases = testkit::ReadCaseTable("frame/error-texts.txt");
    ASSERT_GT(cases.size(), 30u);
    NewPlugin();
    for (const auto& fields : cases)
    {
        wxString out = "unchanged";
        EXPECT_TRUE(plugin->GetErrorString(std::stol(fields[0]), out));
        EXPECT_EQ(out, fields[1]) << "code " << fields[0] << ": " << fields[2];
    }
}

// The sentence for a refused file through the C entry point: its whole
// length always, as much of it as fits, always terminated.
TEST_F(LoadedModule, RefusalReasonsThroughTheEntryPoint)
{
    auto describe = Entry<DescribeRefusalFn>("DescribeRefusal");
    ASSERT_NE(describe, nullptr);
    testkit::ScratchDir scratch("hf-refusal");
    const std::string text = scratch.File("letter.eps"), eps = scratch.File("art.eps");
    testkit::WriteFile(text, "Dear customer,\n");
    testkit::WriteFile(eps, "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox: 0 0 1 1\n");
    const std::string reason = "not an EPS file: its first line is not %!PS-Adobe-x.x EPSF-x.x";

    char buffer[128];
    std::memset(buffer, 'x', sizeof buffer);
    EXPECT_EQ(describe(text.c_str(), buffer, sizeof buffer), reason.size());
    EXPECT_EQ(std::string(buffer), reason);
    std::memset(buffer, 'x', sizeof buffer);
    EXPECT_EQ(describe(text.c_str(), buffer, 8), reason.size());
    EXPECT_EQ(std::string(buffer), reason.substr(0, 7)); // cut, and terminated
    EXPECT_EQ(buffer[8], 'x');                           // nothing written beyond
    EXPECT_EQ(describe(text.c_str(), nullptr, 0), reason.size());
    EXPECT_EQ(describe(text.c_str(), buffer, 0), reason.size());
    EXPECT_EQ(buffer[0], 'n'); // size 0: nothing written at all

    // A file the filter takes has no reason: 0 and an empty text.
    EXPECT_EQ(describe(eps.c_str(), buffer, sizeof buffer), 0u);
    EXPECT_EQ(buffer[0], '\0');
    EXPECT_EQ(describe(nullptr, buffer, sizeof buffer), std::strlen("no file was named"));
}

TEST(ExportedSymbols, ExactlyTheEntryPoints)
{
    std::istringstream table(
        testkit::RunProgram({"nm", "-D", "--defined-only", HF_MODULE_PATH}).out);
    std::set<std::string> exported, expected;
    for (std::string address, type, name; table >> address >> type >> name;)
        exported.insert(name);
    for (const auto& fields : testkit::ReadCaseTable("frame/exported-symbols.txt"))
        expected.insert(fields[0]);
    ASSERT_FALSE(expected.empty());
    EXPECT_EQ(exported, expected) << "from nm -D " << HF_MODULE_PATH;
}
