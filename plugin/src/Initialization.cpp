// What the server offers, and the settings the host saved for this filter.
#include <wx/xml/xml.h>

#include "EPS.h"
#include "SettingsKeys.h"
#include "XmlHelper.h"
#include "db/PluginInitialize.h"

long EPS::Initialize(const wxString& serverDescription)
{
    m_lStatus = 0;
    if (!serverDescription.empty())
        m_strServerDescription = serverDescription;

    // Every query reads the text handed in, not the stored description.
    if (PluginInitialize::IsServerGA2Enabled(serverDescription) ||
        PluginInitialize::IsFeatureEnabled(serverDescription, "HF_EPS_FILTER"))
        m_bFilterEnabled = true;

    PluginInitialize::InitializeSheetInfo(serverDescription, m_sheetList);
    PluginInitialize::InitializeCustomPageSizeInfo(serverDescription, m_customPageSizeInfo);
    PluginInitialize::InitializeDefaultSheetInfo(serverDescription, m_defaultSheet);

    if (PluginInitialize::IsFeatureEnabled(serverDescription, "SubstrateFamilySupported"))
        m_bSubstrateFamilySupported = true;
    return m_lStatus;
}

// One element per setting below "UI", named by the key, its text the value.
void EPS::ReadUIElement(wxXmlNode* node)
{
    wxXmlNode* ui = CXmlNodeHelper::Find(node, "UI", true);
    if (!ui)
        return;
    for (wxXmlNode* setting = ui->GetChildren(); setting; setting = setting->GetNext())
    {
        if (setting->GetType() != wxXML_ELEMENT_NODE)
            continue;
        for (wxXmlNode* text = setting->GetChildren(); text; text = text->GetNext())
            m_settings[setting->GetName()] = text->GetContent();
    }
}

long EPS::InitilaizeFromPreference(wxXmlNode* preference)
{
    ReadUIElement(preference);
    m_bOutputTypeIsOne = IsSettingOn(m_settings[SettingsKeys::OUTPUTFILETYPEEPS]);
    LoadEPSParams();
    return m_lStatus = 0;
}
