#pragma once
#include <wx/dialog.h>

#include "Units.h"

class wxStaticText;
class wxTextCtrl;

// Modal entry of a custom page width and height, in inches, millimetres or
// points, within the print server's custom media limits.
class CustomPageSizeDlg : public wxDialog
{
public:
    CustomPageSizeDlg(wxWindow* parent, wxWindowID id, const wxString& title, double minWidth,
                      double maxWidth, double minHeight, double maxHeight, double width,
                      double height, Unit_t unit, bool& heightIsLength);

    void SetPageSizes(double width, double height, Unit_t unit);
    void GetPageSizes(double& width, double& height, Unit_t& unit) const;

    void OnRadioInch(wxCommandEvent& event);
    void OnRadioMM(wxCommandEvent& event);
    void OnRadioPoint(wxCommandEvent& event);
    void OnCustomWidth(wxCommandEvent& event);
    void OnCustomHeight(wxCommandEvent& event);
    void OnOK(wxCommandEvent& event);
    // What OK checks: the sizes against the limits, then the validators.
    bool AcceptSizes();

    // Shows the stored sizes in the current unit and moves the limits from
    // `previousUnit` to it.
    void UpdateSizes(Unit_t previousUnit);
    // Limits carry two decimals, as they are shown.
    void FormatValues();
    // False (after a message) when the value cannot be used; true, after a
    // warning, for sizes below what the engine supports.
    bool MinMaxDoubleEx(double value, double minimum, double maximum, int dimension);

private:
    void CreateControls();
    void SwitchUnit(Unit_t unit);
    void HandleKeystroke(wxTextCtrl* field, double maximum, wxString& lastAccepted, double& points);
    wxString ShownNumber(double value) const;

    double m_dWidth;
    double m_dHeight;
    double m_dMaxWidth;
    double m_dMaxHeight;
    double m_dMinWidth;
    double m_dMinHeight;
    Unit_t m_eUnit;
    wxString m_strLastWidth;
    wxString m_strLastHeight;
    double m_dWidthPoints = 0;
    double m_dHeightPoints = 0;
    bool& m_bHeightIsLength;
    wxString m_strDecimalPoint;

    wxTextCtrl* m_pWidthText = nullptr;
    wxTextCtrl* m_pHeightText = nullptr;
    wxStaticText* m_pWidthRange = nullptr;
    wxStaticText* m_pHeightRange = nullptr;
};
