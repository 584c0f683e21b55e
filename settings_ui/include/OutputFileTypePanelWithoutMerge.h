#pragma once
#include <wx/arrstr.h>
#include <wx/panel.h>

#include <hotfolder/MapPropToValue.h>

// First section of the settings panel chain: EPS pass-through or PostScript
// conversion. While EPS is chosen the page and image controls of the derived
// sections are switched off, since they only matter for the conversion.
class OutputFileTypePanelWithoutMerge : public wxPanel
{
public:
    OutputFileTypePanelWithoutMerge(wxWindow* parent, bool enabled, bool secondFlag);

    // Binds the controls to the members through validators.
    virtual bool InitializeControls();
    // Writes the members to the map; false when validation fails.
    virtual bool SaveUISettings(MapPropToValue& settings);
    // Sets the members and the controls from the map.
    virtual bool LoadUISettings(MapPropToValue& settings);

    void OnRadioEPS(wxCommandEvent& event);
    void OnRadioPS(wxCommandEvent& event);
    void OnRadioPDF(wxCommandEvent& event);

    void EnablePageSizePanel(bool enable);
    void HandleOutputFileTypeSelection(bool enable);
    void HandlePDFDistillerSelection(bool enable);
    void RemovePDFOption();

    bool IsEPSOutput() const { return m_bEPSOutput; }
    bool IsPSOutput() const { return m_bPSOutput; }
    bool ArePageControlsDisabled() const { return m_bPageControlsDisabled; }

protected:
    bool m_bEPSOutput = true;
    bool m_bPSOutput = false;
    bool m_bPDFOutput = false;
    bool m_bOutputSectionEnabled;
    // Part of the section's data model; this filter reads neither.
    bool m_bOutputSecondFlag;
    wxArrayString m_arrNames;
    bool m_bPageControlsDisabled = false;

private:
    void EnableIfPresent(int id, bool enable);
};
