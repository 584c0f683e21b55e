#pragma once
#include <wx/string.h>

#include "PpdCapabilities.h"

namespace printing
{
// The server description a filter reads, for a printer known by its
// capabilities: one paper group per size under "SheetInfo", the default
// paper, the custom size limits when custom sizes are allowed, and the
// feature flags the EPS filter asks for. Numbers always use ".".
wxString ServerDescriptionXml(const PpdCapabilities& capabilities);
} // namespace printing
