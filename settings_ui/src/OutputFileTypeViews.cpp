#include <wx/radiobut.h>
#include <wx/sizer.h>
#include <wx/statbox.h>

#include "ControlIds.h"
#include "PanelTheme.h"
#include "SettingsViews.h"
#include "UiText.h"

namespace
{
wxSizer* CreateTwoChoiceView(wxWindow* parent, int firstId, const char* first, int secondId,
                             const char* second)
{
    auto* box = new wxStaticBoxSizer(wxHORIZONTAL, parent, TranslateUiText("Output file type"));
    ApplyDefaultTheme(box->GetStaticBox());
    box->Add(new wxRadioButton(parent, firstId, TranslateUiText(first), wxDefaultPosition,
                               wxDefaultSize, wxRB_GROUP),
             0, wxALL, 5);
    box->Add(new wxRadioButton(parent, secondId, TranslateUiText(second)), 0, wxALL, 5);
    return box;
}
} // namespace

wxSizer* CreateOutputFileTypeWithoutDistillMergeViewForEPS(wxWindow* parent, bool, bool)
{
    return CreateTwoChoiceView(parent, ID_OUTPUT_EPS_RADIO, "EPS", ID_OUTPUT_PS_RADIO, "PS");
}

wxSizer* CreateOutputFileTypeWithoutMergeView(wxWindow* parent, bool, bool)
{
    return CreateTwoChoiceView(parent, ID_OUTPUT_PS_RADIO, "PS", ID_OUTPUT_PDF_RADIO, "PDF");
}
