// Copies one byte range of a file: the PostScript section of a DOS EPS
// binary (leaving its preview behind) or the whole of a plain EPS file.
#include <cstdio>

#include "EPStoPS.h"
#include "EngineAlloc.h"
#include "EngineMessages.h"
#include "KernelCopy.h"

namespace
{
void ReportShortRead(FILE* in, unsigned long bytesLeft)
{
    if (ferror(in))
        WriteEngineMessage("Error from fread in ExtractEPSfromTIFFpreview\n");
    else if (!feof(in))
        WriteEngineMessage("Unknown error from fread in ExtractEPSfromTIFFpreview\n");
    else
        fprintf(stderr, "Premature EOF with leftover BytesToRead = %lu\n", bytesLeft);
}
} // namespace

void ExtractEPSfromTIFFpreview(FILE* in, FILE* out, long offset, long length)
{
    if (!in || !out)
        return;
    size_t bufferSize = 0;
    char* buffer = AllocateWorkBuffer(1048576, &bufferSize);
    if (!buffer)
        return;

    if (fseek(in, offset, SEEK_SET) != 0)
    {
        WriteEngineMessage("Error from fseek in ExtractEPSfromTIFFpreview\n");
        ReleaseWorkBuffer(buffer, bufferSize);
        return;
    }

    unsigned long bytesLeft = static_cast<unsigned long>(length);
    // Large ranges between regular files are copied inside the kernel; the
    // loop below is the fallback and owns every message.
    if (bytesLeft > bufferSize && CopyRangeInKernel(in, out, offset, bytesLeft))
        bytesLeft = 0;
    while (bytesLeft > 0)
    {
        const size_t wanted = bytesLeft < bufferSize ? bytesLeft : bufferSize;
        const size_t got = fread(buffer, 1, wanted, in);
        bytesLeft -= got;
        if (got < wanted)
        {
            // The bytes of a short final read are deliberately not written:
            // the output ends with the last full chunk.
            ReportShortRead(in, bytesLeft);
            break;
        }
        if (fwrite(buffer, 1, got, out) < got)
        {
            WriteEngineMessage("Error from fwrite in ExtractEPSfromTIFFpreview\n");
            break;
        }
    }
    ReleaseWorkBuffer(buffer, bufferSize);
}
