#include <wx/sizer.h>
#include <wx/statbox.h>
#include <wx/stattext.h>

#include "ControlIds.h"
#include "PanelTheme.h"
#include "SettingsViews.h"
#include "UiText.h"

wxSizer* CreateInputFileTypeView(wxWindow* parent, bool, bool, const wxString& extension)
{
    auto* box = new wxStaticBoxSizer(wxHORIZONTAL, parent, TranslateUiText("Input file type"));
    ApplyDefaultTheme(box->GetStaticBox());
    box->Add(new wxStaticText(parent, ID_INPUT_FILETYPE_LABEL, TranslateUiText("File extension:")),
             0, wxALL | wxALIGN_CENTER_VERTICAL, 5);
    box->Add(new wxStaticText(parent, ID_INPUT_FILETYPE_TEXT, extension), 0,
             wxALL | wxALIGN_CENTER_VERTICAL, 5);
    return box;
}
