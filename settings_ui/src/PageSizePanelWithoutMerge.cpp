#include "PageSizePanelWithoutMerge.h"

#include <algorithm>

#include <wx/combobox.h>
#include <wx/valgen.h>

#include "ControlIds.h"
#include "CustomPageSizeDlg.h"
#include "PageSizeKeys.h"
#include "SettingsKeys.h"
#include "UiText.h"

PageSizePanelWithoutMerge::PageSizePanelWithoutMerge(wxWindow* parent, bool enabled,
                                                     bool secondFlag)
    : OutputFileTypePanelWithoutMerge(parent, enabled, secondFlag), m_bPageSectionEnabled(enabled),
      m_bPageSecondFlag(secondFlag), m_strPageSize("Default Size"),
      m_strImagePosition(TranslateUiText(SettingsDefaults::IMAGEPOSITION)),
      m_eMeasurementUnit(SettingsDefaults::CUSTOMPAGETUNIT)
{
    m_arrPageSizeNames.Add("Default Size");
    Bind(wxEVT_BUTTON, &PageSizePanelWithoutMerge::OnCustomPageSize, this,
         ID_CUSTOMPAGESIZE_BUTTON);
    Bind(wxEVT_COMBOBOX, &PageSizePanelWithoutMerge::OnComboCustomPageSize, this,
         ID_PAGESIZE_COMBO);
    Bind(wxEVT_COMBOBOX, &PageSizePanelWithoutMerge::OnComboImagePosition, this,
         ID_IMAGEPOSITION_COMBO);
}

bool PageSizePanelWithoutMerge::InitializeControls()
{
    if (!m_bPageSectionEnabled)
        return true;
    OutputFileTypePanelWithoutMerge::InitializeControls();
    auto* paper = wxDynamicCast(FindWindow(ID_PAGESIZE_COMBO), wxComboBox);
    if (paper)
    {
        if (!m_arrPageSizeNames.empty())
            paper->Append(m_arrPageSizeNames);
        // At least its 150 pixels, wider when the server's names need it.
        paper->InvalidateBestSize();
        paper->SetMinSize(wxSize(std::max(150, paper->GetBestSize().x), -1));
        paper->SetValidator(wxGenericValidator(&m_strPageSize));
    }
    if (wxWindow* position = FindWindow(ID_IMAGEPOSITION_COMBO))
        position->SetValidator(wxGenericValidator(&m_strImagePosition));
    return true;
}

void PageSizePanelWithoutMerge::AddCustomPageSize()
{
    auto* paper = wxDynamicCast(FindWindow(ID_PAGESIZE_COMBO), wxComboBox);
    if (!paper)
        return;
    paper->Append(CustomPageEntryText(m_dCustomWidth, m_dCustomHeight, m_eMeasurementUnit));
    paper->SetSelection(paper->GetCount() - 1);
}

void PageSizePanelWithoutMerge::ShowCustomPageSize()
{
    // Only the list entry is in the measurement unit: the points stay as they
    // are, since points to millimetres and back can come out a hair short of
    // a whole point, which the page command would then truncate.
    const double widthPoints = m_dCustomWidth, heightPoints = m_dCustomHeight;
    convertToUnit(m_dCustomWidth, UNIT_POINT, m_eMeasurementUnit);
    convertToUnit(m_dCustomHeight, UNIT_POINT, m_eMeasurementUnit);
    AddCustomPageSize();
    m_dCustomWidth = widthPoints;
    m_dCustomHeight = heightPoints;
}

void PageSizePanelWithoutMerge::OnCustomPageSize(wxCommandEvent&)
{
    const Unit_t unit = m_eMeasurementUnit;
    double minWidth = m_customPage.MinMediaWidth, maxWidth = m_customPage.MaxMediaWidth;
    double minHeight = m_customPage.MinMediaHeight, maxHeight = m_customPage.MaxMediaHeight;
    double width = m_dCustomWidth, height = m_dCustomHeight;
    for (double* value : {&minWidth, &maxWidth, &minHeight, &maxHeight, &width, &height})
        convertToUnit(*value, UNIT_POINT, unit);

    CustomPageSizeDlg dialog(this, wxID_ANY, TranslateUiText("Custom page size"), minWidth,
                             maxWidth, minHeight, maxHeight, width, height, unit,
                             m_customPage.SubstrateHeightToLength);
    dialog.Centre(wxBOTH);
    if (dialog.ShowModal() != wxID_OK)
        return;
    m_bCustomPageSize = true;
    Unit_t dialogUnit = unit;
    dialog.GetPageSizes(width, height, dialogUnit);
    convertToUnit(width, dialogUnit, UNIT_POINT);
    convertToUnit(height, dialogUnit, UNIT_POINT);
    m_dCustomWidth = width;
    m_dCustomHeight = height;
    ShowCustomPageSize();
}

void PageSizePanelWithoutMerge::OnRadioPortrait(wxCommandEvent& event)
{
    m_bPortrait = event.IsChecked();
    m_bLandscape = !m_bPortrait;
}

void PageSizePanelWithoutMerge::OnRadioLandscape(wxCommandEvent& event)
{
    m_bLandscape = event.IsChecked();
    m_bPortrait = !m_bLandscape;
}

void PageSizePanelWithoutMerge::OnCheckAutoRotate(wxCommandEvent& event)
{
    m_bAutoRotate = event.IsChecked();
}

bool PageSizePanelWithoutMerge::SaveUISettings(MapPropToValue& settings)
{
    if (!m_bPageSectionEnabled)
        return true;
    using namespace SettingsKeys;
    if (auto* paper = wxDynamicCast(FindWindow(ID_PAGESIZE_COMBO), wxComboBox))
    {
        if (!m_arrPageSizeNames.empty() &&
            m_arrPageSizeNames.Index(paper->GetValue()) != wxNOT_FOUND)
        {
            m_bCustomPageSize = false;
            settings[CUSTOMPAGESIZE] = FormatSettingFlag(false);
        }
    }
    OutputFileTypePanelWithoutMerge::SaveUISettings(settings);

    const stPageAttribute* sheet = FindSheetByDisplayName(m_sheets, m_strPageSize);
    settings[DEFAULTPAGESIZE] = sheet ? sheet->PaperName : m_strPageSize;
    settings[ORIENTATIONPOTRAIT] = FormatSettingFlag(m_bPortrait);
    settings[ORIENTATIONLANDSCAPE] = FormatSettingFlag(m_bLandscape);
    settings[AUTOROTATE] = FormatSettingFlag(m_bAutoRotate);
    settings[IMAGEPOSITION] = m_strImagePosition;
    if (sheet)
        WriteSheetPageKeys(settings, *sheet);
    if (m_bCustomPageSize)
        WriteCustomPageKeys(settings, m_dCustomWidth, m_dCustomHeight, m_customPage,
                            m_eMeasurementUnit);
    return true;
}

bool PageSizePanelWithoutMerge::LoadUISettings(MapPropToValue& settings)
{
    if (!m_bPageSectionEnabled)
        return true;
    using namespace SettingsKeys;
    namespace Defaults = SettingsDefaults;
    m_bPortrait = ReadSettingFlag(settings, ORIENTATIONPOTRAIT, Defaults::ORIENTATIONPOTRAIT);
    m_bLandscape = ReadSettingFlag(settings, ORIENTATIONLANDSCAPE, Defaults::ORIENTATIONLANDSCAPE);
    m_bAutoRotate = ReadSettingFlag(settings, AUTOROTATE, Defaults::AUTOROTATE);

    const wxString paperKey = settings[DEFAULTPAGESIZE];
    if (paperKey.empty())
    {
        if (!m_arrPageSizeNames.empty())
            m_strPageSize = m_arrPageSizeNames[0];
    }
    else
    {
        const stPageAttribute* sheet = FindSheetByPaperName(m_sheets, paperKey);
        m_strPageSize = sheet ? sheet->PaperDisplayName : paperKey;
    }

    const wxString position = settings[IMAGEPOSITION];
    m_strImagePosition = position.empty() ? TranslateUiText(Defaults::IMAGEPOSITION) : position;

    const wxString width = settings[CUSTOMPAGEWIDTH];
    if (!width.empty())
        ParseSettingDouble(width, m_dCustomWidth);
    else if (!m_sheets.empty())
        m_dCustomWidth = m_sheets.front().Width;
    const wxString height = settings[CUSTOMPAGEHEIGHT];
    if (!height.empty())
        ParseSettingDouble(height, m_dCustomHeight);
    else if (!m_sheets.empty())
        m_dCustomHeight = m_sheets.front().Height;

    // Text that is no unit code leaves the unit as it was.
    DecodeCustomPageUnit(settings[CUSTOMPAGETUNIT], m_eMeasurementUnit);

    m_bCustomPageSize = ReadSettingFlag(settings, CUSTOMPAGESIZE, Defaults::CUSTOMPAGESIZE);
    if (m_bCustomPageSize)
    {
        ShowCustomPageSize();
    }
    // A paper of the list named by the page size text is what the list shows
    // (and what a save keeps), even beside a custom flag; any other text
    // leaves the custom entry selected.
    TransferDataToWindow();
    return OutputFileTypePanelWithoutMerge::LoadUISettings(settings);
}
