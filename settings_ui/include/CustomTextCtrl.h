#pragma once
#include <wx/textctrl.h>

// Text field of the image size view. Losing the focus checks nothing: the
// values are checked when the panel is saved, not when the user tabs away.
class CustomTextCtrl : public wxTextCtrl
{
public:
    CustomTextCtrl(wxWindow* parent, wxWindowID id, const wxString& value = wxEmptyString,
                   const wxPoint& pos = wxDefaultPosition, const wxSize& size = wxDefaultSize,
                   long style = 0);

private:
    // Passed on, so the toolkit's own focus handling (caret, selection) runs.
    void OnKillFocus(wxFocusEvent& event) { event.Skip(); }
};
