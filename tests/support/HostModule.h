#pragma once
// Shared by the tests that drive the filter as a host does: the built module
// opened by name (ModuleFixture.h), a folder's Folder.cfg, the job overrides
// read back from it and a progress recorder.
#include <initializer_list>
#include <utility>
#include <vector>

#include <hotfolder/HFPlugin.h>
#include <wx/xml/xml.h>

#include "ModuleFixture.h"
#include "db/ConfigurationReader.h"
#include "db/FilterConfiguration.h"
#include "db/FolderConfiguration.h"
#include "db/HFDatabase.h"
#include "db/ImposeConfiguration.h"
#include "db/JobConfiguration.h"
#include "db/PreflightConfiguration.h"
#include "db/Setting.h"

namespace hf_test
{
// A Folder.cfg with no job overrides yet, as a new folder has.
inline void WriteEmptyFolderConfig(const wxString& path, const wxString& name = "hot")
{
    db::Setting setting;
    setting.SetName(name);
    wxString saved;
    db::HFDatabase::WriteFolderProperties(
        path, setting, db::JobConfiguration(), db::FolderConfiguration(), db::FilterConfiguration(),
        db::ImposeConfiguration(), db::PreflightConfiguration(), saved);
}

inline db::JobConfiguration::Map FolderOverrides(const wxString& path)
{
    db::JobConfiguration job;
    db::ConfigurationReader::ReadJobConfiguration(path, job);
    return job.GetProperties();
}

// A <Filter><UI> node holding one element per setting.
inline void AddSetting(wxXmlNode* ui, const wxString& key, const wxString& value)
{
    auto* node = new wxXmlNode(wxXML_ELEMENT_NODE, key);
    node->AddChild(new wxXmlNode(wxXML_TEXT_NODE, "text", value));
    ui->AddChild(node);
}

struct ProgressRecorder : IProgressTracker
{
    std::vector<std::pair<wxString, int>> calls;
    void ReportProgress(const wxString& path, int percent) override
    {
        calls.emplace_back(path, percent);
    }
};

} // namespace hf_test
