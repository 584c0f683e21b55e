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
};

// 1 when the file is an EPS file; the slot then holds a new context with the
// file open. 0 otherwise, with the slot set to null. An earlier context in
// the slot is overwritten, not released.
unsigned int IsThisEPS(const char* path, void** context);

// Writes the PostScript job to outputPath. 1 when the whole output was
// written, 0 otherwise. Releases the context on every path except a null
// slot pointer or an empty slot.
int ConvertEPStoPS(void** context, const EPStoPSparams_t* params, const char* outputPath);

// Closes the input file, frees the context and nulls the slot; harmless on a
// null or already released slot.
void EPStoPSfreeMemory(void** context);

// Copies length bytes from offset of in to out (neither stream is closed).
// Trouble shows only as messages on standard error.
void ExtractEPSfromTIFFpreview(FILE* in, FILE* out, long offset, long length);
