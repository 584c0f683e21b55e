#include "module/DimensionLimits.h"

#include "ImageDimensionRange.h"
#include "SettingsKeys.h"
#include "UiText.h"

namespace
{
wxString ValueOf(const SettingList& settings, const wxString& key)
{
    for (const auto& setting : settings)
        if (setting.first == key)
            return setting.second;
    return wxString();
}

bool CheckDimension(const SettingList& settings, const std::set<wxString>& changed,
                    const wxString& key, const wxString& unitKey, wxString& error)
{
    if (!changed.count(key) && !changed.count(unitKey))
        return true;
    const wxString text = ValueOf(settings, key), unitWord = ValueOf(settings, unitKey);
    double value = 0;
    // Without a unit the filter reads the number as points, which the panel
    // never limits; a stored text that is no number is not this call's doing.
    if (text.empty() || unitWord.empty() || !ParseSettingDouble(text, value))
        return true;
    const Unit_t unit = DecodeDimensionUnit(unitWord);
    const ImageDimensionCheck check = CheckImageDimension(value, TranslateUiText(UnitWord(unit)));
    if (check.valid)
        return true;
    error = wxString::Format("%s=%s is outside %s, the range the settings panel takes in %s "
                             "(%s=%s)",
                             key, text, check.rangeText, UnitWord(unit), unitKey, unitWord);
    return false;
}
} // namespace

bool CheckImageDimensions(const SettingList& settings, const std::set<wxString>& changed,
                          wxString& error)
{
    using namespace SettingsKeys;
    return CheckDimension(settings, changed, ORIGINALWIDTH, ORIGINALWIDTHUNIT, error) &&
           CheckDimension(settings, changed, ORIGINALHEIGHT, ORIGINALHEIGHTUNIT, error);
}
