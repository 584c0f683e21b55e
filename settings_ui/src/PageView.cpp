#include <wx/button.h>
#include <wx/combobox.h>
#include <wx/sizer.h>
#include <wx/statbox.h>
#include <wx/stattext.h>

#include "ControlIds.h"
#include "PanelTheme.h"
#include "SettingsKeys.h"
#include "SettingsViews.h"
#include "UiText.h"

wxSizer* CreatePageViewEPS(wxWindow* parent, bool, bool)
{
    auto* box = new wxStaticBoxSizer(wxVERTICAL, parent, TranslateUiText("Page"));
    ApplyDefaultTheme(box->GetStaticBox());
    auto* grid = new wxFlexGridSizer(3, 5, 10);
    // Paper names can be long: the lists take the width the section has.
    grid->AddGrowableCol(1);

    grid->Add(new wxStaticText(parent, ID_PAGESIZE_LABEL, TranslateUiText("Size:")), 0,
              wxALIGN_CENTER_VERTICAL);
    grid->Add(new wxComboBox(parent, ID_PAGESIZE_COMBO, wxEmptyString, wxDefaultPosition,
                             wxSize(150, -1), 0, nullptr, wxCB_DROPDOWN | wxCB_READONLY),
              0, wxEXPAND);
    grid->Add(new wxButton(parent, ID_CUSTOMPAGESIZE_BUTTON, TranslateUiText("Custom...")), 0,
              wxALIGN_CENTER_VERTICAL);

    grid->Add(new wxStaticText(parent, ID_IMAGEPOSITION_LABEL, TranslateUiText("Image position:")),
              0, wxALIGN_CENTER_VERTICAL);
    wxArrayString positions;
    for (const char* position : kImagePositionWords)
        positions.Add(TranslateUiText(position));
    grid->Add(new wxComboBox(parent, ID_IMAGEPOSITION_COMBO, wxEmptyString, wxDefaultPosition,
                             wxDefaultSize, positions, wxCB_DROPDOWN | wxCB_READONLY),
              0, wxEXPAND);
    grid->AddSpacer(0);

    box->Add(grid, 0, wxEXPAND | wxALL, 5);
    return box;
}
