#pragma once
#include <string>

namespace printing
{
// A PPD's page-size code goes into the PostScript job only when it is
// PostScript: not an option of the JCL section and not printer job language
// ("@PJL ..." or the universal exit ESC%-12345X). Other drivers (PDF and
// driverless printers, many office printers) select paper outside the job.
bool IsPostScriptPageCode(const std::string& code, bool inJclSection);

// "<< /PageSize [W H] >> setpagedevice", lengths in points with ".".
std::string StandardPageSizeCode(double width, double height);

// The same for a custom size, whose width, height, offsets and orientation
// the filter pushes in front of the code.
extern const char* const kStandardCustomSizeCode;

// Shortest text that reads back as the same single-precision number; always
// ".". PPD numbers are single precision, so 595.276 rather than 17 digits.
std::string PointsNumber(double value);
} // namespace printing
