#include "LineReader.h"

#include <cstring>

#include "EngineMessages.h"

namespace
{
// An unfinished line longer than this is not worth carrying over: the
// comments looked for are short.
constexpr size_t kLongestCarriedRest = 256;

bool IsLineBreak(char c)
{
    return c == '\r' || c == '\n';
}
} // namespace

LineReader::LineReader(FILE* stream, char* buffer, size_t size, size_t preloaded, long streamOffset)
    : m_stream(stream), m_buffer(buffer), m_size(size), m_end(preloaded),
      m_atEof(preloaded < size - 2), m_seekTo(streamOffset)
{
    m_buffer[m_end] = '\n';
    m_buffer[m_end + 1] = '\0';
}

LineReader::Fill LineReader::Refill(size_t keep)
{
    if (m_seekTo >= 0)
    {
        if (fseek(m_stream, m_seekTo, SEEK_SET) != 0)
        {
            WriteEngineMessage("IOfread error in readline()\n");
            return Fill::End;
        }
        m_seekTo = -1;
    }
    if (keep > 0 && m_pos > 0)
        std::memmove(m_buffer, m_buffer + m_pos, keep);
    m_pos = 0;
    m_end = keep;

    const size_t wanted = m_size - 2 - keep;
    const size_t got = fread(m_buffer + keep, 1, wanted, m_stream);
    m_end = keep + got;
    m_buffer[m_end] = '\n';
    m_buffer[m_end + 1] = '\0';

    if (got < wanted)
    {
        if (ferror(m_stream))
        {
            WriteEngineMessage("IOfread error in readline()\n");
            return Fill::End;
        }
        if (!feof(m_stream))
        {
            WriteEngineMessage("Unknown IOfread error in readline()\n");
            return Fill::End;
        }
        m_atEof = true;
        if (m_end == 0)
            return Fill::End;
    }
    return Fill::Data;
}

const char* LineReader::Next()
{
    for (;;)
    {
        // Skip the line breaks left behind the previous line.
        while (m_pos < m_end && IsLineBreak(m_buffer[m_pos]))
            ++m_pos;

        if (m_pos < m_end)
        {
            // Guards the arithmetic above: a line never starts in the last
            // bytes, which hold the sentinel.
            if (m_pos > m_size - 3)
            {
                WriteEngineMessage("*lineptr out of range of buf in readline!\n");
                return nullptr;
            }
            char* start = m_buffer + m_pos;
            // The LF sentinel behind the data ends the scan at the latest.
            size_t length = 0;
            while (!IsLineBreak(start[length]))
                ++length;
            // A line ended only by the sentinel behind the data is complete
            // only when the file has no more to give.
            if (m_pos + length < m_end || m_atEof)
            {
                const size_t breakAt = m_pos + length;
                m_pos = breakAt < m_end ? breakAt + 1 : m_end;
                start[length] = '\0';
                return start;
            }
        }

        if (m_atEof)
            return nullptr;

        size_t rest = m_end - m_pos;
        if (rest > kLongestCarriedRest || rest >= m_size - 3)
        {
            ++m_droppedPieces;
            rest = 0;
        }
        if (Refill(rest) == Fill::End)
            return nullptr;
    }
}
