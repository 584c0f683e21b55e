#include "CopyCandidates.h"

#include <fcntl.h>
#include <sys/sendfile.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <memory>

namespace
{
constexpr size_t kMegabyte = 1 << 20;
constexpr size_t kPage = 4096;

bool WriteAll(int fd, const char* data, size_t size)
{
    while (size > 0)
    {
        const ssize_t written = write(fd, data, size);
        if (written <= 0)
            return false;
        data += written;
        size -= static_cast<size_t>(written);
    }
    return true;
}

// How much to copy first so that the output then stands on a multiple of
// boundary (0 for no alignment).
size_t FirstChunk(int outFd, size_t boundary, size_t chunk)
{
    if (boundary == 0)
        return chunk;
    const off_t at = lseek(outFd, 0, SEEK_CUR);
    const size_t rest = boundary - static_cast<size_t>(at) % boundary;
    return rest == boundary ? chunk : rest;
}

bool ReadWrite(int inFd, off_t offset, size_t length, int outFd, size_t alignTo)
{
    void* block = nullptr;
    if (posix_memalign(&block, kPage, kMegabyte) != 0)
        return false;
    const std::unique_ptr<void, decltype(&std::free)> owned(block, &std::free);
    char* buffer = static_cast<char*>(block);
    size_t wanted = FirstChunk(outFd, alignTo, kMegabyte);
    while (length > 0)
    {
        const ssize_t got = pread(inFd, buffer, std::min(wanted, length), offset);
        if (got <= 0 || !WriteAll(outFd, buffer, static_cast<size_t>(got)))
            return false;
        offset += got;
        length -= static_cast<size_t>(got);
        wanted = kMegabyte;
    }
    return true;
}

bool CopyFileRange(int inFd, off_t offset, size_t length, int outFd, size_t alignTo)
{
    if (alignTo != 0)
    {
        // The first bytes by read and write, the rest at a page boundary.
        const size_t first = std::min(FirstChunk(outFd, alignTo, 0), length);
        if (first != 0 && !ReadWrite(inFd, offset, first, outFd, 0))
            return false;
        offset += static_cast<off_t>(first);
        length -= first;
    }
    loff_t from = offset;
    while (length > 0)
    {
        const ssize_t copied = copy_file_range(inFd, &from, outFd, nullptr, length, 0);
        if (copied <= 0)
            return false;
        length -= static_cast<size_t>(copied);
    }
    return true;
}

bool Splice(int inFd, off_t offset, size_t length, int outFd, int pipeBytes, bool align,
            bool adviseSequential)
{
    if (adviseSequential)
        posix_fadvise(inFd, offset, static_cast<off_t>(length), POSIX_FADV_SEQUENTIAL);
    int fds[2];
    if (pipe2(fds, O_CLOEXEC) != 0)
        return false;
    if (pipeBytes > 0)
        fcntl(fds[1], F_SETPIPE_SZ, pipeBytes);
    const size_t chunk = static_cast<size_t>(fcntl(fds[1], F_GETPIPE_SZ));
    off_t outAt = lseek(outFd, 0, SEEK_CUR);
    loff_t from = offset;
    bool ok = true;
    while (ok && length > 0)
    {
        const size_t wanted = std::min(length, align ? chunk - outAt % chunk : chunk);
        const ssize_t filled = splice(inFd, &from, fds[1], nullptr, wanted, 0);
        ok = filled > 0;
        for (ssize_t left = filled; ok && left > 0;)
        {
            const ssize_t moved = splice(fds[0], nullptr, outFd, nullptr, left, 0);
            ok = moved > 0;
            left -= moved;
        }
        if (ok)
        {
            length -= static_cast<size_t>(filled);
            outAt += filled;
        }
    }
    close(fds[0]);
    close(fds[1]);
    return ok;
}

bool SendFile(int inFd, off_t offset, size_t length, int outFd)
{
    while (length > 0)
    {
        const ssize_t sent = sendfile(outFd, inFd, &offset, length);
        if (sent <= 0)
            return false;
        length -= static_cast<size_t>(sent);
    }
    return true;
}
} // namespace

const std::vector<CopyCandidate>& CopyCandidates()
{
    static const std::vector<CopyCandidate> candidates = {
        {"read_write_1m",
         [](int in, off_t at, size_t n, int out) { return ReadWrite(in, at, n, out, 0); }},
        {"read_write_1m_aligned",
         [](int in, off_t at, size_t n, int out) { return ReadWrite(in, at, n, out, kMegabyte); }},
        {"copy_file_range",
         [](int in, off_t at, size_t n, int out) { return CopyFileRange(in, at, n, out, 0); }},
        {"copy_file_range_aligned",
         [](int in, off_t at, size_t n, int out) { return CopyFileRange(in, at, n, out, kPage); }},
        {"sendfile", SendFile},
        {"splice_64k", [](int in, off_t at, size_t n, int out)
         { return Splice(in, at, n, out, 0, false, false); }},
        // The engine's way.
        {"splice_1m", [](int in, off_t at, size_t n, int out)
         { return Splice(in, at, n, out, kMegabyte, false, false); }},
        {"splice_1m_aligned", [](int in, off_t at, size_t n, int out)
         { return Splice(in, at, n, out, kMegabyte, true, false); }},
        {"splice_1m_aligned_fadvise", [](int in, off_t at, size_t n, int out)
         { return Splice(in, at, n, out, kMegabyte, true, true); }},
    };
    return candidates;
}

bool CopyAsConversion(const CopyCandidate& candidate, const std::string& input, off_t offset,
                      size_t length, const std::string& header, const std::string& trailer,
                      const std::string& output)
{
    const int inFd = open(input.c_str(), O_RDONLY | O_CLOEXEC);
    const int outFd = open(output.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
    const bool ok = inFd >= 0 && outFd >= 0 && WriteAll(outFd, header.data(), header.size()) &&
                    candidate.copy(inFd, offset, length, outFd) &&
                    WriteAll(outFd, trailer.data(), trailer.size());
    if (inFd >= 0)
        close(inFd);
    return outFd >= 0 && close(outFd) == 0 && ok;
}
