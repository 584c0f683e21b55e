#pragma once
// Runs Ghostscript as a test oracle: where a PostScript file marks the page,
// how large the page is, and whether the interpreter hit an error. Programs
// are started with an argument vector, never through a shell.
#include <cstdio>
#include <sstream>
#include <string>
#include <vector>

#include "TestKit.h"

namespace hf_test
{
struct Box
{
    double llx = 0, lly = 0, urx = 0, ury = 0;
};

struct GhostscriptReport
{
    testkit::ProcessResult process;
    bool postscriptError = false; // the interpreter reported an error
    bool marked = false;          // a %%HiResBoundingBox line was printed
    Box marks;                    // union of all marks on the (last) page
    bool pageSeen = false;
    double pageWidth = 0, pageHeight = 0; // page size at showpage
    int pages = 0;
};

// Page size at each showpage, printed by the oracle's own prologue. The job
// may redefine showpage inside a save; restore brings this one back.
inline const char* PageSizeProbe()
{
    return "/showpage { currentpagedevice /PageSize get aload pop exch "
           "(HFPAGESIZE ) print =only ( ) print = flush systemdict /showpage get exec } bind def";
}

// Runs the file through the bbox device.
inline GhostscriptReport RunGhostscriptBBox(const std::string& psFile)
{
    GhostscriptReport report;
    report.process = testkit::RunProgram({"gs", "-q", "-dNOPAUSE", "-dBATCH", "-dSAFER",
                                          "-sDEVICE=bbox", "-c", PageSizeProbe(), "-f", psFile});
    const std::string& err = report.process.err;
    report.postscriptError = report.process.exitCode != 0 ||
                             err.find("Error:") != std::string::npos ||
                             err.find("Unrecoverable error") != std::string::npos;

    std::istringstream errLines(err);
    for (std::string line; std::getline(errLines, line);)
    {
        Box box;
        if (std::sscanf(line.c_str(), "%%%%HiResBoundingBox: %lf %lf %lf %lf", &box.llx, &box.lly,
                        &box.urx, &box.ury) == 4)
        {
            report.marked = true;
            report.marks = box;
        }
    }
    std::istringstream outLines(report.process.out);
    for (std::string line; std::getline(outLines, line);)
    {
        double w = 0, h = 0;
        if (std::sscanf(line.c_str(), "HFPAGESIZE %lf %lf", &w, &h) == 2)
        {
            report.pageSeen = true;
            report.pageWidth = w;
            report.pageHeight = h;
            ++report.pages;
        }
    }
    return report;
}

// Renders to a grey-scale raster at the given resolution; "" on failure.
inline std::string RenderToPgm(const std::string& psFile, int dpi)
{
    testkit::ScratchDir scratch("hf-oracle");
    const std::string raster = scratch.File("page.pgm");
    const testkit::ProcessResult run =
        testkit::RunProgram({"gs", "-q", "-dNOPAUSE", "-dBATCH", "-dSAFER", "-sDEVICE=pgmraw",
                             "-r" + std::to_string(dpi), "-sOutputFile=" + raster, psFile});
    return run.exitCode == 0 ? testkit::ReadFile(raster) : std::string();
}
} // namespace hf_test
