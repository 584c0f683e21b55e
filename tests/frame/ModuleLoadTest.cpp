// Loads the built module exactly as a host does: dlopen, then the entry
// points by name, then the interface only. Its dynamic symbol table holds
// exactly the names of tests/data/frame/exported-symbols.txt.
#include <set>
#include <sstream>

#include <gtest/gtest.h>
#include <hotfolder/HFPlugin.h>
#include <wx/arrstr.h>
#include <wx/xml/xml.h>

#include "ModuleFixture.h"
#include "TestKit.h"

using LoadedModule = hf_test::ModuleTest;

TEST_F(LoadedModule, DescriptionAppendsToTheHostsRecord)
{
    auto info = Entry<GetPluginInfoFn>("GetPluginInfo");
    auto init = Entry<InitializePluginFn>("InitializePlugin");
    auto uninit = Entry<UninitializePluginFn>("UninitializePlugin");
    ASSERT_TRUE(info && init && uninit);
    PluginInfo record;
    EXPECT_EQ(record.m_llKind, 0); // a host's fresh record: no kind yet
    record.m_arrExtensions.Add(".tif");
    record.m_strHostReserved = "host's own";
    init();
    info(&record);
    EXPECT_EQ(record.m_llKind, 1);
    EXPECT_EQ(record.m_strVersion + "|" + record.m_strIdentifier + "|" + record.m_strDisplayName,
              "1.0.0.1|Orv.EPS.1|EPS");
    EXPECT_EQ(wxJoin(record.m_arrExtensions, ','), ".tif,.eps");
    EXPECT_EQ(record.m_strHostReserved, "host's own");
    EXPECT_EQ(wxJoin(record.m_arrRequiredServerFeatures, ','), "GA2_HOTFOLDERS");
    uninit();
}

TEST_F(LoadedModule, CallingOrderOfAHost)
{
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
    EXPECT_EQ(wxJoin(extensions, ','), "eps,ps,pdf");
    EXPECT_TRUE(second.empty());
    wxArrayString keys = wxSplit("existing", ',');
    plugin->GetServerKeys(keys);
    EXPECT_EQ(wxJoin(keys, ','), "existing,GA2_HOTFOLDERS,HF_EPS_FILTER");

    plugin->EnableMerge(true);
    EXPECT_FALSE(plugin->IsMergeEnabled());
    EXPECT_EQ(plugin->DeInitialize(), 0);
    EXPECT_TRUE(plugin->IsInitialized());
    EXPECT_EQ(plugin->Initialize(""), 0); // again on the same object after DeInitialize
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

TEST_F(LoadedModule, EveryInstanceIsItsOwn)
{
    HFPlugin* first = make(L"a");
    HFPlugin* second = make(L"b");
    ASSERT_TRUE(first && second);
    EXPECT_NE(first, second);
    first->Initialize("<Server><SubstrateFamilySupported>on</SubstrateFamilySupported></Server>");
    release(first);
    wxString name;
    second->GetShortName(name);
    EXPECT_EQ(name, "Orv.EPS.1");
    release(second);
    release(nullptr); // harmless
    HFPlugin* unnamed = make(nullptr);
    EXPECT_NE(unnamed, nullptr) << "a null name is an empty name";
    release(unnamed);
}

TEST(ExportedSymbols, ExactlyTheEntryPoints)
{
    const std::string table =
        testkit::RunProgram({"nm", "-D", "--defined-only", HF_MODULE_PATH}).out;
    ASSERT_FALSE(table.empty()) << "nm printed nothing for " << HF_MODULE_PATH;
    std::set<std::string> exported, expected;
    std::istringstream lines(table);
    for (std::string line, address, type, name; std::getline(lines, line);)
        if (std::istringstream(line) >> address >> type >> name)
            exported.insert(name);
    for (const auto& fields : testkit::ReadCaseTable("frame/exported-symbols.txt"))
        expected.insert(fields[0]);
    ASSERT_FALSE(expected.empty());
    EXPECT_EQ(exported, expected);
}
