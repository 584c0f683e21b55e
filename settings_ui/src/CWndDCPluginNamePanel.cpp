#include "CWndDCPluginNamePanel.h"

#include <wx/dcclient.h>

#include <hotfolder/Themer.h>

CWndDCPluginNamePanel::CWndDCPluginNamePanel(wxWindow* parent, wxWindowID id)
    : wxPanel(parent, id, wxDefaultPosition, wxSize(-1, 22), wxTAB_TRAVERSAL | wxNO_BORDER)
{
    const stTheme theme = Themer::GetThemeService()->GetTheme("HeaderView");
    if (theme.m_background.IsOk())
        SetBackgroundColour(theme.m_background);
    SetBackgroundStyle(wxBG_STYLE_PAINT);
    Bind(wxEVT_PAINT, &CWndDCPluginNamePanel::OnPaint, this);
    Bind(wxEVT_ERASE_BACKGROUND, &CWndDCPluginNamePanel::OnEraseBackground, this);
    Bind(wxEVT_SIZE, &CWndDCPluginNamePanel::OnSize, this);
}

void CWndDCPluginNamePanel::SetName(const wxString& name)
{
    m_strName = name;
    Refresh();
}

void CWndDCPluginNamePanel::OnPaint(wxPaintEvent&)
{
    wxPaintDC dc(this);
    Draw(dc);
}

void CWndDCPluginNamePanel::Draw(wxDC& dc) const
{
    dc.SetPen(*wxTRANSPARENT_PEN);
    dc.SetBrush(wxBrush(GetBackgroundColour()));
    dc.DrawRectangle(GetClientRect());

    const stTheme theme = Themer::GetThemeService()->GetTheme("HeaderView");
    if (theme.m_foreground.IsOk())
        dc.SetTextForeground(theme.m_foreground);
    if (theme.m_font.IsOk())
        dc.SetFont(theme.m_font);
    dc.DrawText(m_strName, 8, 4);
}

void CWndDCPluginNamePanel::OnSize(wxSizeEvent& event)
{
    Refresh();
    event.Skip();
}
