// Settings text to the converter's numbers and flags.
#include <cstring>

#include <hotfolder/HFTranslations.h>

#include "EPS.h"
#include "ImagePosition.h"
#include "Units.h"

namespace
{
bool IsOn(MapPropToValue& settings, const char* key)
{
    return settings[key] == "1";
}

// Stored numbers use "." whatever the language, but the application
// language may have switched the C locale to a decimal comma: read the
// stored form first, then the locale's own form (values typed by older
// panels). A text neither reads leaves 0.
double Number(MapPropToValue& settings, const char* key)
{
    const wxString& text = settings[key];
    double value = 0;
    if (!text.ToCDouble(&value) && !text.ToDouble(&value))
        value = 0;
    return value;
}

Unit_t UnitOfWord(const wxString& word)
{
    HFTranslations* translations = HFTranslations::GetInstance();
    if (translations->GetTranslations("inch").Index(word, true) != wxNOT_FOUND)
        return static_cast<Unit_t>(0);
    if (translations->GetTranslations("mm").Index(word, true) != wxNOT_FOUND)
        return static_cast<Unit_t>(1);
    return static_cast<Unit_t>(2);
}
} // namespace

void EPS::LoadEPSParams()
{
    // Indexing adds the key with an empty value when it is absent, and the
    // map is saved as it stands: kept so that saved preferences do not change.
    (void)m_settings["DEFAULTPAGESIZE"];

    if (IsOn(m_settings, "ORIGINALSIZE"))
    {
        m_params.customSize = false;
        m_params.autoScale = false;
        m_params.imageWidth = 0;
        m_params.imageHeight = 0;
    }
    else if (IsOn(m_settings, "CUSTOMSIZE"))
    {
        m_params.customSize = true;
        m_params.autoScale = true;
        m_params.imageWidth = Number(m_settings, "ORIGINALWIDTH");
        m_params.imageHeight = Number(m_settings, "ORIGINALHEIGHT");
        m_params.constrainProportions = IsOn(m_settings, "CONTRAINPROPORTION");
        // Once on, these stay on for the object's lifetime.
        if (IsOn(m_settings, "ORIGINALWIDTHOPTION"))
            m_params.widthGiven = true;
        if (IsOn(m_settings, "ORIGINALHEIGHTOPTION"))
            m_params.heightGiven = true;
        const Unit_t widthUnit = UnitOfWord(m_settings["ORIGINALWIDTHUNIT"]);
        const Unit_t heightUnit = UnitOfWord(m_settings["ORIGINALHEIGHTUNIT"]);
        convertToUnit(m_params.imageWidth, widthUnit, static_cast<Unit_t>(2));
        convertToUnit(m_params.imageHeight, heightUnit, static_cast<Unit_t>(2));
    }
    else if (IsOn(m_settings, "FORCEAUTOSCALE"))
    {
        m_params.customSize = true;
        m_params.autoScale = true;
        m_params.fitToPage = IsOn(m_settings, "FITTOPAGE");
        m_params.shrinkToFit = !m_params.fitToPage;
        m_params.scaleToPrintable = IsOn(m_settings, "SCALETOPRINT");
    }

    // The first command loaded into an object stays for its lifetime.
    const wxCharBuffer command = m_settings["PAGESIZE_COMMAND"].mb_str(wxConvUTF8);
    if (!m_params.setPageDeviceString)
    {
        const size_t length = command.data() ? std::strlen(command.data()) : 0;
        m_params.setPageDeviceString = new char[length + 1];
        std::memcpy(m_params.setPageDeviceString, command.data() ? command.data() : "", length);
        m_params.setPageDeviceString[length] = '\0';
    }

    m_params.imagePosition = ConvertToImgPosStr(m_settings["IMAGEPOSITION"]);
    m_params.pageWidth = Number(m_settings, "FORCEPAGESIZEX");
    m_params.pageHeight = Number(m_settings, "FORCEPAGESIZEY");
    m_params.imageableLLX = Number(m_settings, "IMAGEEABLESIZELLX");
    m_params.imageableLLY = Number(m_settings, "IMAGEEABLESIZELLY");
    m_params.imageableURX = Number(m_settings, "IMAGEEABLESIZEURX");
    m_params.imageableURY = Number(m_settings, "IMAGEEABLESIZEURY");
    m_params.autoRotate = IsOn(m_settings, "AUTOROTATE");
}
