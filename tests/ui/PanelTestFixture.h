#pragma once
// A settings panel built by the factory from a test server description.
#include <wx/button.h>
#include <wx/checkbox.h>
#include <wx/combobox.h>
#include <wx/frame.h>
#include <wx/msgdlg.h>
#include <wx/testing.h>
#include <wx/radiobut.h>
#include <wx/textctrl.h>

#include "ControlIds.h"
#include "CustomPageSizeDlg.h"
#include "GuiTestSupport.h"
#include "ImageSizePanelWithoutMerge.h"
#include "PanelFactories.h"

namespace ui_test
{
// Answers the custom page size dialog: switches it to points, types the
// size and presses OK (with OK's own checks).
class EnterCustomSizeInPoints : public wxExpectModalBase<CustomPageSizeDlg>
{
public:
    EnterCustomSizeInPoints(wxString width, wxString height)
        : m_width(std::move(width)), m_height(std::move(height))
    {
    }

protected:
    int OnInvoked(CustomPageSizeDlg* dialog) const override
    {
        ClickRadio(wxDynamicCast(dialog->FindWindow(ID_CUSTOM_UNIT_POINT), wxRadioButton));
        auto* width = wxDynamicCast(dialog->FindWindow(ID_CUSTOM_WIDTH_TEXT), wxTextCtrl);
        auto* height = wxDynamicCast(dialog->FindWindow(ID_CUSTOM_HEIGHT_TEXT), wxTextCtrl);
        // The fields are typed in the locale's notation, as shown ("612.00").
        const wxString point = width->GetValue().Right(3).Left(1);
        wxString w = m_width, h = m_height;
        w.Replace(".", point);
        h.Replace(".", point);
        TypeText(width, w);
        TypeText(height, h);
        return dialog->AcceptSizes() ? wxID_OK : wxID_CANCEL;
    }

private:
    wxString m_width, m_height;
};

class CancelCustomSize : public wxExpectModalBase<CustomPageSizeDlg>
{
protected:
    int OnInvoked(CustomPageSizeDlg*) const override { return wxID_CANCEL; }
};

// A message box whose text must contain `part`.
class ExpectMessageContaining : public wxExpectModalBase<wxMessageDialog>
{
public:
    explicit ExpectMessageContaining(wxString part) : m_part(std::move(part)) {}

protected:
    int OnInvoked(wxMessageDialog* dialog) const override
    {
        EXPECT_NE(wxNOT_FOUND, dialog->GetMessage().Find(m_part))
            << dialog->GetMessage().ToStdString();
        return wxID_OK;
    }

private:
    wxString m_part;
};

class PanelTest : public GuiTest
{
protected:
    ImageSizePanelWithoutMerge* Build(bool enabled = true,
                                      const wxString& server = "ui/server-ui.xml")
    {
        const wxString xml = TestDataText(server);
        wxWindow* window = ImageSizePanelWithoutMerge_Factory::CreateInstance(
            m_frame, xml, "EPS", ".eps", enabled, enabled);
        m_panel = wxDynamicCast(window, ImageSizePanelWithoutMerge);
        m_frame->Layout();
        return m_panel;
    }

    // Builds the panel and loads settings with PostScript output chosen.
    void BuildAndLoadPs(MapPropToValue& settings)
    {
        Build();
        settings["OUTPUTFILETYPEEPS"] = "0";
        m_panel->LoadUISettings(settings);
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
