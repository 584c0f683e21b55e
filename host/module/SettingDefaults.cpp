#include "module/SettingDefaults.h"

#include <utility>

#include "SettingsKeys.h"

using namespace SettingsKeys;

namespace
{
const std::pair<const char*, bool> kFlagDefaults[] = {
    {OUTPUTFILETYPEEPS, SettingsDefaults::OUTPUTFILETYPEEPS},
    {CUSTOMPAGESIZE, SettingsDefaults::CUSTOMPAGESIZE},
    {ORIENTATIONPOTRAIT, SettingsDefaults::ORIENTATIONPOTRAIT},
    {ORIENTATIONLANDSCAPE, SettingsDefaults::ORIENTATIONLANDSCAPE},
    {AUTOROTATE, SettingsDefaults::AUTOROTATE},
    {ORIGINALSIZE, SettingsDefaults::ORIGINALSIZE},
    {CUSTOMSIZE, SettingsDefaults::CUSTOMSIZE},
    {CONTRAINPROPORTION, SettingsDefaults::CONTRAINPROPORTION},
    {ORIGINALWIDTHOPTION, SettingsDefaults::ORIGINALWIDTHOPTION},
    {ORIGINALHEIGHTOPTION, SettingsDefaults::ORIGINALHEIGHTOPTION},
    {FORCEAUTOSCALE, SettingsDefaults::FORCEAUTOSCALE},
    {FITTOPAGE, SettingsDefaults::FITTOPAGE},
    {SHRINKTOFIT, SettingsDefaults::SHRINKTOFIT},
    {SCALETOPRINT, SettingsDefaults::SCALETOPRINT},
};

wxString FirstPaper(const std::vector<stPageAttribute>& sheets, const wxString& what)
{
    if (sheets.empty())
        return "the " + what + " of the server's first paper (the folder has no server)";
    const stPageAttribute& first = sheets.front();
    if (what == "name")
        return "the server's first paper, " + first.PaperName;
    return FormatSettingDouble(what == "width" ? first.Width : first.Height) +
           " (the server's first paper, " + first.PaperName + ")";
}
} // namespace

wxString DescribeSettingDefault(const wxString& key, const std::vector<stPageAttribute>& sheets)
{
    for (const auto& flag : kFlagDefaults)
        if (key == flag.first)
            return FormatSettingFlag(flag.second);
    if (key == OUTPUTFILETYPEPS)
        return wxString("the opposite of ") + OUTPUTFILETYPEEPS;
    if (key == DEFAULTPAGESIZE)
        return FirstPaper(sheets, "name");
    if (key == IMAGEPOSITION)
        return SettingsDefaults::IMAGEPOSITION;
    if (key == CUSTOMPAGEWIDTH)
        return FirstPaper(sheets, "width");
    if (key == CUSTOMPAGEHEIGHT)
        return FirstPaper(sheets, "height");
    if (key == CUSTOMPAGETUNIT)
        return EncodeCustomPageUnit(SettingsDefaults::CUSTOMPAGETUNIT) + " (" +
               UnitWord(SettingsDefaults::CUSTOMPAGETUNIT) + ")";
    if (key == ORIGINALWIDTH || key == ORIGINALHEIGHT)
        return DefaultOriginalDimension(true) + " in inch, " + DefaultOriginalDimension(false) +
               " in mm";
    if (key == ORIGINALWIDTHUNIT || key == ORIGINALHEIGHTUNIT)
        return "the window's unit (the server's, or the system's)";
    // The page size, imageable area and page command follow the paper.
    return wxString("from ") + DEFAULTPAGESIZE;
}
