#pragma once
#include <memory>

#include <hotfolder/HFPlugin.h>

#include "module/FilterModule.h"

class wxXmlNode;

// One filter object brought up in the order every host follows:
// GetPluginInfo, GetPluginInstance, Initialize with the server description,
// InitilaizeFromPreference with the filter's own "Filter" element of the
// stored "FilterSetting" (an empty one when there is none). Torn down with
// DeInitialize and ReleasePluginInstance.
class FilterSession
{
public:
    static std::unique_ptr<FilterSession> Start(const wxString& modulePath,
                                                const wxString& serverDescription,
                                                const wxXmlNode* filterSetting, wxString& error);
    ~FilterSession();

    HFPlugin& Filter() { return *m_plugin; }
    const PluginInfo& Info() const { return m_info; }
    const FilterModule& Module() const { return *m_module; }
    // The filter's own text for a status code, with the code appended.
    wxString DescribeStatus(long code);
    // Why the filter refused the file at path; empty when it cannot say.
    wxString RefusalReason(const wxString& path) const { return m_module->DescribeRefusal(path); }
    // Sniffs exactly the listed files of folder (not the whole folder), as a
    // host does for files it has seen arrive.
    void SniffListed(const wxString& folder, const wxArrayString& files, wxArrayString& rejected,
                     JobInfoCollection& jobs);
    // A filter keeps its last status and answers it for later jobs too, so
    // after a failed job it is initialised again (which clears the status).
    void ClearStatusAfterFailure();

private:
    FilterSession() = default;
    std::unique_ptr<FilterModule> m_module;
    PluginInfo m_info;
    PluginPtr m_plugin;
    wxString m_serverDescription;
};

// A "Filter" element named by the filter's identifier holding what a freshly
// made filter object saves: the filter's defaults. Null with a reason on failure.
// described, when given, receives the module's description.
std::unique_ptr<wxXmlNode> MakeDefaultFilterNode(const wxString& modulePath, wxString& error,
                                                 PluginInfo* described = nullptr);
