// The module's entry points: the host finds these by name.
#include <algorithm>
#include <cstring>

#include "EPS.h"
#include "FilterVersion.h"
#include "HFExport.h"

HF_MODULE_EXPORT void InitializePlugin() {}

HF_MODULE_EXPORT void UninitializePlugin() {}

HF_MODULE_EXPORT void GetPluginInfo(PluginInfo* info)
{
    if (!info)
        return;
    info->m_llKind = 1;
    info->m_strVersion = HF_FILTER_VERSION;
    info->m_strIdentifier = HF_FILTER_IDENTIFIER;
    info->m_strDisplayName = "EPS";
    info->m_arrExtensions.Add(".eps");
    info->m_arrRequiredServerFeatures.Add("GA2_HOTFOLDERS");
}

HF_MODULE_EXPORT HFPlugin* GetPluginInstance(const wchar_t* name)
{
    try
    {
        return new EPS(wxString(name ? name : L""));
    }
    catch (...)
    {
        return nullptr;
    }
}

HF_MODULE_EXPORT void ReleasePluginInstance(HFPlugin* plugin)
{
    delete plugin; // virtual: freed by the module that made it
}

HF_MODULE_EXPORT size_t DescribeRefusal(const char* path, char* text, size_t size)
{
    try
    {
        const std::string reason = RefusalReason(path);
        if (text && size > 0)
        {
            const size_t copied = std::min(reason.size(), size - 1);
            std::memcpy(text, reason.data(), copied);
            text[copied] = '\0';
        }
        return reason.size();
    }
    catch (...)
    {
        return 0; // nothing to say rather than an exception across the C boundary
    }
}
