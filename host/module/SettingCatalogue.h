#pragma once
#include <wx/string.h>

#include "SettingsKeys.h"

// Checks value for key, as given on the command line, against the filter's
// settings catalogue and gives its stored form, in the encoding the filter's
// panel writes ("1"/"0" flags, "." decimals) so the filter reads it as its
// own. Flags also accept yes/no, true/false and on/off. False with a message
// that says what was expected.
bool NormaliseSettingValue(const wxString& key, const wxString& value, wxString& stored,
                           wxString& error);
