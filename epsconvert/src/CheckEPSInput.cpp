// Whether a recognised file can be printed as it stands. Recognition takes a
// DOS EPS header's section as it is and any four numbers as the box; what
// they would print (a page cut short, or no picture at all) is decided here.
#include <sys/stat.h>

#include <cmath>
#include <string>

#include "EPStoPS.h"
#include "FailureRecord.h"
#include "posix/OutsideText.h"

namespace
{
bool SectionInFile(const EPSinfo_t& info)
{
    if (info.psOffset == 0)
        return true; // a plain EPS file: the program is the whole file
    const std::string start = "the file is damaged: its PostScript section should ";
    if (info.psOffset < kDosEpsHeaderBytes)
    {
        RecordFailure(EPS_FAILURE_DAMAGED,
                      start + "start at byte " + std::to_string(info.psOffset) + ", inside the " +
                          std::to_string(kDosEpsHeaderBytes) + "-byte DOS EPS header");
        return false;
    }
    struct stat status;
    // Only a regular file has a size to hold the section against.
    if (fstat(fileno(info.epsFile), &status) != 0 || !S_ISREG(status.st_mode) ||
        info.psOffset + info.psLength <= status.st_size)
        return true;
    RecordFailure(EPS_FAILURE_DAMAGED, start + "hold " + std::to_string(info.psLength) +
                                           " bytes from byte " + std::to_string(info.psOffset) +
                                           ", but the file ends after " +
                                           std::to_string(status.st_size) + " bytes");
    return false;
}

bool BoxUsable(const EPSinfo_t& info)
{
    const double* box = info.boundingBox;
    const std::string largest = std::to_string(static_cast<long long>(kEPSLargestBoxValue));
    const std::string outside = "has a number outside -" + largest + " to " + largest + " points";
    const char* problem = nullptr;
    for (int i = 0; i < 4 && !problem; ++i)
        if (!std::isfinite(box[i]))
            problem = "is not four finite numbers";
    for (int i = 0; i < 4 && !problem; ++i)
        if (std::fabs(box[i]) > kEPSLargestBoxValue)
            problem = outside.c_str();
    // Width or height 0 is allowed: such a picture keeps its scale of 1.
    if (!problem && (box[0] > box[2] || box[1] > box[3]))
        problem = "has its lower-left corner above or right of its upper-right corner";
    if (!problem)
        return true;
    RecordFailure(EPS_FAILURE_BAD_BOX,
                  "the bounding box \"" + posix::ShownText(info.boxLine) + "\" " + problem);
    return false;
}
} // namespace

int CheckEPSInput(void* context)
{
    ClearFailure();
    if (!context)
    {
        RecordFailure(EPS_FAILURE_RESOURCES, "no file description was given");
        return 0;
    }
    const auto& info = *static_cast<const EPSinfo_t*>(context);
    return SectionInFile(info) && BoxUsable(info) ? 1 : 0;
}
