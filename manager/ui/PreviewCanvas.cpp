#include "ui/PreviewCanvas.h"

#include <algorithm>
#include <cmath>

#include <wx/dcbuffer.h>
#include <wx/dcmemory.h>
#include <wx/settings.h>

namespace
{
const int kMargin = 8;
}

PreviewCanvas::PreviewCanvas(wxWindow* parent)
    : wxWindow(parent, wxID_ANY, wxDefaultPosition, wxSize(320, 400), wxFULL_REPAINT_ON_RESIZE)
{
    SetBackgroundStyle(wxBG_STYLE_PAINT);
    Bind(wxEVT_PAINT, &PreviewCanvas::OnPaint, this);
}

void PreviewCanvas::ShowPage(const PagePreview& preview)
{
    m_preview = preview;
    m_message = preview.ok ? wxString() : preview.reason;
    Refresh();
}

void PreviewCanvas::ShowMessage(const wxString& message)
{
    m_preview = PagePreview();
    m_message = message;
    Refresh();
}

PreviewCanvas::Placement PreviewCanvas::PlacePage(const wxSize& size) const
{
    Placement place;
    if (!m_preview.ok || m_preview.pageWidth <= 0 || m_preview.pageHeight <= 0)
        return place;
    const double width = std::max(1, size.x - 2 * kMargin);
    const double height = std::max(1, size.y - 2 * kMargin);
    place.scale = std::min(width / m_preview.pageWidth, height / m_preview.pageHeight);
    place.left = (size.x - m_preview.pageWidth * place.scale) / 2;
    place.top = (size.y - m_preview.pageHeight * place.scale) / 2;
    return place;
}

wxRect PreviewCanvas::PixelsOf(const PointRect& rect, const wxSize& size) const
{
    const Placement place = PlacePage(size);
    if (place.scale <= 0 || rect.IsEmpty())
        return wxRect();
    const int x0 = static_cast<int>(std::lround(place.left + rect.x0 * place.scale));
    const int x1 = static_cast<int>(std::lround(place.left + rect.x1 * place.scale));
    // PostScript counts from the bottom, the screen from the top.
    const int y0 =
        static_cast<int>(std::lround(place.top + (m_preview.pageHeight - rect.y1) * place.scale));
    const int y1 =
        static_cast<int>(std::lround(place.top + (m_preview.pageHeight - rect.y0) * place.scale));
    return wxRect(wxPoint(x0, y0), wxPoint(x1 - 1, y1 - 1));
}

void PreviewCanvas::Draw(wxDC& dc, const wxSize& size) const
{
    dc.SetBackground(wxBrush(wxSystemSettings::GetColour(wxSYS_COLOUR_APPWORKSPACE)));
    dc.Clear();
    const Placement place = PlacePage(size);
    if (place.scale <= 0)
    {
        dc.SetTextForeground(wxSystemSettings::GetColour(wxSYS_COLOUR_WINDOWTEXT));
        wxRect area(wxPoint(kMargin, kMargin), size - wxSize(2 * kMargin, 2 * kMargin));
        dc.DrawLabel(m_message, area, wxALIGN_CENTER);
        return;
    }
    const PointRect page{0, 0, m_preview.pageWidth, m_preview.pageHeight};
    const wxRect pageRect = PixelsOf(page, size);
    if (m_preview.image.IsOk() && pageRect.width > 0 && pageRect.height > 0)
        dc.DrawBitmap(wxBitmap(m_preview.image.Scale(pageRect.width, pageRect.height,
                                                     wxIMAGE_QUALITY_BILINEAR)),
                      pageRect.GetTopLeft());
    dc.SetBrush(*wxTRANSPARENT_BRUSH);
    dc.SetPen(wxPen(*wxBLACK, 1));
    dc.DrawRectangle(pageRect);
    if (!m_preview.imageable.IsEmpty())
    {
        dc.SetPen(wxPen(wxColour(0, 96, 200), 1, wxPENSTYLE_SHORT_DASH));
        dc.DrawRectangle(PixelsOf(m_preview.imageable, size));
    }
    if (!m_preview.marks.IsEmpty())
    {
        dc.SetPen(wxPen(wxColour(220, 0, 0), 1));
        dc.DrawRectangle(PixelsOf(m_preview.marks, size).Inflate(1));
    }
}

wxBitmap PreviewCanvas::Render(const wxSize& size) const
{
    wxBitmap bitmap(std::max(1, size.x), std::max(1, size.y), 24);
    wxMemoryDC dc(bitmap);
    Draw(dc, size);
    dc.SelectObject(wxNullBitmap);
    return bitmap;
}

void PreviewCanvas::OnPaint(wxPaintEvent&)
{
    wxAutoBufferedPaintDC dc(this);
    Draw(dc, GetClientSize());
}
