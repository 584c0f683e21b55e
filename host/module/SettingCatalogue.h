#pragma once
#include <wx/arrstr.h>
#include <wx/string.h>

// What the host accepts for each filter setting when it is changed from the
// command line. Values are checked and brought into the stored encoding
// ("1"/"0" flags, "." decimals) so the filter reads them as its panel wrote
// them.
enum class SettingKind
{
    Flag,          // "1" or "0"; yes/no, true/false, on/off accepted
    Points,        // a length in points, stored "%f"
    Length,        // a length in the unit of its companion key, "." decimals
    UnitWord,      // "inch", "mm" or "point"
    UnitNumber,    // 0 inch, 1 millimetre, 2 point
    ImagePosition, // "Top Left", "Top Right", "Center", "Bottom Left", "Bottom Right"
    PaperName,     // a paper of the server's list
    Text           // stored as given
};

// False when the key is not a setting of the filter.
bool LookUpSettingKind(const wxString& key, SettingKind& kind);

// Every key the host knows, in catalogue order.
wxArrayString KnownSettingKeys();

// Checks value for key and gives its stored form. False with a message that
// says what was expected.
bool NormaliseSettingValue(const wxString& key, const wxString& value, wxString& stored,
                           wxString& error);
