#pragma once
// The EPS conversion engine: recognise an EPS file (plain or wrapped in a
// DOS EPS binary header with a preview) and wrap its PostScript program in a
// one-page PostScript job placed on the requested page.
#include <cstdint>
#include <cstdio>
#include "EPStoPSparams.h"

// The EPS context that detection hands to conversion. Callers see it only as
// a void*; it is made by IsThisEPS and released by EPStoPSfreeMemory.
struct EPSinfo_t
{
    FILE* epsFile;         // opened "rb", open while the context lives
    int64_t psOffset;      // where the PostScript program starts in the file
    int64_t psLength;      // its length in bytes
    double boundingBox[4]; // llx, lly, urx, ury; all 0 when the file has none
    char docName[64];      // path from its last '/' on, at most 63 characters
    char boxLine[256];     // the comment line the box came from (its first 255 bytes), or ""
};

// What kind of trouble the last failed call of this thread met; a caller
// decides by it what becomes of the file.
enum EPSFailureKind_t : int
{
    EPS_FAILURE_NONE = 0,
    EPS_FAILURE_MISSING,    // no file at the path, or no path
    EPS_FAILURE_UNREADABLE, // the file is there but cannot be opened or read
    EPS_FAILURE_NOT_EPS,    // the file is read but is no EPS file
    EPS_FAILURE_DAMAGED,    // a DOS EPS binary whose PostScript section is not in the file
    EPS_FAILURE_BAD_BOX,    // the bounding box cannot place a picture
    EPS_FAILURE_RESOURCES   // memory, or the output file, failed
};

// A DOS EPS binary's header; its PostScript section starts behind it.
constexpr int64_t kDosEpsHeaderBytes = 30;

// Bounding box numbers beyond this many points (about 353 m) are taken for
// damage, not for artwork.
constexpr double kEPSLargestBoxValue = 1000000.0;

// 1 when the file is an EPS file; the slot then holds a new context with the
// file open. 0 otherwise, with the slot set to null and the reason recorded:
// the file is empty or shorter than 12 bytes, its DOS EPS header gives
// offset or length 0, its first line is no EPS signature, a box line holds
// fewer than four numbers (EPS_FAILURE_NOT_EPS); its DOS EPS section starts
// beyond the end or inside the header (EPS_FAILURE_DAMAGED); it cannot be
// read. A file without a box is EPS with the box 0 0 0 0. An earlier context
// in the slot is overwritten, not released.
unsigned int IsThisEPS(const char* path, void** context);

// Writes the PostScript job to outputPath. 1 when the whole output was
// written (also when the section came short of its length: see
// CheckEPSInput), 0 otherwise, with the reason recorded. Releases the context on every path except
// a null slot pointer or an empty slot.
int ConvertEPStoPS(void** context, const EPStoPSparams_t* params, const char* outputPath);

// Whether a recognised file can be printed as it stands: a DOS EPS binary's
// PostScript section lies behind the 30-byte header and wholly within the
// file; the bounding box (when there is one) is four finite numbers within
// kEPSLargestBoxValue, its lower-left corner neither above nor right of its
// upper-right one (a box of width or height 0 passes). 1 when it can, 0 with
// the reason recorded. The context stays as it was.
int CheckEPSInput(void* context);

// The last IsThisEPS, CheckEPSInput or ConvertEPStoPS of the calling thread:
// what kind of failure it met and a sentence saying it to a print-shop
// operator (UTF-8, outside text in it shown as posix::ShownText shows it);
// EPS_FAILURE_NONE and "" when it succeeded. The text stays valid until the
// thread's next such call.
EPSFailureKind_t EPStoPSFailureKind();
const char* EPStoPSFailureReason();

// Closes the input file, frees the context and nulls the slot; harmless on a
// null or already released slot.
void EPStoPSfreeMemory(void** context);

// Copies length bytes from offset of in to out (neither stream is closed).
// Trouble shows only as messages on standard error.
void ExtractEPSfromTIFFpreview(FILE* in, FILE* out, long offset, long length);
