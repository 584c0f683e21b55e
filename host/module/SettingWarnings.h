#pragma once
#include <set>
#include <vector>

#include <wx/string.h>

#include "module/FilterSettings.h"

// Assignments that are stored as asked but will not do what they suggest,
// because the filter reads them only together with other keys (pass-through
// output ignores the page, one size mode wins over the others, ...). One
// sentence per such combination. settings: the values as stored now;
// changed: the keys just assigned; hasServer: the folder knows its papers.
std::vector<wxString> SettingWarnings(const SettingList& settings,
                                      const std::set<wxString>& changed, bool hasServer);
