#pragma once
#include <set>
#include <string>
#include <utility>
#include <vector>

#include <wx/string.h>

#include "db/PageAttributes.h"

class wxXmlNode;

// The filter's stored settings: the first "UI" element under its "Filter"
// element, one child per key whose text is the value.
using SettingList = std::vector<std::pair<wxString, wxString>>;

// The settings in document order.
SettingList ReadFilterSettings(const wxXmlNode* filter);
// Replaces the key's value, or appends the key (making "UI" when missing).
void WriteFilterSetting(wxXmlNode* filter, const wxString& key, const wxString& value);

// Applies "KEY=VALUE" assignments: all are checked first and nothing changes
// when one is refused. Choosing DEFAULTPAGESIZE of one of the server's
// papers also writes that paper's page size, imageable box and command, as
// the settings panel does; explicit assignments of those keys still win.
// changedKeys, when given, receives the keys assigned.
bool ApplySettingAssignments(wxXmlNode* filter, const std::vector<std::string>& assignments,
                             const std::vector<stPageAttribute>& sheets, wxString& error,
                             std::set<wxString>* changedKeys = nullptr);
