#include "EPS.h"
#include "ImageSizePanelWithoutMerge.h"
#include "PanelFactories.h"
#include "SettingsKeys.h"
#include "Units.h"
#include "db/PluginInitialize.h"

wxWindow* EPS::ShowPluginUI(wxWindow* parent)
{
    wxWindow* panel = ImageSizePanelWithoutMerge_Factory::CreateInstance(
        parent, m_strServerDescription, "EPS", ".eps", m_bFilterEnabled, m_bFilterEnabled);
    m_pSettingsPanel = wxDynamicCast(panel, ImageSizePanelWithoutMerge);
    if (!m_pSettingsPanel)
        return nullptr;

    // The server's preferred unit decides how custom page sizes are shown,
    // whatever was stored.
    wxString unit;
    if (!PluginInitialize::InitializePreferenceUnit(m_strServerDescription, unit))
        unit.clear();
    m_settings[SettingsKeys::CUSTOMPAGETUNIT] = EncodeCustomPageUnit(UnitFromServerWord(unit));

    m_pSettingsPanel->LoadUISettings(m_settings);
    LoadEPSParams();
    return m_pSettingsPanel;
}
