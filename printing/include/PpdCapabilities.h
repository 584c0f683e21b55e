#pragma once
#include <string>
#include <vector>

namespace printing
{
// One paper of a printer description. Lengths in points.
struct PpdPaper
{
    std::string keyword;     // the PageSize choice, e.g. "A4"
    std::string displayName; // its translation text, UTF-8
    std::string pwgName;     // standard media name, "" when none is known
    std::string command;     // the PostScript that selects the paper (see PageCode.h)
    double width = 0;
    double height = 0;
    // Imageable area
    double left = 0;
    double bottom = 0;
    double right = 0;
    double top = 0;
};

struct PpdCustomSize
{
    bool allowed = false;
    double minWidth = 0;
    double maxWidth = 0;
    double minHeight = 0;
    double maxHeight = 0;
    // Hardware margins
    double left = 0;
    double bottom = 0;
    double right = 0;
    double top = 0;
    std::string command; // takes width, height, offsets and orientation from the stack
};

struct PpdCapabilities
{
    std::string modelName;
    std::vector<PpdPaper> papers; // in the order of the description
    std::string defaultPaper;     // keyword of the default choice
    int resolution = 0;           // dpi, 0 when the description gives none
    PpdCustomSize custom;
};

// Reads the papers, default paper, resolution and custom size limits through
// the CUPS PPD parser. Gzip-compressed files are read as well.
bool ReadPpdCapabilities(const std::string& ppdPath, PpdCapabilities& capabilities,
                         std::string& error);
} // namespace printing
