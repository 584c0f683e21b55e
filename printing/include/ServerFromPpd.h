#pragma once
#include <string>

#include <wx/string.h>

namespace printing
{
// Builds the server description XML of the printer that a PPD file
// describes. On failure xml is left alone and error says why.
bool ServerDescriptionFromPpd(const std::string& ppdPath, wxString& xml, std::string& error);
} // namespace printing
