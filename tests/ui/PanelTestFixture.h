#pragma once
// A settings panel built by the factory from a test server description.
#include <wx/button.h>
#include <wx/checkbox.h>
#include <wx/combobox.h>
#include <wx/frame.h>
#include <wx/radiobut.h>
#include <wx/textctrl.h>

#include "ControlIds.h"
#include "GuiTestSupport.h"
#include "ImageSizePanelWithoutMerge.h"
#include "PanelFactories.h"

namespace ui_test
{
class PanelTest : public GuiTest
{
protected:
    ImageSizePanelWithoutMerge* Build(bool enabled = true,
                                      const wxString& server = "ui/server-ui.xml")
    {
        const wxString xml = ReadTextFile(TestDataPath(server));
        wxWindow* window = ImageSizePanelWithoutMerge_Factory::CreateInstance(
            m_frame, xml, "EPS", ".eps", enabled, enabled);
        m_panel = wxDynamicCast(window, ImageSizePanelWithoutMerge);
        m_frame->Layout();
        return m_panel;
    }

    // What the host does on OK.
    bool Save(MapPropToValue& settings)
    {
        m_panel->TransferDataFromWindow();
        return m_panel->SaveUISettings(settings);
    }

    template <typename T> T* Control(int id) const
    {
        return wxDynamicCast(m_panel->FindWindow(id), T);
    }
    wxRadioButton* Radio(int id) const { return Control<wxRadioButton>(id); }
    wxComboBox* Combo(int id) const { return Control<wxComboBox>(id); }
    wxTextCtrl* Text(int id) const { return Control<wxTextCtrl>(id); }
    bool Enabled(int id) const { return m_panel->FindWindow(id)->IsEnabled(); }

    void ClickButton(int id)
    {
        wxCommandEvent event(wxEVT_BUTTON, id);
        event.SetEventObject(m_panel->FindWindow(id));
        m_panel->FindWindow(id)->HandleWindowEvent(event);
    }

    ImageSizePanelWithoutMerge* m_panel = nullptr;
};
} // namespace ui_test
