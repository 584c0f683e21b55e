#include "module/FilterSession.h"

#include <wx/xml/xml.h>

#include "folder/HotFolder.h"

std::unique_ptr<FilterSession> FilterSession::Start(const wxString& modulePath,
                                                    const wxString& serverDescription,
                                                    const wxXmlNode* filterSetting, wxString& error)
{
    std::unique_ptr<FilterSession> session(new FilterSession);
    session->m_module = FilterModule::Open(modulePath, error);
    if (!session->m_module)
        return nullptr;
    session->m_module->Describe(session->m_info);
    session->m_plugin = session->m_module->NewInstance(session->m_info.m_strIdentifier);
    if (!session->m_plugin)
    {
        error = wxString::Format("the filter module %s could not make a filter object", modulePath);
        return nullptr;
    }
    session->m_serverDescription = serverDescription;
    long status = session->m_plugin->Initialize(serverDescription);
    if (status != 0)
    {
        error = "the filter refused the server description: " + session->DescribeStatus(status);
        return nullptr;
    }
    // The filter's own "Filter" element, so that another filter's "UI" in the
    // same "FilterSetting" is never taken for this one's.
    wxXmlNode preference(wxXML_ELEMENT_NODE, "Filter");
    if (filterSetting)
        if (const wxXmlNode* own =
                FindFilterElement(*filterSetting, session->m_info.m_strIdentifier))
            preference = *own;
    status = session->m_plugin->InitilaizeFromPreference(&preference);
    if (status != 0)
    {
        error = "the filter refused its stored settings: " + session->DescribeStatus(status);
        return nullptr;
    }
    return session;
}

FilterSession::~FilterSession()
{
    if (m_plugin)
        m_plugin->DeInitialize();
    m_plugin.reset();
    m_module.reset();
}

wxString FilterSession::DescribeStatus(long code)
{
    wxString text;
    if (!m_plugin || !m_plugin->GetErrorString(code, text) || text.empty())
        text = "unknown status";
    return wxString::Format("%s (%ld)", text, code);
}

void FilterSession::ClearStatusAfterFailure()
{
    if (m_plugin)
        m_plugin->Initialize(m_serverDescription);
}

std::unique_ptr<wxXmlNode> MakeDefaultFilterNode(const wxString& modulePath, wxString& error,
                                                 PluginInfo* described)
{
    std::unique_ptr<FilterModule> module = FilterModule::Open(modulePath, error);
    if (!module)
        return nullptr;
    PluginInfo info;
    module->Describe(info);
    if (described)
        *described = info;
    PluginPtr plugin = module->NewInstance(info.m_strIdentifier);
    if (!plugin)
    {
        error = wxString::Format("the filter module %s could not make a filter object", modulePath);
        return nullptr;
    }
    // A fresh object, not initialised from anything: what it saves are the
    // filter's own defaults.
    auto filter = std::make_unique<wxXmlNode>(wxXML_ELEMENT_NODE, "Filter");
    filter->AddAttribute("name", info.m_strIdentifier);
    if (plugin->SavePreference(filter.get()) != 0)
    {
        error = "the filter could not save its default settings";
        return nullptr;
    }
    return filter;
}

void FilterSession::SniffListed(const wxString& folder, const wxArrayString& files,
                                wxArrayString& rejected, JobInfoCollection& jobs)
{
    FolderContent content;
    content.m_arrFiles = files;
    FolderContent* contentPointer = &content;
    m_plugin->SniffFolder(folder, rejected, jobs, contentPointer);
}
