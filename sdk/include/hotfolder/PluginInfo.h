#pragma once
#include <cstdint>
#include <wx/arrstr.h>
#include <wx/string.h>

// The host's description record, filled by a filter's GetPluginInfo.
// The member order is the host's layout: never reorder.
struct PluginInfo
{
    int64_t m_llKind = 0;
    wxString m_strVersion;
    wxString m_strIdentifier;
    wxString m_strDisplayName;
    wxArrayString m_arrExtensions;
    wxString m_strHostReserved; // belongs to the host; filters leave it alone
    wxArrayString m_arrRequiredServerFeatures;
};
