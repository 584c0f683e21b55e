#pragma once
#include <set>

#include <wx/string.h>

#include "module/FilterSettings.h"

// The custom image width and height must lie within what the settings panel
// accepts for their unit. settings: the values as they will be stored;
// changed: the keys the command line assigns. Only a dimension whose number
// or unit is assigned is checked, so an old value never blocks another
// change. False with a message naming the key and the range.
bool CheckImageDimensions(const SettingList& settings, const std::set<wxString>& changed,
                          wxString& error);
