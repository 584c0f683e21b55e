#pragma once
// A folder configuration with every field set to a distinct, non-default
// value, so a field lost or swapped anywhere shows up. Configurations are
// compared by the bytes the writer makes of them.
#include <gtest/gtest.h>

#include <wx/sstream.h>

#include "TestKit.h"
#include "db/ConfigurationReader.h"
#include "db/HFDatabase.h"

namespace storetest
{
inline wxString Wx(const std::string& path)
{
    return wxString::FromUTF8(path);
}

struct FolderConfig
{
    db::Setting setting;
    db::JobConfiguration job;
    db::FolderConfiguration folders;
    db::FilterConfiguration filter;
    db::ImposeConfiguration impose;
    db::PreflightConfiguration preflight;

    int Write(const std::string& path) const
    {
        wxString saved;
        const int result = db::HFDatabase::WriteFolderProperties(Wx(path), setting, job, folders,
                                                                 filter, impose, preflight, saved);
        EXPECT_EQ(saved, result == 0 ? Wx(path) : saved);
        return result;
    }
    // The whole file this configuration makes.
    std::string Bytes() const
    {
        testkit::ScratchDir dir("hf-store");
        Write(dir.File("Folder.cfg"));
        return testkit::ReadFile(dir.File("Folder.cfg"));
    }
    // Every reader on path; the result is ReadSetting's.
    int ReadAll(const std::string& path)
    {
        const int result = db::HFDatabase::ReadSetting(Wx(path), setting);
        EXPECT_EQ(db::ConfigurationReader::ReadFolderConfiguration(Wx(path), folders), 0);
        EXPECT_EQ(db::ConfigurationReader::ReadJobConfiguration(Wx(path), job), 0);
        EXPECT_EQ(db::ConfigurationReader::ReadFilterConfiguration(Wx(path), filter), 0);
        EXPECT_EQ(db::ConfigurationReader::ReadImposeConfiguration(Wx(path), impose), 0);
        EXPECT_EQ(db::ConfigurationReader::ReadPreflightConfiguration(Wx(path), preflight), 0);
        return result;
    }
};

inline wxXmlNode ParseNode(const char* xml)
{
    wxStringInputStream stream(wxString::FromUTF8(xml));
    wxXmlDocument document(stream);
    return *document.GetRoot();
}

inline FolderConfig FullFolderConfig()
{
    FolderConfig c;
    db::Setting& s = c.setting;
    s.SetName(wxString::FromUTF8("Proofs \xc3\xa4<&>\""));
    s.SetDescription("Daily proofs");
    s.SetServerIP("10.0.0.7");
    s.SetServerName("press-1");
    s.SetServerVersion(5000000000LL);
    s.SetTextServerVersion("5.0 build 7");
    s.SetServerType("fiery");
    s.SetBaseVirtualPrinter("vp-id");
    s.SetBaseVirtualPrinterName("vp-name");
    s.SetBaseVirtualPrinterDisplayName("VP Display");
    s.SetSelectedPreset("Preset A");
    s.SetPPDVersion("3.1");
    s.SetServerTypeAndJPDefaultKeyInfo("opaque;key=1|x");
    s.SetQuickSetsSupported(true);
    s.EnableQuickSets(true);
    s.SetSelectedQuickSet("Quick 1");
    s.SetIsWidthBased(true);
    s.SetJobExpertSupported(true);
    s.EnableJobExpert(true);
    s.SetJobExpertRule({"rule-7", "Rule Seven"});
    s.SetStatusEnable(true);
    s.SetStatusCentralized(true);
    s.SetJobPresetAttched(true);
    s.SetCustomInterval(true);
    s.SetCustomTimeInterval("45");
    s.SetInputFormats({{"EPS", "Encapsulated PostScript"}, {"PDF", "Portable Document"}});
    c.folders.SetFailFolder("/hf/fail");
    c.folders.SetWorkFolder("/hf/work");
    c.folders.SetBackupFolder("/hf/keep");
    c.folders.SetHotFolder("/hf");
    c.job.SaveProperty("PageSize", "A4", "A4 display", "A4 lokal");
    c.job.SaveProperty("Copies", "2", "Two", "Zwei");
    c.impose.SaveProperty("Layout", "2up", "Two up");
    c.impose.SaveProperty("Creep", "0.5", "Half");
    c.preflight.AddProperty("Status", "true");
    c.preflight.AddProperty("Profile", "Strict");
    c.filter.SetFilterSettingNode(
        ParseNode("<FilterSetting><Filter name=\"Orv.EPS.1\"><UI><OUTPUTFILETYPEEPS>1"
                  "</OUTPUTFILETYPEEPS><PAGESIZE>A4</PAGESIZE></UI></Filter></FilterSetting>"));
    return c;
}

// The full configuration, changed as the tables of tests/data/store name it.
inline FolderConfig Variant(const std::string& name)
{
    FolderConfig c = name == "empty" ? FolderConfig() : FullFolderConfig();
    db::Setting& s = c.setting;
    if (name == "switches-off")
    {
        s.SetQuickSetsSupported(false);
        s.EnableQuickSets(false);
        s.SetIsWidthBased(false);
        s.SetJobExpertSupported(false); // rule and switch stay set
        s.SetStatusEnable(false);
        s.SetStatusCentralized(false);
        s.SetJobPresetAttched(false);
        s.SetCustomInterval(false);
        s.SetServerVersion(-42);
    }
    if (name == "other-filter-node")
        c.filter.SetFilterSettingNode(
            ParseNode("<FilterSettings><Filter name='x'/></FilterSettings>"));
    return c;
}
} // namespace storetest
