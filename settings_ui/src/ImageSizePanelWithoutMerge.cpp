#include "ImageSizePanelWithoutMerge.h"

#include <wx/checkbox.h>
#include <wx/combobox.h>
#include <wx/intl.h>
#include <wx/msgdlg.h>
#include <wx/radiobut.h>
#include <wx/textctrl.h>
#include <wx/valgen.h>

#include "ControlIds.h"
#include "ImageDimensionRange.h"
#include "NumericValidator.h"
#include "SettingsKeys.h"
#include "UiText.h"
#include "UnitChoiceValidator.h"
#include "utils/CLocaleNumbers.h"
#include "utils/HFHelper.h"

namespace
{
const int kImageControls[] = {ID_ORIGINALSIZE_RADIO, ID_CUSTOMSIZE_RADIO, ID_CONSTRAIN_CHECK,
                              ID_WIDTH_RADIO,        ID_WIDTH_TEXT,       ID_WIDTH_UNIT_COMBO,
                              ID_HEIGHT_RADIO,       ID_HEIGHT_TEXT,      ID_HEIGHT_UNIT_COMBO,
                              ID_AUTOSCALE_RADIO,    ID_FITTOPAGE_RADIO,  ID_SHRINKTOFIT_RADIO,
                              ID_SCALETOPRINT_CHECK};

wxString InchText()
{
    return TranslateUiText(UnitWord(UNIT_INCH));
}
} // namespace

ImageSizePanelWithoutMerge::ImageSizePanelWithoutMerge(wxWindow* parent, bool enabled,
                                                       bool secondFlag)
    : PageSizePanelWithoutMerge(parent, enabled, secondFlag), m_bImageSectionEnabled(enabled),
      m_bImageSecondFlag(secondFlag), m_strWidth(DefaultOriginalDimension(true)),
      m_strHeight(DefaultOriginalDimension(true)), m_strWidthUnit(InchText()),
      m_strHeightUnit(InchText())
{
    using Self = ImageSizePanelWithoutMerge;
    Bind(wxEVT_RADIOBUTTON, &Self::OnRadioOriginalSize, this, ID_ORIGINALSIZE_RADIO);
    Bind(wxEVT_RADIOBUTTON, &Self::OnRadioCustomSize, this, ID_CUSTOMSIZE_RADIO);
    Bind(wxEVT_RADIOBUTTON, &Self::OnRadioAutoScale, this, ID_AUTOSCALE_RADIO);
    Bind(wxEVT_CHECKBOX, &Self::OnCheckConstrain, this, ID_CONSTRAIN_CHECK);
    Bind(wxEVT_RADIOBUTTON, &Self::OnRadioWidth, this, ID_WIDTH_RADIO);
    Bind(wxEVT_RADIOBUTTON, &Self::OnRadioHeight, this, ID_HEIGHT_RADIO);
    Bind(wxEVT_RADIOBUTTON, &Self::OnRadioFitToPage, this, ID_FITTOPAGE_RADIO);
    Bind(wxEVT_RADIOBUTTON, &Self::OnRadioShrinkToFit, this, ID_SHRINKTOFIT_RADIO);
    Bind(wxEVT_CHECKBOX, &Self::OnCheckScaleToPrint, this, ID_SCALETOPRINT_CHECK);
    Bind(wxEVT_TEXT, &Self::OnWidthText, this, ID_WIDTH_TEXT);
    Bind(wxEVT_TEXT, &Self::OnHeightText, this, ID_HEIGHT_TEXT);
    Bind(wxEVT_COMBOBOX, &Self::OnWidthUnit, this, ID_WIDTH_UNIT_COMBO);
    Bind(wxEVT_COMBOBOX, &Self::OnHeightUnit, this, ID_HEIGHT_UNIT_COMBO);
}

void ImageSizePanelWithoutMerge::SetMeasurementUnit(const wxString& preferredUnit,
                                                    const wxString& systemUnit)
{
    m_strMeasurementUnit =
        preferredUnit.IsSameAs(UnitWord(UNIT_POINT), false) ? systemUnit : preferredUnit;
}

void ImageSizePanelWithoutMerge::SetDecimalSeparator(wxString& separator)
{
    if (separator.empty())
        separator = wxLocale::GetInfo(wxLOCALE_DECIMAL_POINT, wxLOCALE_CAT_NUMBER);
    m_strDecimalSeparator = separator;
}

void ImageSizePanelWithoutMerge::FormatDataAsPerDecimalSeparator(wxString& text,
                                                                 bool toStorage) const
{
    text = ExchangeDecimalSeparator(text, m_strDecimalSeparator, toStorage);
}

bool ImageSizePanelWithoutMerge::InitializeControls()
{
    if (!m_bImageSectionEnabled)
        return true;
    PageSizePanelWithoutMerge::InitializeControls();

    wxString separator = HFHelper::GetDecimalSeparatorFromAppLang();
    SetDecimalSeparator(separator);

    auto bind = [this](int id, const wxValidator& validator)
    {
        if (wxWindow* control = FindWindow(id))
            control->SetValidator(validator);
    };
    bind(ID_ORIGINALSIZE_RADIO, wxGenericValidator(&m_bOriginalSize));
    bind(ID_CUSTOMSIZE_RADIO, wxGenericValidator(&m_bCustomSize));
    bind(ID_CONSTRAIN_CHECK, wxGenericValidator(&m_bConstrain));
    bind(ID_WIDTH_RADIO, wxGenericValidator(&m_bWidthDrives));
    bind(ID_HEIGHT_RADIO, wxGenericValidator(&m_bHeightDrives));
    bind(ID_WIDTH_TEXT, NumericValidator(&m_strWidth, m_strDecimalSeparator));
    bind(ID_HEIGHT_TEXT, NumericValidator(&m_strHeight, m_strDecimalSeparator));
    bind(ID_WIDTH_UNIT_COMBO, UnitChoiceValidator(&m_strWidthUnit));
    bind(ID_HEIGHT_UNIT_COMBO, UnitChoiceValidator(&m_strHeightUnit));
    bind(ID_AUTOSCALE_RADIO, wxGenericValidator(&m_bAutoScale));
    bind(ID_FITTOPAGE_RADIO, wxGenericValidator(&m_bFitToPage));
    bind(ID_SHRINKTOFIT_RADIO, wxGenericValidator(&m_bShrinkToFit));
    bind(ID_SCALETOPRINT_CHECK, wxGenericValidator(&m_bScaleToPrint));
    return true;
}

void ImageSizePanelWithoutMerge::EnableControls(const EnableRequests& requests)
{
    for (const auto& request : requests)
        if (wxWindow* control = FindWindow(request.first))
            control->Enable(request.second);
}

void ImageSizePanelWithoutMerge::TransferImageControlsToWindow()
{
    // Only this section's controls: the paper combo may hold a choice that
    // has not been read back yet.
    for (int id : kImageControls)
        if (wxWindow* control = FindWindow(id))
            if (wxValidator* validator = control->GetValidator())
                validator->TransferToWindow();
}

void ImageSizePanelWithoutMerge::HandleCustomSizeSelection(bool enable, bool widthDrives,
                                                           bool heightDrives)
{
    EnableRequests requests;
    CustomSizeSelectionRule(requests, enable, widthDrives, heightDrives);
    EnableControls(requests);
}

void ImageSizePanelWithoutMerge::HandleConstrainSelection(bool on)
{
    EnableRequests requests;
    ConstrainSelectionRule(requests, on, m_bCustomSize, m_bWidthDrives, m_bHeightDrives);
    EnableControls(requests);
}

void ImageSizePanelWithoutMerge::HandleAutoScaleSelection(bool on)
{
    EnableRequests requests;
    AutoScaleSelectionRule(requests, on);
    EnableControls(requests);
}

void ImageSizePanelWithoutMerge::HandleOnRadioWidthHeight(bool width)
{
    EnableRequests requests;
    WidthHeightRule(requests, width);
    EnableControls(requests);
    if (auto* field = wxDynamicCast(FindWindow(width ? ID_WIDTH_TEXT : ID_HEIGHT_TEXT), wxTextCtrl))
    {
        field->SetFocus();
        field->SelectAll();
    }
}

void ImageSizePanelWithoutMerge::OnRadioOriginalSize(wxCommandEvent&)
{
    m_bOriginalSize = true;
    m_bCustomSize = m_bAutoScale = false;
    HandleCustomSizeSelection(false, m_bWidthDrives, m_bHeightDrives);
    HandleAutoScaleSelection(false);
    TransferImageControlsToWindow();
}

void ImageSizePanelWithoutMerge::OnRadioCustomSize(wxCommandEvent&)
{
    m_bCustomSize = true;
    m_bOriginalSize = m_bAutoScale = false;
    HandleCustomSizeSelection(true, m_bWidthDrives, m_bHeightDrives);
    HandleConstrainSelection(m_bConstrain);
    HandleAutoScaleSelection(false);
    TransferImageControlsToWindow();
}

void ImageSizePanelWithoutMerge::OnRadioAutoScale(wxCommandEvent& event)
{
    m_bOriginalSize = m_bCustomSize = false;
    m_bAutoScale = event.IsChecked();
    HandleCustomSizeSelection(false, m_bWidthDrives, m_bHeightDrives);
    HandleAutoScaleSelection(m_bAutoScale);
    TransferImageControlsToWindow();
}

void ImageSizePanelWithoutMerge::OnCheckConstrain(wxCommandEvent&)
{
    m_bConstrain = !m_bConstrain;
    HandleConstrainSelection(m_bConstrain);
}

void ImageSizePanelWithoutMerge::OnRadioWidth(wxCommandEvent& event)
{
    m_bWidthDrives = event.IsChecked();
    m_bHeightDrives = !m_bWidthDrives;
    HandleOnRadioWidthHeight(m_bWidthDrives);
}

void ImageSizePanelWithoutMerge::OnRadioHeight(wxCommandEvent& event)
{
    m_bHeightDrives = event.IsChecked();
    m_bWidthDrives = !m_bHeightDrives;
    HandleOnRadioWidthHeight(m_bWidthDrives);
}

void ImageSizePanelWithoutMerge::OnRadioFitToPage(wxCommandEvent& event)
{
    m_bFitToPage = event.IsChecked();
    m_bShrinkToFit = !m_bFitToPage;
}

void ImageSizePanelWithoutMerge::OnRadioShrinkToFit(wxCommandEvent& event)
{
    m_bShrinkToFit = event.IsChecked();
    m_bFitToPage = !m_bShrinkToFit;
}

void ImageSizePanelWithoutMerge::OnCheckScaleToPrint(wxCommandEvent& event)
{
    m_bScaleToPrint = event.IsChecked();
}

void ImageSizePanelWithoutMerge::OnWidthText(wxCommandEvent& event)
{
    m_strWidth = event.GetString();
}

void ImageSizePanelWithoutMerge::OnHeightText(wxCommandEvent& event)
{
    m_strHeight = event.GetString();
}

void ImageSizePanelWithoutMerge::OnWidthUnit(wxCommandEvent&)
{
    ChangeFieldUnit(ID_WIDTH_UNIT_COMBO, ID_WIDTH_TEXT, m_strWidthUnit, m_strWidth);
}

void ImageSizePanelWithoutMerge::OnHeightUnit(wxCommandEvent&)
{
    ChangeFieldUnit(ID_HEIGHT_UNIT_COMBO, ID_HEIGHT_TEXT, m_strHeightUnit, m_strHeight);
}

void ImageSizePanelWithoutMerge::ChangeFieldUnit(int comboId, int textId, wxString& unitText,
                                                 wxString& valueText)
{
    auto* combo = wxDynamicCast(FindWindow(comboId), wxComboBox);
    auto* field = wxDynamicCast(FindWindow(textId), wxTextCtrl);
    if (!combo || !field)
        return;
    unitText = combo->GetStringSelection();
    wxString plain = field->GetValue();
    FormatDataAsPerDecimalSeparator(plain, true);
    double value = utils::StrToDoubleC(plain);
    if (unitText != InchText())
        convertToUnit(value, UNIT_INCH, UNIT_MM);
    else
        convertToUnit(value, UNIT_MM, UNIT_INCH);
    valueText = utils::FormatFixedC(value, 4);
    FormatDataAsPerDecimalSeparator(valueText, false);
    field->ChangeValue(valueText);
    field->SetFocus();
}

bool ImageSizePanelWithoutMerge::ValidateAndSetData(double value, const wxString& unit,
                                                    wxString& resetText, wxTextCtrl* field)
{
    const ImageDimensionCheck check = CheckImageDimension(value, unit);
    if (check.valid)
        return true;
    resetText = check.resetText;

    wxString message =
        TranslateUiText("An integer between [HF3Range] is required for [HF3Parameter]");
    wxArrayString placeholders, replacements;
    placeholders.Add("[HF3Range]");
    placeholders.Add("[HF3Parameter]");
    replacements.Add(check.rangeText);
    replacements.Add(TranslateUiText("Width") + " / " + TranslateUiText("Height"));
    ReplacePlaceHolderString(message, placeholders, replacements);
    wxMessageBox(message, wxMessageBoxCaptionStr, wxOK | wxCENTRE, this);

    if (field)
    {
        field->SetValue(resetText);
        field->SetFocus();
        field->SelectAll();
    }
    return false;
}

bool ImageSizePanelWithoutMerge::ValidateData()
{
    if (!m_bCustomSize)
        return true;
    auto check = [this](const wxString& text, const wxString& unit, int fieldId)
    {
        wxString plain = text;
        FormatDataAsPerDecimalSeparator(plain, true);
        wxString reset;
        return ValidateAndSetData(utils::StrToDoubleC(plain), unit, reset,
                                  wxDynamicCast(FindWindow(fieldId), wxTextCtrl));
    };
    if (m_bConstrain)
    {
        if (m_bWidthDrives)
            return check(m_strWidth, m_strWidthUnit, ID_WIDTH_TEXT);
        if (m_bHeightDrives)
            return check(m_strHeight, m_strHeightUnit, ID_HEIGHT_TEXT);
        return true;
    }
    return check(m_strWidth, m_strWidthUnit, ID_WIDTH_TEXT) &&
           check(m_strHeight, m_strHeightUnit, ID_HEIGHT_TEXT);
}

bool ImageSizePanelWithoutMerge::SaveUISettings(MapPropToValue& settings)
{
    if (!m_bImageSectionEnabled)
        return true;
    PageSizePanelWithoutMerge::SaveUISettings(settings);
    using namespace SettingsKeys;
    settings[ORIGINALSIZE] = FormatSettingFlag(m_bOriginalSize);
    settings[CUSTOMSIZE] = FormatSettingFlag(m_bCustomSize);
    settings[CONTRAINPROPORTION] = FormatSettingFlag(m_bConstrain);
    settings[ORIGINALWIDTHOPTION] = FormatSettingFlag(m_bWidthDrives);
    settings[ORIGINALHEIGHTOPTION] = FormatSettingFlag(m_bHeightDrives);

    wxString width = m_strWidth, height = m_strHeight;
    FormatDataAsPerDecimalSeparator(width, true);
    FormatDataAsPerDecimalSeparator(height, true);
    settings[ORIGINALWIDTH] = width;
    settings[ORIGINALWIDTHUNIT] = m_strWidthUnit;
    settings[ORIGINALHEIGHT] = height;
    settings[ORIGINALHEIGHTUNIT] = m_strHeightUnit;

    settings[FORCEAUTOSCALE] = FormatSettingFlag(m_bAutoScale);
    settings[FITTOPAGE] = FormatSettingFlag(m_bFitToPage);
    settings[SHRINKTOFIT] = FormatSettingFlag(m_bShrinkToFit);
    settings[SCALETOPRINT] = FormatSettingFlag(m_bScaleToPrint);
    // Written before the check on purpose: a refused save keeps what was typed.
    return ValidateData();
}

bool ImageSizePanelWithoutMerge::LoadUISettings(MapPropToValue& settings)
{
    if (!m_bImageSectionEnabled)
        return true;
    using namespace SettingsKeys;
    namespace Defaults = SettingsDefaults;
    m_bOriginalSize = ReadSettingFlag(settings, ORIGINALSIZE, Defaults::ORIGINALSIZE);
    m_bCustomSize = ReadSettingFlag(settings, CUSTOMSIZE, Defaults::CUSTOMSIZE);
    m_bConstrain = ReadSettingFlag(settings, CONTRAINPROPORTION, Defaults::CONTRAINPROPORTION);
    m_bAutoScale = ReadSettingFlag(settings, FORCEAUTOSCALE, Defaults::FORCEAUTOSCALE);
    m_bFitToPage = ReadSettingFlag(settings, FITTOPAGE, Defaults::FITTOPAGE);
    m_bShrinkToFit = ReadSettingFlag(settings, SHRINKTOFIT, Defaults::SHRINKTOFIT);
    m_bScaleToPrint = ReadSettingFlag(settings, SCALETOPRINT, Defaults::SCALETOPRINT);
    m_bWidthDrives = ReadSettingFlag(settings, ORIGINALWIDTHOPTION, Defaults::ORIGINALWIDTHOPTION);
    m_bHeightDrives =
        ReadSettingFlag(settings, ORIGINALHEIGHTOPTION, Defaults::ORIGINALHEIGHTOPTION);

    const wxString inch = InchText();
    auto loadDimension =
        [&](bool drives, const char* unitKey, const char* valueKey, wxString& unit, wxString& value)
    {
        // A server that names no unit leaves the fields without one (and
        // without a range check).
        unit = m_strMeasurementUnit.empty() ? wxString() : TranslateUiText(m_strMeasurementUnit);
        const wxString storedUnit = settings[unitKey];
        if ((!m_bConstrain || drives) && !storedUnit.empty())
            unit = storedUnit;
        const wxString storedValue = settings[valueKey];
        value = !storedValue.empty() ? storedValue : DefaultOriginalDimension(unit == inch);
        FormatDataAsPerDecimalSeparator(value, false);
    };
    loadDimension(m_bWidthDrives, ORIGINALWIDTHUNIT, ORIGINALWIDTH, m_strWidthUnit, m_strWidth);
    loadDimension(m_bHeightDrives, ORIGINALHEIGHTUNIT, ORIGINALHEIGHT, m_strHeightUnit,
                  m_strHeight);

    HandleCustomSizeSelection(m_bCustomSize, m_bWidthDrives, m_bHeightDrives);
    if (m_bCustomSize)
        HandleConstrainSelection(m_bConstrain);
    HandleAutoScaleSelection(m_bAutoScale);
    TransferDataToWindow();
    return PageSizePanelWithoutMerge::LoadUISettings(settings);
}
