#include "OutputFileTypePanelWithoutMerge.h"

#include <wx/radiobut.h>
#include <wx/valgen.h>

#include "ControlIds.h"
#include "EnablingRules.h"
#include "PanelTheme.h"
#include "SettingsKeys.h"

OutputFileTypePanelWithoutMerge::OutputFileTypePanelWithoutMerge(wxWindow* parent, bool enabled,
                                                                 bool secondFlag)
    : wxPanel(parent, wxID_ANY, wxDefaultPosition, wxDefaultSize, wxTAB_TRAVERSAL | wxNO_BORDER),
      m_bOutputSectionEnabled(enabled), m_bOutputSecondFlag(secondFlag)
{
    // The views nest their controls in static boxes; validators must reach them.
    SetExtraStyle(GetExtraStyle() | wxWS_EX_VALIDATE_RECURSIVELY);
    ApplyDefaultTheme(this);
    Bind(wxEVT_RADIOBUTTON, &OutputFileTypePanelWithoutMerge::OnRadioEPS, this,
         ID_OUTPUT_EPS_RADIO);
    Bind(wxEVT_RADIOBUTTON, &OutputFileTypePanelWithoutMerge::OnRadioPS, this, ID_OUTPUT_PS_RADIO);
    Bind(wxEVT_RADIOBUTTON, &OutputFileTypePanelWithoutMerge::OnRadioPDF, this,
         ID_OUTPUT_PDF_RADIO);
}

bool OutputFileTypePanelWithoutMerge::InitializeControls()
{
    if (!m_bOutputSectionEnabled)
        return true;
    if (wxWindow* eps = FindWindow(ID_OUTPUT_EPS_RADIO))
        eps->SetValidator(wxGenericValidator(&m_bEPSOutput));
    if (wxWindow* ps = FindWindow(ID_OUTPUT_PS_RADIO))
        ps->SetValidator(wxGenericValidator(&m_bPSOutput));
    return true;
}

bool OutputFileTypePanelWithoutMerge::SaveUISettings(MapPropToValue& settings)
{
    if (!m_bOutputSectionEnabled)
        return true;
    settings[SettingsKeys::OUTPUTFILETYPEEPS] = FormatSettingFlag(m_bEPSOutput);
    settings[SettingsKeys::OUTPUTFILETYPEPS] = FormatSettingFlag(m_bPSOutput);
    return true;
}

bool OutputFileTypePanelWithoutMerge::LoadUISettings(MapPropToValue& settings)
{
    if (!m_bOutputSectionEnabled)
        return true;
    m_bEPSOutput = ReadSettingFlag(settings, SettingsKeys::OUTPUTFILETYPEEPS,
                                   SettingsDefaults::OUTPUTFILETYPEEPS);
    m_bPSOutput = !m_bEPSOutput;
    TransferDataToWindow();
    if (m_bEPSOutput)
    {
        m_bPageControlsDisabled = true;
        EnablePageSizePanel(false);
    }
    return true;
}

void OutputFileTypePanelWithoutMerge::OnRadioEPS(wxCommandEvent& event)
{
    m_bEPSOutput = event.IsChecked();
    m_bPSOutput = !m_bEPSOutput;
    m_bPageControlsDisabled = true;
    EnablePageSizePanel(false);
}

void OutputFileTypePanelWithoutMerge::OnRadioPS(wxCommandEvent& event)
{
    m_bPSOutput = event.IsChecked();
    m_bEPSOutput = !m_bPSOutput;
    EnablePageSizePanel(true);
    m_bPageControlsDisabled = false;
}

void OutputFileTypePanelWithoutMerge::OnRadioPDF(wxCommandEvent& event)
{
    m_bPDFOutput = event.IsChecked();
    m_bPSOutput = m_bEPSOutput = !m_bPDFOutput;
    EnableIfPresent(ID_DISTILLER_CHOICE, true);
    EnableIfPresent(ID_DISTILLER_JOBOPTIONS, true);
    EnablePageSizePanel(true);
    m_bPageControlsDisabled = false;
}

void OutputFileTypePanelWithoutMerge::EnablePageSizePanel(bool enable)
{
    // Only undo what this section switched off, so repeated "PS" clicks do
    // not keep resetting the image size choice.
    if (!m_bPageControlsDisabled)
        return;
    EnableRequests requests;
    PageAndImageGroupRule(requests, enable);
    for (const auto& request : requests)
        EnableIfPresent(request.first, request.second);

    auto* original = wxDynamicCast(FindWindow(ID_ORIGINALSIZE_RADIO), wxRadioButton);
    if (original)
        original->SetValue(true);
    wxCommandEvent select(wxEVT_RADIOBUTTON, ID_ORIGINALSIZE_RADIO);
    select.SetEventObject(original ? static_cast<wxObject*>(original) : this);
    select.SetInt(1);
    GetEventHandler()->ProcessEvent(select);
}

void OutputFileTypePanelWithoutMerge::HandleOutputFileTypeSelection(bool enable)
{
    EnableIfPresent(ID_DISTILLER_CHOICE, enable);
    EnableIfPresent(ID_DISTILLER_JOBOPTIONS, enable);
}

void OutputFileTypePanelWithoutMerge::HandlePDFDistillerSelection(bool enable)
{
    EnableIfPresent(ID_OUTPUT_PDF_RADIO, enable);
    HandleOutputFileTypeSelection(enable);
}

void OutputFileTypePanelWithoutMerge::RemovePDFOption()
{
    if (wxWindow* pdf = FindWindow(ID_OUTPUT_PDF_RADIO))
    {
        pdf->Hide();
        for (int id : {ID_DISTILLER_JOBOPTIONS, ID_DISTILLER_CHOICE})
            if (wxWindow* control = FindWindow(id))
                control->Hide();
    }
    Layout();
}

void OutputFileTypePanelWithoutMerge::EnableIfPresent(int id, bool enable)
{
    if (wxWindow* control = FindWindow(id))
        control->Enable(enable);
}
