#pragma once
#include <memory>

#include <wx/panel.h>

#include "preview/PreviewWorker.h"

class PreviewCanvas;
class wxButton;
class wxStaticText;

// The right side of the window: the page an output makes, rendered by
// Ghostscript on the preview worker's thread so that a slow or missing
// Ghostscript never holds the window; and "Try a file…", which converts any
// EPS with the folder's current settings into a scratch file (the folder is
// not touched) on that thread too, and shows that.
class PreviewPanel : public wxPanel
{
public:
    PreviewPanel(wxWindow* parent, const wxString& modulePath);
    ~PreviewPanel() override;

    // The folder whose printer and settings apply; empty for none.
    void SetFolder(const wxString& folder);
    // Shows the page of an output (PostScript or EPS) of the folder.
    void ShowOutput(const wxString& output, const wxString& title);
    // Asks for an EPS file and tries it.
    void TryFile();
    // Tries eps with the folder's current settings: true once the trial is
    // under way, its page or why it cannot be converted arriving later as a
    // delivered page; false (the reason shown) when it cannot even begin.
    bool TryFileNamed(const wxString& eps);

    PreviewCanvas& Canvas() const { return *m_canvas; }
    wxButton& TryButton() const { return *m_try; }
    // How many pages (or reasons) the worker delivered so far.
    size_t Delivered() const { return m_delivered; }

private:
    void Render(PreviewRequest request, const wxString& title, const wxString& message);

    wxString m_modulePath;
    wxString m_folder;
    wxStaticText* m_title = nullptr;
    PreviewCanvas* m_canvas = nullptr;
    wxButton* m_try = nullptr;
    size_t m_generation = 0;
    size_t m_delivered = 0;
    // Ended first (stopping Ghostscript, joining, removing a trial's
    // scratch file) before the windows it reports to go.
    std::unique_ptr<PreviewWorker> m_worker = std::make_unique<PreviewWorker>();
};
