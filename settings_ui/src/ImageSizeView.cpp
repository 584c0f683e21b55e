#include <wx/checkbox.h>
#include <wx/combobox.h>
#include <wx/radiobut.h>
#include <wx/sizer.h>
#include <wx/statbox.h>

#include "ControlIds.h"
#include "CustomTextCtrl.h"
#include "PanelTheme.h"
#include "SettingsViews.h"
#include "UiText.h"
#include "Units.h"

namespace
{
wxComboBox* CreateUnitCombo(wxWindow* parent, int id)
{
    wxArrayString units;
    units.Add(TranslateUiText(UnitWord(UNIT_INCH)));
    units.Add(TranslateUiText(UnitWord(UNIT_MM)));
    return new wxComboBox(parent, id, wxEmptyString, wxDefaultPosition, wxDefaultSize, units,
                          wxCB_DROPDOWN | wxCB_READONLY);
}
} // namespace

wxSizer* CreateImageSizeView(wxWindow* parent, bool, bool)
{
    auto* box = new wxStaticBoxSizer(wxVERTICAL, parent, TranslateUiText("Image size"));
    ApplyDefaultTheme(box->GetStaticBox());

    // A radio button joins the group of the one created just before it, so
    // the three size choices are created together and "Auto-scale" is moved
    // behind the dimension fields in the tab order afterwards.
    auto* original =
        new wxRadioButton(parent, ID_ORIGINALSIZE_RADIO, TranslateUiText("Original Size"),
                          wxDefaultPosition, wxDefaultSize, wxRB_GROUP);
    auto* custom = new wxRadioButton(parent, ID_CUSTOMSIZE_RADIO, TranslateUiText("Custom Size"));
    auto* autoScale = new wxRadioButton(parent, ID_AUTOSCALE_RADIO, TranslateUiText("Auto-scale"));

    auto* constrain =
        new wxCheckBox(parent, ID_CONSTRAIN_CHECK, TranslateUiText("Constrain Proportions"));
    auto* widthRadio = new wxRadioButton(parent, ID_WIDTH_RADIO, TranslateUiText("Width:"),
                                         wxDefaultPosition, wxDefaultSize, wxRB_GROUP);
    auto* width = new CustomTextCtrl(parent, ID_WIDTH_TEXT, TranslateUiText("Original Width"));
    auto* widthUnit = CreateUnitCombo(parent, ID_WIDTH_UNIT_COMBO);
    auto* heightRadio = new wxRadioButton(parent, ID_HEIGHT_RADIO, TranslateUiText("Height:"));
    auto* height = new CustomTextCtrl(parent, ID_HEIGHT_TEXT);
    auto* heightUnit = CreateUnitCombo(parent, ID_HEIGHT_UNIT_COMBO);
    autoScale->MoveAfterInTabOrder(heightUnit);

    auto* fit = new wxRadioButton(parent, ID_FITTOPAGE_RADIO, TranslateUiText("Fit to page"),
                                  wxDefaultPosition, wxDefaultSize, wxRB_GROUP);
    auto* shrink =
        new wxRadioButton(parent, ID_SHRINKTOFIT_RADIO, TranslateUiText("Shrink to fit"));
    auto* printable = new wxCheckBox(parent, ID_SCALETOPRINT_CHECK,
                                     TranslateUiText("Scale to printable area only"));

    const int indent = 20;
    box->Add(original, 0, wxALL, 3);
    box->Add(custom, 0, wxALL, 3);
    box->Add(constrain, 0, wxLEFT | wxTOP | wxBOTTOM, indent / 2 + 3);

    auto* dimensions = new wxFlexGridSizer(3, 5, 5);
    dimensions->AddGrowableCol(1);
    dimensions->Add(widthRadio, 0, wxALIGN_CENTER_VERTICAL);
    dimensions->Add(width, 1, wxEXPAND);
    dimensions->Add(widthUnit, 0, wxALIGN_CENTER_VERTICAL);
    dimensions->Add(heightRadio, 0, wxALIGN_CENTER_VERTICAL);
    dimensions->Add(height, 1, wxEXPAND);
    dimensions->Add(heightUnit, 0, wxALIGN_CENTER_VERTICAL);
    box->Add(dimensions, 0, wxEXPAND | wxLEFT | wxRIGHT, indent);

    box->Add(autoScale, 0, wxALL, 3);
    auto* scaling = new wxBoxSizer(wxHORIZONTAL);
    scaling->Add(fit, 0, wxRIGHT, 10);
    scaling->Add(shrink, 0);
    box->Add(scaling, 0, wxLEFT | wxRIGHT, indent);
    box->Add(printable, 0, wxLEFT | wxTOP | wxBOTTOM, indent);
    return box;
}
