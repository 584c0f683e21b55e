#pragma once
// The panel's controls by the short names the case tables use.
#include <string>
#include <utility>
#include <vector>

#include "ControlIds.h"

namespace ui_test
{
inline const std::vector<std::pair<std::string, int>>& ControlNames()
{
    static const std::vector<std::pair<std::string, int>> names = {
        {"original", ID_ORIGINALSIZE_RADIO},
        {"custom", ID_CUSTOMSIZE_RADIO},
        {"constrain", ID_CONSTRAIN_CHECK},
        {"width-radio", ID_WIDTH_RADIO},
        {"width", ID_WIDTH_TEXT},
        {"width-unit", ID_WIDTH_UNIT_COMBO},
        {"height-radio", ID_HEIGHT_RADIO},
        {"height", ID_HEIGHT_TEXT},
        {"height-unit", ID_HEIGHT_UNIT_COMBO},
        {"autoscale", ID_AUTOSCALE_RADIO},
        {"fit", ID_FITTOPAGE_RADIO},
        {"shrink", ID_SHRINKTOFIT_RADIO},
        {"scale", ID_SCALETOPRINT_CHECK},
        {"page-label", ID_PAGESIZE_LABEL},
        {"page", ID_PAGESIZE_COMBO},
        {"custom-page", ID_CUSTOMPAGESIZE_BUTTON},
        {"position-label", ID_IMAGEPOSITION_LABEL},
        {"position", ID_IMAGEPOSITION_COMBO},
        {"eps", ID_OUTPUT_EPS_RADIO},
        {"ps", ID_OUTPUT_PS_RADIO},
        {"input", ID_INPUT_FILETYPE_TEXT},
        {"input-label", ID_INPUT_FILETYPE_LABEL}};
    return names;
}

inline int ControlId(const std::string& name)
{
    for (const auto& [known, id] : ControlNames())
        if (known == name)
            return id;
    return -1;
}
} // namespace ui_test
