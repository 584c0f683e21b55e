#pragma once
#include <wx/string.h>

namespace db
{
// The host's record of one print server.
struct stHFServerInfo
{
    wxString m_strServerName;      // as shown to the user
    wxString m_strServerDirectory; // directory name of the server's database
    wxString m_strAddress;         // host name or address
};
} // namespace db
