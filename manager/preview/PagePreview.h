#pragma once
// A picture of a job's first page as it will print, with where it is marked
// and where the printer can mark, made by Ghostscript outside the window's
// thread; and the conversion of any EPS with a folder's settings that the
// window previews without the folder ever seeing the file.
#include <wx/image.h>
#include <wx/string.h>

// PostScript points, origin bottom-left of the page.
struct PointRect
{
    double x0 = 0, y0 = 0, x1 = 0, y1 = 0;
    bool IsEmpty() const { return x1 <= x0 || y1 <= y0; }
};

struct PagePreview
{
    bool ok = false;
    wxString reason; // why not, in words (Ghostscript's own error line where it gave one)
    wxImage image;   // the page, its top-left pixel the page's top-left corner
    double pageWidth = 0, pageHeight = 0; // points
    PointRect marks;     // where Ghostscript's bbox device finds marks; empty when nothing is drawn
    PointRect imageable; // the printer's imageable area for this page when known
};

struct PreviewOptions
{
    int longestSide = 800;
    int timeoutSeconds = 30;
    // A path, or a name looked up in PATH. Left at "gs", HOTFOLDER_GHOSTSCRIPT
    // names another one, as for the service's preflight.
    wxString ghostscript = "gs";
    PointRect imageable; // handed back in the preview
};

// Blocking; gs -dSAFER from an argument vector, limited in time, processor
// time and memory. Only the first page; a page that sets no size is shown
// on A4.
PagePreview RenderPagePreview(const wxString& postscript, const PreviewOptions& options);

// The same, ended early (ok false) once stopFd becomes readable: what a
// newer request does to an older one.
PagePreview RenderPagePreview(const wxString& postscript, const PreviewOptions& options,
                              int stopFd);

// From the folder's server description and its page; empty when unknown
// (no server, a custom page, a paper the server does not offer).
PointRect ImageableAreaOf(const wxString& folder);

// Converts eps with the folder's current settings into outputPs; the folder
// is not touched.
bool ConvertForTrial(const wxString& folder, const wxString& eps, const wxString& modulePath,
                     const wxString& outputPs, wxString& error);
