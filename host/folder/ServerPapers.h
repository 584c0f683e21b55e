#pragma once
#include <vector>

#include <wx/string.h>

#include "db/PageAttributes.h"

// The papers a server description offers, as the filter's queries read them.
struct ServerPapers
{
    std::vector<stPageAttribute> sheets;
    wxString defaultPaper; // paper name of the server's default, may be empty

    void Load(const wxString& serverDescription);
};
