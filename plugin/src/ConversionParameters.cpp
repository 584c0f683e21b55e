// Settings text to the converter's numbers and flags.
#include <cstring>

#include "EPS.h"
#include "ImagePositionText.h"
#include "SettingsKeys.h"
#include "Units.h"

void EPS::LoadEPSParams()
{
    using namespace SettingsKeys;
    // Indexing inserts the key with an empty value, so the saved preferences
    // always name the paper, chosen or not.
    (void)m_settings[DEFAULTPAGESIZE];

    auto isOn = [this](const char* key) { return IsSettingOn(m_settings[key]); };
    auto number = [this](const char* key) { return ReadSettingNumber(m_settings, key); };

    if (isOn(ORIGINALSIZE))
    {
        m_params.customSize = false;
        m_params.autoScale = false;
        m_params.imageWidth = 0;
        m_params.imageHeight = 0;
    }
    else if (isOn(CUSTOMSIZE))
    {
        m_params.customSize = true;
        m_params.autoScale = true;
        m_params.imageWidth = number(ORIGINALWIDTH);
        m_params.imageHeight = number(ORIGINALHEIGHT);
        m_params.constrainProportions = isOn(CONTRAINPROPORTION);
        // Once on, these stay on for the object's lifetime.
        if (isOn(ORIGINALWIDTHOPTION))
            m_params.widthGiven = true;
        if (isOn(ORIGINALHEIGHTOPTION))
            m_params.heightGiven = true;
        const Unit_t widthUnit = DecodeDimensionUnit(m_settings[ORIGINALWIDTHUNIT]);
        const Unit_t heightUnit = DecodeDimensionUnit(m_settings[ORIGINALHEIGHTUNIT]);
        convertToUnit(m_params.imageWidth, widthUnit, UNIT_POINT);
        convertToUnit(m_params.imageHeight, heightUnit, UNIT_POINT);
    }
    else if (isOn(FORCEAUTOSCALE))
    {
        m_params.customSize = true;
        m_params.autoScale = true;
        m_params.fitToPage = isOn(FITTOPAGE);
        m_params.shrinkToFit = !m_params.fitToPage;
        m_params.scaleToPrintable = isOn(SCALETOPRINT);
    }

    // The first command loaded into an object stays for its lifetime.
    const wxCharBuffer command = m_settings[PAGESIZE_COMMAND].mb_str(wxConvUTF8);
    if (!m_params.setPageDeviceString)
    {
        const size_t length = command.data() ? std::strlen(command.data()) : 0;
        m_params.setPageDeviceString = new char[length + 1];
        std::memcpy(m_params.setPageDeviceString, command.data() ? command.data() : "", length);
        m_params.setPageDeviceString[length] = '\0';
    }

    m_params.imagePosition = ConvertToImgPosStr(m_settings[IMAGEPOSITION]);
    m_params.pageWidth = number(FORCEPAGESIZEX);
    m_params.pageHeight = number(FORCEPAGESIZEY);
    m_params.imageableLLX = number(IMAGEEABLESIZELLX);
    m_params.imageableLLY = number(IMAGEEABLESIZELLY);
    m_params.imageableURX = number(IMAGEEABLESIZEURX);
    m_params.imageableURY = number(IMAGEEABLESIZEURY);
    m_params.autoRotate = isOn(AUTOROTATE);
}
