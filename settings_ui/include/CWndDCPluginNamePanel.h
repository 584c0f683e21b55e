#pragma once
#include <wx/panel.h>

class wxDC;

// The strip above the filter's settings that names the filter, drawn in the
// host's "HeaderView" theme.
class CWndDCPluginNamePanel : public wxPanel
{
public:
    CWndDCPluginNamePanel(wxWindow* parent, wxWindowID id);

    void SetName(const wxString& name) override;
    wxString GetName() const override { return m_strName; }
    // The strip's look on any device: its background, and the name in the
    // theme's colour and font.
    void Draw(wxDC& dc) const;

private:
    void OnPaint(wxPaintEvent& event);
    void OnEraseBackground(wxEraseEvent&) {} // painted whole in OnPaint; avoids flicker
    void OnSize(wxSizeEvent& event);

    wxString m_strName;
};
