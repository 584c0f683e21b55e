#pragma once
#include <hotfolder/MapPropToValue.h>
#include <wx/string.h>

#include "Units.h"

// The filter's settings map: keys, value encodings and the defaults that
// apply when a value is empty. The key spellings are what is stored in the
// users' preferences and must not be corrected.
namespace SettingsKeys
{
// Output type section.
constexpr char OUTPUTFILETYPEEPS[] = "OUTPUTFILETYPEEPS";
constexpr char OUTPUTFILETYPEPS[] = "OUTPUTFILETYPEPS";

// Page size section.
constexpr char CUSTOMPAGESIZE[] = "CUSTOMPAGESIZE";
constexpr char DEFAULTPAGESIZE[] = "DEFAULTPAGESIZE";
constexpr char ORIENTATIONPOTRAIT[] = "ORIENTATIONPOTRAIT";
constexpr char ORIENTATIONLANDSCAPE[] = "ORIENTATIONLANDSCAPE";
constexpr char AUTOROTATE[] = "AUTOROTATE";
constexpr char IMAGEPOSITION[] = "IMAGEPOSITION";
constexpr char FORCEPAGESIZEX[] = "FORCEPAGESIZEX";
constexpr char FORCEPAGESIZEY[] = "FORCEPAGESIZEY";
constexpr char IMAGEEABLESIZELLX[] = "IMAGEEABLESIZELLX";
constexpr char IMAGEEABLESIZELLY[] = "IMAGEEABLESIZELLY";
constexpr char IMAGEEABLESIZEURX[] = "IMAGEEABLESIZEURX";
constexpr char IMAGEEABLESIZEURY[] = "IMAGEEABLESIZEURY";
constexpr char PAGESIZE_COMMAND[] = "PAGESIZE_COMMAND";
constexpr char CUSTOMPAGEWIDTH[] = "CUSTOMPAGEWIDTH";
constexpr char CUSTOMPAGEHEIGHT[] = "CUSTOMPAGEHEIGHT";
constexpr char CUSTOMPAGETUNIT[] = "CUSTOMPAGETUNIT";

// Image size section.
constexpr char ORIGINALSIZE[] = "ORIGINALSIZE";
constexpr char CUSTOMSIZE[] = "CUSTOMSIZE";
constexpr char CONTRAINPROPORTION[] = "CONTRAINPROPORTION";
constexpr char ORIGINALWIDTHOPTION[] = "ORIGINALWIDTHOPTION";
constexpr char ORIGINALHEIGHTOPTION[] = "ORIGINALHEIGHTOPTION";
constexpr char ORIGINALWIDTH[] = "ORIGINALWIDTH";
constexpr char ORIGINALHEIGHT[] = "ORIGINALHEIGHT";
constexpr char ORIGINALWIDTHUNIT[] = "ORIGINALWIDTHUNIT";
constexpr char ORIGINALHEIGHTUNIT[] = "ORIGINALHEIGHTUNIT";
constexpr char FORCEAUTOSCALE[] = "FORCEAUTOSCALE";
constexpr char FITTOPAGE[] = "FITTOPAGE";
constexpr char SHRINKTOFIT[] = "SHRINKTOFIT";
constexpr char SCALETOPRINT[] = "SCALETOPRINT";
} // namespace SettingsKeys

// Defaults of the flags when their value is empty. Keys without an entry
// here either have a computed default (below) or are not read by a panel.
namespace SettingsDefaults
{
constexpr bool OUTPUTFILETYPEEPS = true;
constexpr bool CUSTOMPAGESIZE = false;
constexpr bool ORIENTATIONPOTRAIT = true;
constexpr bool ORIENTATIONLANDSCAPE = false;
constexpr bool AUTOROTATE = false;
constexpr Unit_t CUSTOMPAGETUNIT = UNIT_INCH;
constexpr bool ORIGINALSIZE = true;
constexpr bool CUSTOMSIZE = false;
constexpr bool CONTRAINPROPORTION = true;
constexpr bool ORIGINALWIDTHOPTION = true;
constexpr bool ORIGINALHEIGHTOPTION = false;
constexpr bool FORCEAUTOSCALE = false;
constexpr bool FITTOPAGE = true;
constexpr bool SHRINKTOFIT = false;
constexpr bool SCALETOPRINT = false;
// English source text; panels show and store its translation.
constexpr char IMAGEPOSITION[] = "Center";
} // namespace SettingsDefaults

// Value encodings. Every reader indexes the map, which leaves an empty
// entry behind for an absent key; empty always means "use the default".

// "1" or "0".
wxString FormatSettingFlag(bool on);
// On exactly when the text is "1".
bool IsSettingOn(const wxString& value);
// The flag under key, or defaultValue when its value is empty.
bool ReadSettingFlag(MapPropToValue& settings, const wxString& key, bool defaultValue);

// A measure in points as "%f" with "." ("595.500000").
wxString FormatSettingDouble(double value);
// A whole number as "%d".
wxString FormatSettingInt(long value);
// A stored measure: "." as separator whatever the process locale. False
// when the text is empty or not entirely a number (value then holds the
// leading number, 0 when there is none).
bool ParseSettingDouble(const wxString& text, double& value);

// "OUTPUTFILETYPEPS" when empty: false while "OUTPUTFILETYPEEPS" is empty
// too, else the negation of that flag.
bool ReadOutputFileTypePS(MapPropToValue& settings);

// "CUSTOMPAGETUNIT": empty or "0" inch, "1" millimetre, "2" point. Any other
// text returns false and leaves unit as it was.
bool DecodeCustomPageUnit(const wxString& value, Unit_t& unit);

// "ORIGINALWIDTH" / "ORIGINALHEIGHT" when empty: a quarter inch, written
// in the field's unit ("0.25" for inch, "6.35" for anything else).
wxString DefaultOriginalDimension(bool fieldUnitIsInch);
