#pragma once
#include <vector>

#include <wx/arrstr.h>

#include "OutputFileTypePanelWithoutMerge.h"
#include "Units.h"
#include "db/PageAttributes.h"

// Page section: one of the server's sheets or a custom size, and where the
// image sits on the page. Saved as the page description the converter needs.
class PageSizePanelWithoutMerge : public OutputFileTypePanelWithoutMerge
{
public:
    PageSizePanelWithoutMerge(wxWindow* parent, bool enabled, bool secondFlag);

    bool InitializeControls() override;
    bool SaveUISettings(MapPropToValue& settings) override;
    bool LoadUISettings(MapPropToValue& settings) override;

    void SetPageSizeArray(const wxArrayString& names) { m_arrPageSizeNames = names; }
    void GetPageSizeArray(wxArrayString& names) const { names = m_arrPageSizeNames; }
    void SetPageAttributes(const std::vector<stPageAttribute>& sheets) { m_sheets = sheets; }
    void SetCustomPageAttributes(const stCustomPageSizeAttribute& custom) { m_customPage = custom; }
    void SetPageSize(const wxString& text) { m_strPageSize = text; }
    wxString GetPageSize() const { return m_strPageSize; }

    bool IsCustomPageSize() const { return m_bCustomPageSize; }
    Unit_t GetCustomPageUnit() const { return m_eMeasurementUnit; }
    double GetCustomWidthPoints() const { return m_dCustomWidth; }
    double GetCustomHeightPoints() const { return m_dCustomHeight; }
    wxString GetImagePosition() const { return m_strImagePosition; }

    void OnCustomPageSize(wxCommandEvent& event);
    void OnComboCustomPageSize(wxCommandEvent&) {}
    void OnComboImagePosition(wxCommandEvent&) {}
    void OnRadioPortrait(wxCommandEvent& event);
    void OnRadioLandscape(wxCommandEvent& event);
    void OnCheckAutoRotate(wxCommandEvent& event);

    // Appends the custom size, already in the measurement unit, to the
    // paper list and selects it.
    void AddCustomPageSize();

protected:
    bool m_bPortrait = true;
    bool m_bLandscape = false;
    bool m_bAutoRotate = false;
    bool m_bCustomPageSize = false;
    bool m_bPageSectionEnabled;
    bool m_bPageSecondFlag;     // part of the section's data model; nothing reads it
    double m_dCustomWidth = 0;  // points between operations
    double m_dCustomHeight = 0; // points between operations
    wxString m_strPageSize;
    wxString m_strImagePosition;
    wxArrayString m_arrPageSizeNames;
    std::vector<stPageAttribute> m_sheets;
    stCustomPageSizeAttribute m_customPage;
    Unit_t m_eMeasurementUnit;

private:
    // Adds the custom size to the paper list, leaving it in points.
    void ShowCustomPageSize();
};
