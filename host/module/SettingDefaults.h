#pragma once
#include <vector>

#include <wx/string.h>

#include "db/PageAttributes.h"

// What the settings panel takes for key when its value is empty, as a short
// text for people: a value ("1", "Center") or how it is found ("the first
// paper of the server, Letter"). sheets: the server's papers, may be empty.
wxString DescribeSettingDefault(const wxString& key, const std::vector<stPageAttribute>& sheets);
