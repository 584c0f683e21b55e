#pragma once
// A folder configuration with every field set to a distinct, non-default
// value, so a field lost or swapped anywhere shows up in a comparison.
#include <gtest/gtest.h>

#include <wx/sstream.h>

#include "db/ConfigurationReader.h"
#include "db/HFDatabase.h"

namespace storetest
{
struct FolderConfig
{
    db::Setting setting;
    db::JobConfiguration job;
    db::FolderConfiguration folders;
    db::FilterConfiguration filter;
    db::ImposeConfiguration impose;
    db::PreflightConfiguration preflight;

    int Write(const wxString& path) const
    {
        wxString saved;
        return db::HFDatabase::WriteFolderProperties(path, setting, job, folders, filter, impose,
                                                     preflight, saved);
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

inline void ExpectSameSetting(const db::Setting& a, const db::Setting& b)
{
    EXPECT_EQ(a.GetName(), b.GetName());
    EXPECT_EQ(a.GetDescription(), b.GetDescription());
    EXPECT_EQ(a.GetServerIP(), b.GetServerIP());
    EXPECT_EQ(a.GetServerName(), b.GetServerName());
    EXPECT_EQ(a.GetServerVersion(), b.GetServerVersion());
    EXPECT_EQ(a.GetTextServerVersion(), b.GetTextServerVersion());
    EXPECT_EQ(a.GetServerType(), b.GetServerType());
    EXPECT_EQ(a.GetBaseVirtualPrinter(), b.GetBaseVirtualPrinter());
    EXPECT_EQ(a.GetBaseVirtualPrinterName(), b.GetBaseVirtualPrinterName());
    EXPECT_EQ(a.GetBaseVirtualPrinterDisplayName(), b.GetBaseVirtualPrinterDisplayName());
    EXPECT_EQ(a.GetSelectedPreset(), b.GetSelectedPreset());
    EXPECT_EQ(a.GetPPDVersion(), b.GetPPDVersion());
    EXPECT_EQ(a.GetServerTypeAndJPDefaultKeyInfo(), b.GetServerTypeAndJPDefaultKeyInfo());
    EXPECT_EQ(a.IsQuickSetsSupported(), b.IsQuickSetsSupported());
    EXPECT_EQ(a.IsQuickSetsEnabled(), b.IsQuickSetsEnabled());
    EXPECT_EQ(a.GetSelectedQuickSet(), b.GetSelectedQuickSet());
    EXPECT_EQ(a.GetIsWidthBased(), b.GetIsWidthBased());
    EXPECT_EQ(a.IsJobExpertSupported(), b.IsJobExpertSupported());
    EXPECT_EQ(a.IsJobExpertEnabled(), b.IsJobExpertEnabled());
    EXPECT_EQ(a.GetJobExpertRule(), b.GetJobExpertRule());
    EXPECT_EQ(a.GetStatusEnable(), b.GetStatusEnable());
    EXPECT_EQ(a.GetStatusCentralized(), b.GetStatusCentralized());
    EXPECT_EQ(a.GetJobPresetAttched(), b.GetJobPresetAttched());
    EXPECT_EQ(a.GetCustomInterval(), b.GetCustomInterval());
    EXPECT_EQ(a.GetCustomTimeInterval(), b.GetCustomTimeInterval());
    EXPECT_EQ(a.GetInputFormats(), b.GetInputFormats());
}

// The folder configuration as read back through every reader.
inline FolderConfig ReadAll(const wxString& path)
{
    FolderConfig c;
    EXPECT_EQ(db::HFDatabase::ReadSetting(path, c.setting), 1);
    db::ConfigurationReader::ReadFolderConfiguration(path, c.folders);
    db::ConfigurationReader::ReadJobConfiguration(path, c.job);
    db::ConfigurationReader::ReadFilterConfiguration(path, c.filter);
    db::ConfigurationReader::ReadImposeConfiguration(path, c.impose);
    db::ConfigurationReader::ReadPreflightConfiguration(path, c.preflight);
    return c;
}

inline wxString NodeText(const wxXmlNode& node)
{
    wxXmlDocument document;
    document.SetRoot(new wxXmlNode(node));
    wxStringOutputStream out;
    document.Save(out, 0);
    return out.GetString();
}

inline void ExpectSameConfig(const FolderConfig& a, const FolderConfig& b)
{
    ExpectSameSetting(a.setting, b.setting);
    EXPECT_EQ(a.folders.GetFailFolder(), b.folders.GetFailFolder());
    EXPECT_EQ(a.folders.GetWorkFolder(), b.folders.GetWorkFolder());
    EXPECT_EQ(a.folders.GetBackupFolder(), b.folders.GetBackupFolder());
    EXPECT_EQ(a.folders.GetHotFolder(), b.folders.GetHotFolder());
    EXPECT_EQ(a.job.GetProperties(), b.job.GetProperties());
    EXPECT_EQ(a.impose.GetProperties(), b.impose.GetProperties());
    EXPECT_EQ(a.preflight.GetProperties(), b.preflight.GetProperties());
    EXPECT_EQ(NodeText(a.filter.GetFilterSettingNode()), NodeText(b.filter.GetFilterSettingNode()));
}
} // namespace storetest
