#pragma once
#include <wx/bitmap.h>
#include <wx/window.h>

#include "preview/PagePreview.h"

// Draws a rendered page scaled into the window: the page, its outline, the
// printer's imageable area (dashed) and where the marks are; or, when there
// is no page, the reason in words.
class PreviewCanvas : public wxWindow
{
public:
    explicit PreviewCanvas(wxWindow* parent);

    void ShowPage(const PagePreview& preview);
    void ShowMessage(const wxString& message);
    const PagePreview& Page() const { return m_preview; }

    // The whole picture as drawn at this size.
    wxBitmap Render(const wxSize& size) const;
    // Where a rectangle in points lands in a picture of this size; empty
    // when no page is shown.
    wxRect PixelsOf(const PointRect& rect, const wxSize& size) const;

private:
    struct Placement
    {
        double left = 0, top = 0, scale = 0; // pixels per point
    };
    Placement PlacePage(const wxSize& size) const;
    void Draw(wxDC& dc, const wxSize& size) const;
    void OnPaint(wxPaintEvent&);

    PagePreview m_preview;
    wxString m_message;
};
