// The preview of a page: one run of the bbox device for the page size and
// the marks, then one raster run at the resolution that gives the size
// wanted.
#include <sys/stat.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>

#include <wx/intl.h>

#include "posix/CLocale.h"
#include "posix/Directories.h"
#include "posix/NativePath.h"
#include "preview/GhostscriptRun.h"
#include "preview/PagePreview.h"
#include "preview/PpmImage.h"

namespace
{
// Prints the size of each page as it is shown; the job's own setpagedevice
// keeps this procedure, as it merges into the page device.
const char kPageSizeProbe[] =
    "<< /EndPage { exch pop dup 2 ne { (%%HFPageSize: ) print currentpagedevice /PageSize get "
    "aload pop exch =only ( ) print =only (\\n) print flush } if 2 ne } bind >> setpagedevice";

const int kSmallestSide = 16;
const int kLargestSide = 10000;

// A folder of its own for the raster, removed with it.
class ScratchFolder
{
public:
    ScratchFolder()
    {
        const char* tmp = std::getenv("TMPDIR");
        std::string pattern = std::string(tmp && *tmp ? tmp : "/tmp") + "/hotfolder-preview-XXXXXX";
        if (mkdtemp(pattern.data()))
            m_path = pattern;
    }
    ~ScratchFolder()
    {
        if (!m_path.empty())
            posix::RemoveTree(m_path);
    }
    ScratchFolder(const ScratchFolder&) = delete;
    ScratchFolder& operator=(const ScratchFolder&) = delete;
    const std::string& Path() const { return m_path; }

private:
    std::string m_path;
};

bool IsReadableFile(const std::string& path)
{
    struct stat info;
    return stat(path.c_str(), &info) == 0 && S_ISREG(info.st_mode);
}

std::string ReadAll(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    std::ostringstream bytes;
    bytes << in.rdbuf();
    return bytes.str();
}

// The first page's size and marks from the probe's output; false when no
// page was shown.
bool ReadProbe(const posix::ChildRun& run, PagePreview& preview)
{
    bool sized = false;
    std::istringstream out(run.out);
    for (std::string line; !sized && std::getline(out, line);)
        sized = std::sscanf(line.c_str(), "%%%%HFPageSize: %lf %lf", &preview.pageWidth,
                            &preview.pageHeight) == 2;
    std::istringstream err(run.err);
    for (std::string line; std::getline(err, line);)
    {
        PointRect& box = preview.marks;
        if (std::sscanf(line.c_str(), "%%%%HiResBoundingBox: %lf %lf %lf %lf", &box.x0, &box.y0,
                        &box.x1, &box.y1) == 4)
            break;
    }
    if (preview.marks.IsEmpty())
        preview.marks = PointRect();
    return sized && preview.pageWidth > 0 && preview.pageHeight > 0;
}

PagePreview Failed(PagePreview preview, const wxString& reason)
{
    preview.ok = false;
    preview.reason = reason;
    preview.image = wxImage();
    return preview;
}
} // namespace

PagePreview RenderPagePreview(const wxString& postscript, const PreviewOptions& options)
{
    return RenderPagePreview(postscript, options, -1);
}

PagePreview RenderPagePreview(const wxString& postscript, const PreviewOptions& options, int stopFd)
{
    // Numbers to and from Ghostscript are written with "." in any locale.
    const posix::CLocaleScope numbers;
    PagePreview preview;
    preview.imageable = options.imageable;
    const std::string file = posix::NativePath(postscript);
    if (!IsReadableFile(file))
        return Failed(preview,
                      wxString::Format(_("cannot find the file %s"), posix::ShownLine(postscript)));
    std::string missing;
    const std::string gs = LocateGhostscript(options.ghostscript, missing);
    if (gs.empty())
        return Failed(preview, wxString::Format(_("Ghostscript is not installed (%s)"),
                                                wxString::FromUTF8(missing)));

    const posix::ChildLimits limits = PreviewLimits(options.timeoutSeconds, stopFd);
    const posix::ChildRun probe =
        RunGhostscript(gs, {"-sDEVICE=bbox", "-c", kPageSizeProbe}, file, limits);
    wxString failure = GhostscriptFailure(probe, limits);
    if (!failure.empty())
        return Failed(preview, failure);
    if (!ReadProbe(probe, preview))
        return Failed(preview, _("the file prints no page"));

    const int side = std::clamp(options.longestSide, kSmallestSide, kLargestSide);
    const double dpi = side * 72.0 / std::max(preview.pageWidth, preview.pageHeight);
    ScratchFolder scratch;
    if (scratch.Path().empty())
        return Failed(preview, _("cannot make a temporary folder for the preview"));
    const std::string raster = scratch.Path() + "/page.ppm";
    char resolution[64];
    std::snprintf(resolution, sizeof resolution, "-r%.4f", dpi);
    const posix::ChildRun render = RunGhostscript(
        gs, {"-sDEVICE=ppmraw", resolution, OutputFileArgument(raster)}, file, limits);
    failure = GhostscriptFailure(render, limits);
    if (!failure.empty())
        return Failed(preview, failure);
    preview.image = DecodePpm(ReadAll(raster));
    if (!preview.image.IsOk())
        return Failed(preview, _("Ghostscript wrote no readable page"));
    preview.ok = true;
    return preview;
}
