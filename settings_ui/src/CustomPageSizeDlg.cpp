#include "CustomPageSizeDlg.h"

#include <wx/button.h>
#include <wx/intl.h>
#include <wx/msgdlg.h>
#include <wx/radiobut.h>
#include <wx/sizer.h>
#include <wx/statbox.h>
#include <wx/stattext.h>
#include <wx/textctrl.h>

#include "ControlIds.h"
#include "SizeKeystrokeFilter.h"
#include "UiText.h"
#include "utils/CLocaleNumbers.h"

namespace
{
double RoundToShown(double value)
{
    return utils::StrToDoubleC(utils::FormatFixedC(value, 2));
}

bool Within(double value, double minimum, double maximum)
{
    return value >= minimum && value <= maximum;
}
} // namespace

CustomPageSizeDlg::CustomPageSizeDlg(wxWindow* parent, wxWindowID id, const wxString& title,
                                     double minWidth, double maxWidth, double minHeight,
                                     double maxHeight, double width, double height, Unit_t unit,
                                     bool& heightIsLength)
    : wxDialog(parent, id, title), m_dWidth(width), m_dHeight(height), m_dMaxWidth(maxWidth),
      m_dMaxHeight(maxHeight), m_dMinWidth(minWidth), m_dMinHeight(minHeight), m_eUnit(unit),
      m_bHeightIsLength(heightIsLength)
{
    // The fields are typed and shown in the process locale's notation.
    m_strDecimalPoint = wxLocale::GetInfo(wxLOCALE_DECIMAL_POINT, wxLOCALE_CAT_NUMBER);
    if (m_strDecimalPoint.empty())
        m_strDecimalPoint = ".";

    if (!Within(m_dWidth, minWidth, maxWidth) || !Within(m_dHeight, minHeight, maxHeight))
    {
        double letterWidth = 612, letterHeight = 792;
        convertToUnit(letterWidth, UNIT_POINT, unit);
        convertToUnit(letterHeight, UNIT_POINT, unit);
        const bool letterFits =
            Within(letterWidth, minWidth, maxWidth) && Within(letterHeight, minHeight, maxHeight);
        m_dWidth = letterFits ? letterWidth : minWidth;
        m_dHeight = letterFits ? letterHeight : minHeight;
    }
    FormatValues();
    CreateControls();

    m_dWidthPoints = m_dWidth;
    m_dHeightPoints = m_dHeight;
    convertToUnit(m_dWidthPoints, m_eUnit, UNIT_POINT);
    convertToUnit(m_dHeightPoints, m_eUnit, UNIT_POINT);
    UpdateSizes(m_eUnit);
    m_strLastWidth = m_pWidthText->GetValue();
    m_strLastHeight = m_pHeightText->GetValue();

    const int unitRadio = m_eUnit == UNIT_MM      ? ID_CUSTOM_UNIT_MM
                          : m_eUnit == UNIT_POINT ? ID_CUSTOM_UNIT_POINT
                                                  : ID_CUSTOM_UNIT_INCH;
    if (auto* radio = wxDynamicCast(FindWindow(unitRadio), wxRadioButton))
        radio->SetValue(true);
}

void CustomPageSizeDlg::CreateControls()
{
    auto* grid = new wxFlexGridSizer(3, 5, 5);
    grid->AddGrowableCol(1);
    grid->Add(new wxStaticText(this, ID_CUSTOM_WIDTH_LABEL, TranslateUiText("Width:")), 0,
              wxALIGN_CENTER_VERTICAL | wxALIGN_RIGHT);
    m_pWidthText = new wxTextCtrl(this, ID_CUSTOM_WIDTH_TEXT);
    grid->Add(m_pWidthText, 1, wxEXPAND);
    m_pWidthRange = new wxStaticText(this, ID_CUSTOM_WIDTH_RANGE, "(0.01 - 13.00)              ");
    grid->Add(m_pWidthRange, 0, wxALIGN_CENTER_VERTICAL);

    const wxString heightLabel = m_bHeightIsLength ? "Length:" : "Height:";
    grid->Add(new wxStaticText(this, ID_CUSTOM_HEIGHT_LABEL, TranslateUiText(heightLabel)), 0,
              wxALIGN_CENTER_VERTICAL | wxALIGN_RIGHT);
    m_pHeightText = new wxTextCtrl(this, ID_CUSTOM_HEIGHT_TEXT);
    grid->Add(m_pHeightText, 1, wxEXPAND);
    m_pHeightRange = new wxStaticText(this, ID_CUSTOM_HEIGHT_RANGE, "(0.01 - 19.00)              ");
    grid->Add(m_pHeightRange, 0, wxALIGN_CENTER_VERTICAL);

    auto* units = new wxStaticBoxSizer(wxHORIZONTAL, this, TranslateUiText("Units"));
    units->Add(new wxRadioButton(units->GetStaticBox(), ID_CUSTOM_UNIT_INCH,
                                 TranslateUiText(UnitWord(UNIT_INCH)), wxDefaultPosition,
                                 wxDefaultSize, wxRB_GROUP),
               0, wxALL, 5);
    units->Add(new wxRadioButton(units->GetStaticBox(), ID_CUSTOM_UNIT_MM,
                                 TranslateUiText(UnitWord(UNIT_MM))),
               0, wxALL, 5);
    units->Add(new wxRadioButton(units->GetStaticBox(), ID_CUSTOM_UNIT_POINT,
                                 TranslateUiText(UnitWord(UNIT_POINT))),
               0, wxALL, 5);

    // Stock buttons: OK is the default (Enter) and Cancel answers Escape.
    auto* buttons = new wxStdDialogButtonSizer();
    buttons->AddButton(new wxButton(this, wxID_OK, TranslateUiText("OK")));
    buttons->AddButton(new wxButton(this, wxID_CANCEL, TranslateUiText("Cancel")));
    buttons->Realize();
    static_cast<wxButton*>(FindWindow(wxID_OK))->SetDefault();
    m_pWidthText->SetFocus();

    auto* top = new wxBoxSizer(wxVERTICAL);
    top->Add(grid, 0, wxEXPAND | wxALL, 10);
    top->Add(units, 0, wxEXPAND | wxLEFT | wxRIGHT, 10);
    top->Add(buttons, 0, wxEXPAND | wxALL, 10);
    SetSizerAndFit(top);

    Bind(wxEVT_RADIOBUTTON, &CustomPageSizeDlg::OnRadioInch, this, ID_CUSTOM_UNIT_INCH);
    Bind(wxEVT_RADIOBUTTON, &CustomPageSizeDlg::OnRadioMM, this, ID_CUSTOM_UNIT_MM);
    Bind(wxEVT_RADIOBUTTON, &CustomPageSizeDlg::OnRadioPoint, this, ID_CUSTOM_UNIT_POINT);
    Bind(wxEVT_TEXT, &CustomPageSizeDlg::OnCustomWidth, this, ID_CUSTOM_WIDTH_TEXT);
    Bind(wxEVT_TEXT, &CustomPageSizeDlg::OnCustomHeight, this, ID_CUSTOM_HEIGHT_TEXT);
    Bind(wxEVT_BUTTON, &CustomPageSizeDlg::OnOK, this, wxID_OK);
}

void CustomPageSizeDlg::SetPageSizes(double width, double height, Unit_t unit)
{
    m_dWidth = width;
    m_dHeight = height;
    m_eUnit = unit;
}

void CustomPageSizeDlg::GetPageSizes(double& width, double& height, Unit_t& unit) const
{
    width = m_dWidth;
    height = m_dHeight;
    unit = m_eUnit;
}

wxString CustomPageSizeDlg::ShownNumber(double value) const
{
    wxString text = utils::FormatFixedC(value, 2);
    if (m_strDecimalPoint != ".")
        text.Replace(".", m_strDecimalPoint);
    return text;
}

void CustomPageSizeDlg::FormatValues()
{
    m_dMinWidth = RoundToShown(m_dMinWidth);
    m_dMaxWidth = RoundToShown(m_dMaxWidth);
    m_dMinHeight = RoundToShown(m_dMinHeight);
    m_dMaxHeight = RoundToShown(m_dMaxHeight);
}

void CustomPageSizeDlg::UpdateSizes(Unit_t previousUnit)
{
    m_dWidth = m_dWidthPoints;
    m_dHeight = m_dHeightPoints;
    convertToUnit(m_dWidth, UNIT_POINT, m_eUnit);
    convertToUnit(m_dHeight, UNIT_POINT, m_eUnit);
    // ChangeValue: showing a number is not a keystroke.
    m_pWidthText->ChangeValue(ShownNumber(m_dWidth));
    m_pHeightText->ChangeValue(ShownNumber(m_dHeight));

    for (double* limit : {&m_dMinWidth, &m_dMaxWidth, &m_dMinHeight, &m_dMaxHeight})
        convertToUnit(*limit, previousUnit, m_eUnit);
    FormatValues();
    m_pWidthRange->SetLabel(
        wxString::Format("(%s - %s)", ShownNumber(m_dMinWidth), ShownNumber(m_dMaxWidth)));
    m_pHeightRange->SetLabel(
        wxString::Format("(%s - %s)", ShownNumber(m_dMinHeight), ShownNumber(m_dMaxHeight)));
    m_strLastWidth = m_pWidthText->GetValue();
    m_strLastHeight = m_pHeightText->GetValue();
}

void CustomPageSizeDlg::SwitchUnit(Unit_t unit)
{
    const Unit_t previous = m_eUnit;
    m_eUnit = unit;
    UpdateSizes(previous);
}

void CustomPageSizeDlg::OnRadioInch(wxCommandEvent&)
{
    SwitchUnit(UNIT_INCH);
}
void CustomPageSizeDlg::OnRadioMM(wxCommandEvent&)
{
    SwitchUnit(UNIT_MM);
}
void CustomPageSizeDlg::OnRadioPoint(wxCommandEvent&)
{
    SwitchUnit(UNIT_POINT);
}

void CustomPageSizeDlg::OnCustomWidth(wxCommandEvent&)
{
    HandleKeystroke(m_pWidthText, m_dMaxWidth, m_strLastWidth, m_dWidthPoints);
}

void CustomPageSizeDlg::OnCustomHeight(wxCommandEvent&)
{
    HandleKeystroke(m_pHeightText, m_dMaxHeight, m_strLastHeight, m_dHeightPoints);
}

void CustomPageSizeDlg::HandleKeystroke(wxTextCtrl* field, double maximum, wxString& lastAccepted,
                                        double& points)
{
    const SizeKeystrokeResult result = FilterSizeKeystroke(
        field->GetValue(), field->GetInsertionPoint(), m_strDecimalPoint, maximum, lastAccepted);
    lastAccepted = result.lastAccepted;
    if (result.changed)
    {
        field->ChangeValue(result.text);
        field->SetInsertionPoint(result.insertion);
    }
    points = ParseSizeField(field->GetValue(), m_strDecimalPoint);
    convertToUnit(points, m_eUnit, UNIT_POINT);
}

bool CustomPageSizeDlg::MinMaxDoubleEx(double value, double minimum, double maximum, int dimension)
{
    const wxString parameter = dimension == 0 ? "Width" : m_bHeightIsLength ? "Length" : "Height";
    if (value < 0.1 || value > maximum)
    {
        wxString message =
            TranslateUiText("An integer between [HF3Range] is required for [HF3Parameter]");
        wxArrayString placeholders, replacements;
        placeholders.Add("[HF3Range]");
        placeholders.Add("[HF3Parameter]");
        replacements.Add(utils::FormatFixedC(minimum, 2) + "-" + utils::FormatFixedC(maximum, 2));
        replacements.Add(TranslateUiText(parameter));
        ReplacePlaceHolderString(message, placeholders, replacements);
        wxMessageBox(message, wxMessageBoxCaptionStr, wxOK | wxICON_INFORMATION | wxSTAY_ON_TOP,
                     this);
        return false;
    }
    if (value < minimum)
    {
        wxString warning = TranslateUiText(
            "The page size (PlaceHolder) selected is smaller than the engine supports for "
            "printing. However this page size may be used for imposition, or in conjunction "
            "with a larger sheet size chosen in job properties.");
        warning.Replace("PlaceHolder", TranslateUiText(parameter), false);
        wxMessageBox(warning, TranslateUiText("Warning"), wxOK | wxICON_INFORMATION | wxSTAY_ON_TOP,
                     this);
    }
    return true;
}

bool CustomPageSizeDlg::AcceptSizes()
{
    UpdateSizes(m_eUnit);
    if (!MinMaxDoubleEx(m_dWidth, m_dMinWidth, m_dMaxWidth, 0))
        return false;
    if (!MinMaxDoubleEx(m_dHeight, m_dMinHeight, m_dMaxHeight, 1))
        return false;
    return Validate() && TransferDataFromWindow();
}

void CustomPageSizeDlg::OnOK(wxCommandEvent&)
{
    if (AcceptSizes())
        EndModal(wxID_OK);
}
