#include "CustomTextCtrl.h"

CustomTextCtrl::CustomTextCtrl(wxWindow* parent, wxWindowID id, const wxString& value,
                               const wxPoint& pos, const wxSize& size, long style)
    : wxTextCtrl(parent, id, value, pos, size, style)
{
    Bind(wxEVT_KILL_FOCUS, &CustomTextCtrl::OnKillFocus, this);
}
