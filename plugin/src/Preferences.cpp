// Saving and loading the filter's settings in the host's preference XML.
#include <wx/xml/xml.h>

#include "EPS.h"
#include "ImageSizePanelWithoutMerge.h"

long EPS::SavePreference(wxXmlNode* node)
{
    if (m_pSettingsPanel)
    {
        m_pSettingsPanel->TransferDataFromWindow();
        if (!m_pSettingsPanel->SaveUISettings(m_settings))
            return -1;
        LoadEPSParams();
    }
    auto* ui = new wxXmlNode(wxXML_ELEMENT_NODE, "UI");
    for (const auto& entry : m_settings)
    {
        auto* setting = new wxXmlNode(wxXML_ELEMENT_NODE, entry.first);
        setting->AddChild(new wxXmlNode(wxXML_TEXT_NODE, "text", entry.second));
        ui->AddChild(setting);
    }
    if (node)
        node->AddChild(ui);
    else
        delete ui;
    return 0;
}

long EPS::LoadPreference(wxXmlNode* node)
{
    ReadUIElement(node);
    return m_lStatus = 0;
}
