// Copies one byte range of a file: the PostScript section of a DOS EPS
// binary (leaving its preview behind) or the whole of a plain EPS file.
#include <cstdio>

#include <sys/stat.h>
#include <unistd.h>

#include "EPStoPS.h"
#include "EngineAlloc.h"
#include "EngineMessages.h"

namespace
{
// When the whole range is present and both ends are regular files, the
// kernel copies it without passing the bytes through user space. Anything
// else (a truncated file, a pipe, a file system that refuses) goes through
// the buffered loop, which also owns every message.
bool CopyInKernel(FILE* in, FILE* out, long offset, unsigned long length)
{
    const int inFd = fileno(in);
    const int outFd = fileno(out);
    struct stat inStat, outStat;
    if (inFd < 0 || outFd < 0 || fstat(inFd, &inStat) != 0 || fstat(outFd, &outStat) != 0 ||
        !S_ISREG(inStat.st_mode) || !S_ISREG(outStat.st_mode) || offset < 0 ||
        static_cast<unsigned long long>(inStat.st_size) <
            static_cast<unsigned long long>(offset) + length)
        return false;
    if (fflush(out) != 0)
        return false;
    const off_t outStart = lseek(outFd, 0, SEEK_CUR);
    off64_t from = offset;
    unsigned long left = length;
    while (left > 0)
    {
        const ssize_t copied = copy_file_range(inFd, &from, outFd, nullptr, left, 0);
        if (copied <= 0)
            break;
        left -= static_cast<unsigned long>(copied);
    }
    if (left != 0)
    {
        // Undo a partial kernel copy so the loop starts from a clean state.
        if (outStart < 0 || ftruncate(outFd, outStart) != 0 || lseek(outFd, outStart, SEEK_SET) < 0)
            return false;
        fseek(out, outStart, SEEK_SET);
        return false;
    }
    // Leave both streams where the loop would have left them.
    fseek(out, 0, SEEK_END);
    fseek(in, offset + static_cast<long>(length), SEEK_SET);
    return true;
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
    if (bytesLeft > bufferSize && CopyInKernel(in, out, offset, bytesLeft))
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
