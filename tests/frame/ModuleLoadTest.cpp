// Loads the built module exactly as a host does: dlopen, then the entry
// points by name, then the interface only.
#include <gtest/gtest.h>
#include <hotfolder/HFPlugin.h>
#include <wx/xml/xml.h>

#include "ModuleFixture.h"

namespace
{
class LoadedModule : public hf_test::ModuleTest
{
protected:
    void SetUp() override
    {
        ModuleTest::SetUp();
        info = Entry<GetPluginInfoFn>("GetPluginInfo");
        init = Entry<InitializePluginFn>("InitializePlugin");
        uninit = Entry<UninitializePluginFn>("UninitializePlugin");
        ASSERT_TRUE(info && init && uninit);
    }

    GetPluginInfoFn info = nullptr;
    InitializePluginFn init = nullptr;
    UninitializePluginFn uninit = nullptr;
};
} // namespace

TEST_F(LoadedModule, DescriptionAppendsToTheHostsRecord)
{
    PluginInfo record;
    record.m_arrExtensions.Add(".tif");
    record.m_strHostReserved = "host's own";
    init();
    info(&record);
    EXPECT_EQ(record.m_llKind, 1);
    EXPECT_EQ(record.m_strVersion, "1.0.0.1");
    EXPECT_EQ(record.m_strIdentifier, "Orv.EPS.1");
    EXPECT_EQ(record.m_strDisplayName, "EPS");
    ASSERT_EQ(record.m_arrExtensions.size(), 2u);
    EXPECT_EQ(record.m_arrExtensions[0], ".tif");
    EXPECT_EQ(record.m_arrExtensions[1], ".eps");
    EXPECT_EQ(record.m_strHostReserved, "host's own");
    ASSERT_EQ(record.m_arrRequiredServerFeatures.size(), 1u);
    EXPECT_EQ(record.m_arrRequiredServerFeatures[0], "GA2_HOTFOLDERS");
    uninit();
}

TEST_F(LoadedModule, CallingOrderOfAHost)
{
    PluginInfo record;
    info(&record);
    HFPlugin* plugin = make(L"EPS");
    ASSERT_NE(plugin, nullptr);

    EXPECT_EQ(plugin->Initialize("<Server><GA2_HOTFOLDERS>yes</GA2_HOTFOLDERS></Server>"), 0);
    wxXmlNode preference(wxXML_ELEMENT_NODE, "Filter");
    EXPECT_EQ(plugin->InitilaizeFromPreference(&preference), 0);

    wxString text;
    plugin->GetVersion(text);
    EXPECT_EQ(text, "1.0.0.1");
    plugin->GetDisplayName(text);
    EXPECT_EQ(text, "EPS");
    plugin->GetShortName(text);
    EXPECT_EQ(text, "Orv.EPS.1");
    EXPECT_EQ(plugin->GetGroupType(), 1);
    EXPECT_TRUE(plugin->IsInitialized());

    wxArrayString extensions, second;
    extensions.Add("ps");
    extensions.Add("pdf");
    second.Add("left over");
    plugin->GetSupportedFileExtensions(extensions, second);
    ASSERT_EQ(extensions.size(), 3u);
    EXPECT_EQ(extensions[0], "eps");
    EXPECT_EQ(extensions[1], "ps");
    EXPECT_EQ(extensions[2], "pdf");
    EXPECT_TRUE(second.empty());

    wxArrayString keys;
    keys.Add("existing");
    plugin->GetServerKeys(keys);
    ASSERT_EQ(keys.size(), 3u);
    EXPECT_EQ(keys[1], "GA2_HOTFOLDERS");
    EXPECT_EQ(keys[2], "HF_EPS_FILTER");

    plugin->EnableMerge(true);
    EXPECT_FALSE(plugin->IsMergeEnabled());

    EXPECT_EQ(plugin->DeInitialize(), 0);
    EXPECT_TRUE(plugin->IsInitialized());
    // Initialise again on the same object is allowed after DeInitialize.
    EXPECT_EQ(plugin->Initialize(""), 0);
    release(plugin);
}

TEST_F(LoadedModule, ErrorTextsThroughTheInterface)
{
    HFPlugin* plugin = make(L"");
    ASSERT_NE(plugin, nullptr);
    const std::pair<long, const char*> table[] = {
        {0, "No Error"},
        {-1, "Error"},
        {-1002, "Input file not found"},
        {-1003, "Filter conversion failed"},
        {-1004, "This filter is not supported on server"},
        {-1005, "Invalid input file"},
        {-1006, "Filter is not initialized"},
        {-1007, "PDF conversion failed"},
        {-1008, "PDF preflight failed"},
        {-1009, "PDF merge failed"},
        {-1010, "Distiller is not installed"},
        {1011, "MS Office is not installed"},
        {1012, "MS Word is not installed"},
        {1013, "MS Power Point is not installed"},
        {1014, "MS Excel is not installed"},
        {1015, "MS Publisher is not installed"},
        {1020, "Error printing output file"},
        {1021, "Output file not found"},
        {1022, "Error: Expecting Correct PS Header"},
        {1023, "Error: Publisher 2000 or Previous"},
        {1024, "Error: Unable to Open ps/pdf prefix.ps file"},
        {1025, "Error: Unable to open or create RES file"},
        {1026, "Error: Unable to get CT/LW Resolution"},
        {1027, "Error: Resolution is not reasonable"},
        {1028, "Error: Unable to open temp directory"},
        {1029, "Error: Unable to open configuration file for filter"},
        {1030, "Error: invalid separation name for 1-bit Tiff"},
        {1031, "Error: General processing error during conversion"},
        {1032, "Error: CSL library error during conversion"},
        // Codes without an entry read as success.
        {1016, "No Error"},
        {1017, "No Error"},
        {1019, "No Error"},
        {-1001, "No Error"},
        {-1011, "No Error"},
        {1033, "No Error"},
        {1, "No Error"},
        {5, "No Error"},
        {-2, "No Error"},
        {LONG_MAX, "No Error"},
        {LONG_MIN, "No Error"},
    };
    for (const auto& [code, message] : table)
    {
        wxString out = "unchanged";
        EXPECT_TRUE(plugin->GetErrorString(code, out));
        EXPECT_EQ(out, message) << "code " << code;
    }
    release(plugin);
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
