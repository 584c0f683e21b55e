#pragma once
// Reads the lines of an EPS header from a stream through one fixed buffer.
// CR, LF and runs of them all count as one line break; empty lines are never
// returned. Lines too long for the buffer are dropped in pieces.
#include <cstddef>
#include <cstdio>

class LineReader
{
public:
    // buffer must hold size bytes (at least 8) and outlive the reader. The
    // caller has done the first fill: buffer holds `preloaded` bytes, as many
    // as a fill asks for (size - 2) unless the file ended. Further reads
    // continue at streamOffset.
    LineReader(FILE* stream, char* buffer, size_t size, size_t preloaded, long streamOffset);

    // The next line, NUL-terminated, pointing into the buffer and valid until
    // the next call; null when the scan has to end (end of file or a read
    // error, which is reported on standard error).
    const char* Next();

    // Pieces of over-long lines thrown away so far; they bound the scan like
    // lines do, so a file without line breaks is not read to its end.
    size_t DroppedPieces() const { return m_droppedPieces; }

private:
    enum class Fill
    {
        Data,
        End
    };
    Fill Refill(size_t keep);

    FILE* m_stream;
    char* m_buffer;
    size_t m_size;
    size_t m_pos = 0; // start of the unread rest
    size_t m_end = 0; // end of the data read; an LF and a NUL sit behind it
    bool m_atEof = false;
    size_t m_droppedPieces = 0;
    long m_seekTo = -1; // where the stream must be before the next read, if anywhere
};
