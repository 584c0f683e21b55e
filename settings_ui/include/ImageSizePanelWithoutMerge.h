#pragma once
#include "EnablingRules.h"
#include "PageSizePanelWithoutMerge.h"

class wxTextCtrl;

// Image section and the most derived panel: original size, a custom width
// and height in inches or millimetres, or automatic scaling to the page.
class ImageSizePanelWithoutMerge : public PageSizePanelWithoutMerge
{
public:
    ImageSizePanelWithoutMerge(wxWindow* parent, bool enabled, bool secondFlag);

    bool InitializeControls() override;
    bool SaveUISettings(MapPropToValue& settings) override;
    bool LoadUISettings(MapPropToValue& settings) override;

    // The image fields offer inch and mm only, so a server preferring
    // points falls back to the system's unit.
    void SetMeasurementUnit(const wxString& preferredUnit, const wxString& systemUnit);
    wxString GetMeasurementUnit() const { return m_strMeasurementUnit; }

    bool ValidateData();
    bool ValidateAndSetData(double value, const wxString& unit, wxString& resetText,
                            wxTextCtrl* field);

    void HandleCustomSizeSelection(bool enable, bool widthDrives, bool heightDrives);
    void HandleConstrainSelection(bool on);
    void HandleAutoScaleSelection(bool on);
    void HandleOnRadioWidthHeight(bool width);

    void SetDecimalSeparator(wxString& separator);
    wxString GetDecimalSeparator() const { return m_strDecimalSeparator; }
    // toStorage: the panel's separator becomes "."; otherwise the reverse.
    void FormatDataAsPerDecimalSeparator(wxString& text, bool toStorage) const;

    void OnRadioOriginalSize(wxCommandEvent& event);
    void OnRadioCustomSize(wxCommandEvent& event);
    void OnRadioAutoScale(wxCommandEvent& event);
    void OnCheckConstrain(wxCommandEvent& event);
    void OnRadioWidth(wxCommandEvent& event);
    void OnRadioHeight(wxCommandEvent& event);
    void OnRadioFitToPage(wxCommandEvent& event);
    void OnRadioShrinkToFit(wxCommandEvent& event);
    void OnCheckScaleToPrint(wxCommandEvent& event);
    void OnWidthText(wxCommandEvent& event);
    void OnHeightText(wxCommandEvent& event);
    void OnWidthUnit(wxCommandEvent& event);
    void OnHeightUnit(wxCommandEvent& event);

protected:
    bool m_bOriginalSize = true;
    bool m_bCustomSize = false;
    bool m_bConstrain = true;
    bool m_bWidthDrives = true;
    bool m_bHeightDrives = false;
    bool m_bAutoScale = false;
    bool m_bFitToPage = true;
    bool m_bShrinkToFit = false;
    bool m_bScaleToPrint = false;
    bool m_bImageSectionEnabled;
    bool m_bImageSecondFlag; // part of the section's data model; nothing reads it
    wxString m_strWidth;
    wxString m_strHeight;
    wxString m_strWidthUnit;
    wxString m_strHeightUnit;
    wxString m_strDecimalSeparator;
    wxString m_strMeasurementUnit;

private:
    void EnableControls(const EnableRequests& requests);
    void TransferImageControlsToWindow();
    void ChangeFieldUnit(int comboId, int textId, wxString& unitText, wxString& valueText);
};
