#pragma once
#include <hotfolder/MapPropToValue.h>
#include <wx/arrstr.h>
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

// English source texts of the five image positions, in the order the panel
// lists them. The panel stores the translation shown; readers look the
// stored text up among every language's translations of these words.
constexpr const char* kImagePositionWords[] = {"Top Left", "Top Right", "Center", "Bottom Left",
                                               "Bottom Right"};

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
constexpr const char* IMAGEPOSITION = kImagePositionWords[2];
} // namespace SettingsDefaults

// What each key holds, so that every writer, the command line included,
// stores what the panel and the conversion-parameter loading read.
enum class SettingKind
{
    Flag,          // "1" or "0"
    Points,        // a length in points, "%f" with "."
    Length,        // a length in the unit of its companion key, "." decimals
    UnitWord,      // a unit word: "inch", "mm" or "point", or its translation
    UnitNumber,    // 0 inch, 1 millimetre, 2 point
    ImagePosition, // one of kImagePositionWords, or its translation
    PaperName,     // a paper of the server's list
    Text           // stored as given
};

// False when the key is not a setting of the filter.
bool LookUpSettingKind(const wxString& key, SettingKind& kind);

// Every key of the filter, in catalogue order.
wxArrayString KnownSettingKeys();

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
// The measure under key for the converter: the stored "." form first, then
// the process locale's own form (values typed by older panels while the
// application language had switched the C locale); 0 when neither reads.
double ReadSettingNumber(MapPropToValue& settings, const wxString& key);

// "CUSTOMPAGETUNIT": empty or "0" inch, "1" millimetre, "2" point. Any other
// text returns false and leaves unit as it was.
bool DecodeCustomPageUnit(const wxString& value, Unit_t& unit);
wxString EncodeCustomPageUnit(Unit_t unit);

// "ORIGINALWIDTHUNIT" / "ORIGINALHEIGHTUNIT": the unit word in any language;
// a word that is neither inch nor millimetre counts as point.
Unit_t DecodeDimensionUnit(const wxString& storedWord);

// "ORIGINALWIDTH" / "ORIGINALHEIGHT" when empty: a quarter inch, written
// in the field's unit ("0.25" for inch, "6.35" for anything else).
wxString DefaultOriginalDimension(bool fieldUnitIsInch);
