#include "EnablingRules.h"

#include <initializer_list>

#include "ControlIds.h"

namespace
{
void Request(EnableRequests& out, std::initializer_list<int> ids, bool enable)
{
    for (int id : ids)
        out.emplace_back(id, enable);
}

const std::initializer_list<int> kCustomSizeControls = {
    ID_CONSTRAIN_CHECK, ID_WIDTH_RADIO,      ID_HEIGHT_RADIO,     ID_WIDTH_TEXT,
    ID_HEIGHT_TEXT,     ID_WIDTH_UNIT_COMBO, ID_HEIGHT_UNIT_COMBO};
const std::initializer_list<int> kWidthFields = {ID_WIDTH_TEXT, ID_WIDTH_UNIT_COMBO};
const std::initializer_list<int> kHeightFields = {ID_HEIGHT_TEXT, ID_HEIGHT_UNIT_COMBO};
const std::initializer_list<int> kDimensionChoice = {ID_WIDTH_RADIO, ID_HEIGHT_RADIO};
const std::initializer_list<int> kAutoScaleChoices = {ID_FITTOPAGE_RADIO, ID_SHRINKTOFIT_RADIO,
                                                      ID_SCALETOPRINT_CHECK};
const std::initializer_list<int> kImageGroup = {
    ID_CONSTRAIN_CHECK,   ID_WIDTH_RADIO,        ID_HEIGHT_RADIO,       ID_WIDTH_TEXT,
    ID_HEIGHT_TEXT,       ID_WIDTH_UNIT_COMBO,   ID_HEIGHT_UNIT_COMBO,  ID_FITTOPAGE_RADIO,
    ID_SHRINKTOFIT_RADIO, ID_SCALETOPRINT_CHECK, ID_ORIGINALSIZE_RADIO, ID_CUSTOMSIZE_RADIO,
    ID_AUTOSCALE_RADIO};
const std::initializer_list<int> kPageGroup = {ID_PAGESIZE_COMBO, ID_CUSTOMPAGESIZE_BUTTON,
                                               ID_IMAGEPOSITION_LABEL, ID_IMAGEPOSITION_COMBO,
                                               ID_PAGESIZE_LABEL};
} // namespace

int RequestedState(const EnableRequests& requests, int id)
{
    int state = -1;
    for (const auto& request : requests)
        if (request.first == id)
            state = request.second ? 1 : 0;
    return state;
}

void CustomSizeSelectionRule(EnableRequests& out, bool enable, bool widthDrives, bool heightDrives)
{
    Request(out, kCustomSizeControls, enable);
    if (!widthDrives)
        Request(out, kWidthFields, false);
    else if (!heightDrives)
        Request(out, kHeightFields, false);
}

void ConstrainSelectionRule(EnableRequests& out, bool on, bool customSize, bool widthDrives,
                            bool heightDrives)
{
    if (on)
    {
        Request(out, kDimensionChoice, true);
        CustomSizeSelectionRule(out, customSize, widthDrives, heightDrives);
    }
    else
    {
        Request(out, kWidthFields, true);
        Request(out, kHeightFields, true);
        Request(out, kDimensionChoice, false);
    }
}

void AutoScaleSelectionRule(EnableRequests& out, bool on)
{
    Request(out, kAutoScaleChoices, on);
}

void WidthHeightRule(EnableRequests& out, bool width)
{
    Request(out, kWidthFields, width);
    Request(out, kHeightFields, !width);
}

void PageAndImageGroupRule(EnableRequests& out, bool enable)
{
    Request(out, kImageGroup, enable);
    Request(out, kPageGroup, enable);
}
