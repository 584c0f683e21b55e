#include "ui/PreviewPanel.h"

#include <wx/button.h>
#include <wx/filedlg.h>
#include <wx/filename.h>
#include <wx/sizer.h>
#include <wx/stattext.h>
#include <wx/utils.h>

#include "posix/NativePath.h"
#include "preview/PagePreview.h"
#include "ui/PreviewCanvas.h"

PreviewPanel::PreviewPanel(wxWindow* parent, const wxString& modulePath)
    : wxPanel(parent), m_modulePath(modulePath)
{
    m_title = new wxStaticText(this, wxID_ANY, _("Preview"), wxDefaultPosition, wxDefaultSize,
                               wxST_ELLIPSIZE_MIDDLE);
    m_canvas = new PreviewCanvas(this);
    m_canvas->ShowMessage(_("Select a job and choose Show output, or try a file."));
    m_try = new wxButton(this, wxID_ANY, _(L"&Try a file…"));
    m_try->Bind(wxEVT_BUTTON, [this](wxCommandEvent&) { TryFile(); });
    m_try->Disable();

    auto* sizer = new wxBoxSizer(wxVERTICAL);
    sizer->Add(m_title, 0, wxEXPAND | wxBOTTOM, 4);
    sizer->Add(m_canvas, 1, wxEXPAND);
    sizer->Add(m_try, 0, wxALIGN_RIGHT | wxTOP, 6);
    SetSizer(sizer);
}

PreviewPanel::~PreviewPanel()
{
    m_worker.reset();
}

void PreviewPanel::SetFolder(const wxString& folder)
{
    m_folder = folder;
    m_try->Enable(!folder.empty());
}

void PreviewPanel::ShowOutput(const wxString& output, const wxString& title)
{
    PreviewRequest request;
    request.postscript = output;
    Render(std::move(request), title, _(L"Rendering…"));
}

void PreviewPanel::TryFile()
{
    wxFileDialog dialog(this, _("Try a file with this folder's settings"), wxString(), wxString(),
                        _("EPS files") + " (*.eps)|*.eps;*.EPS;*.epsf;*.epsi|" + _("All files") +
                            "|*",
                        wxFD_OPEN | wxFD_FILE_MUST_EXIST);
    if (dialog.ShowModal() == wxID_OK)
        TryFileNamed(dialog.GetPath());
}

bool PreviewPanel::TryFileNamed(const wxString& eps)
{
    const wxString title =
        wxString::Format(_("Trial: %s"), posix::ShownLine(wxFileName(eps).GetFullName()));
    const wxString cannot = _("Cannot convert: %s");
    PreviewRequest request;
    request.postscript = wxFileName::CreateTempFileName("hf-trial");
    if (request.postscript.empty())
    {
        ++m_generation; // a page still on its way is no longer wanted
        m_title->SetLabel(title);
        m_canvas->ShowMessage(wxString::Format(cannot, _("no scratch file can be made")));
        return false;
    }
    request.removeAfter = true;
    // The worker's thread gets strings of its own, never shared with this one.
    request.prepare = [folder = m_folder.Clone(), eps = eps.Clone(), module = m_modulePath.Clone(),
                       output = request.postscript.Clone(),
                       cannot = cannot.Clone()](wxString& reason)
    {
        wxString error;
        if (ConvertForTrial(folder, eps, module, output, error))
            return true;
        reason = wxString::Format(cannot, posix::ShownLine(error));
        return false;
    };
    Render(std::move(request), title, _(L"Converting…"));
    return true;
}

void PreviewPanel::Render(PreviewRequest request, const wxString& title, const wxString& message)
{
    m_title->SetLabel(title);
    m_canvas->ShowMessage(message);
    request.options.imageable = ImageableAreaOf(m_folder);
    wxString ghostscript;
    if (wxGetEnv("HOTFOLDER_GHOSTSCRIPT", &ghostscript) && !ghostscript.empty())
        request.options.ghostscript = ghostscript;
    const size_t generation = ++m_generation;
    m_worker->Request(std::move(request),
                      [this, generation](const PagePreview& preview)
                      {
                          // A copy of its own: the worker's image is not
                          // shared with the window's thread.
                          PagePreview page = preview;
                          page.image = preview.image.IsOk() ? preview.image.Copy() : wxImage();
                          page.reason = preview.reason.Clone();
                          CallAfter(
                              [this, generation, page]
                              {
                                  ++m_delivered;
                                  if (generation == m_generation)
                                      m_canvas->ShowPage(page);
                              });
                      });
}
