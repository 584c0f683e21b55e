// Copies one byte range of a file: the PostScript section of a DOS EPS
// binary (leaving its preview behind) or the whole of a plain EPS file.
#include <cstdio>

#include "EPStoPS.h"
#include "EngineAlloc.h"
#include "EngineMessages.h"

namespace
{
// Large chunks keep big files to few calls; smaller ones keep the copy going
// under memory pressure.
char* AllocateCopyBuffer(size_t* size)
{
    static const struct
    {
        size_t size;
        const char* failure;
    } steps[] = {
        {1048576, "1MB not available from malloc; trying smaller amount\n"},
        {65536, "64KB not available from malloc; trying smaller amount\n"},
        {4096, "4KB not available from malloc; trying smaller amount\n"},
        {256, "Even 256 bytes not available for copy buffer in ExtractEPSfromTIFFpreview\n"},
    };
    for (const auto& step : steps)
    {
        if (char* buffer = static_cast<char*>(EngineAlloc(step.size)))
        {
            *size = step.size;
            return buffer;
        }
        WriteEngineMessage(step.failure);
    }
    *size = 0;
    return nullptr;
}

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
    char* buffer = AllocateCopyBuffer(&bufferSize);
    if (!buffer)
        return;

    if (fseek(in, offset, SEEK_SET) != 0)
    {
        WriteEngineMessage("Error from fseek in ExtractEPSfromTIFFpreview\n");
        EngineFree(buffer);
        return;
    }

    unsigned long bytesLeft = static_cast<unsigned long>(length);
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
    EngineFree(buffer);
}
