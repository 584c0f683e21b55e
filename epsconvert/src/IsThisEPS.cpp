// EPS detection and header scan: recognises plain EPS files and DOS EPS
// binaries and fills the context that conversion needs.
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include "posix/CLocale.h"
#include "EPStoPS.h"
#include "EngineAlloc.h"
#include "EngineMessages.h"
#include "FailureRecord.h"
#include "LineReader.h"
#include "LocaleDecimalPoint.h"
#include "posix/OutsideText.h"

namespace
{
constexpr unsigned char kDosEpsMagic[4] = {0xC5, 0xD0, 0xD3, 0xC6};
constexpr int kMaxHeaderLines = 1000;
constexpr size_t kFirstLineBytes = 255;
constexpr char kSignatureWanted[] = "%!PS-Adobe-x.x EPSF-x.x";

uint32_t LittleEndian32(const unsigned char* bytes)
{
    return uint32_t(bytes[0]) | uint32_t(bytes[1]) << 8 | uint32_t(bytes[2]) << 16 |
           uint32_t(bytes[3]) << 24;
}

void FillDocName(EPSinfo_t* info, const char* path)
{
    const char* slash = std::strrchr(path, '/');
    const char* name = slash ? slash : path;
    std::strncpy(info->docName, name, sizeof info->docName - 1);
    info->docName[sizeof info->docName - 1] = '\0';
}

// "%!PS-Adobe", a word, blanks, then "EPSF" and at least one more character.
bool IsEpsSignature(char* firstLine)
{
    firstLine[std::strcspn(firstLine, "\r\n")] = '\0';
    static constexpr char kStart[] = "%!PS-Adobe";
    if (std::strncmp(firstLine, kStart, sizeof kStart - 1) != 0)
        return false;
    const char* rest = firstLine + sizeof kStart - 1;
    const size_t word = std::strcspn(rest, " \t\f");
    if (word == 0)
        return false;
    rest += word;
    const size_t blanks = std::strspn(rest, " \t\f");
    if (blanks == 0)
        return false;
    rest += blanks;
    return std::strncmp(rest, "EPSF", 4) == 0 && rest[4] != '\0';
}

// Reads one number as strtod does in the C locale. Boxes mostly hold small
// integers: those are read here directly, exactly and several times faster;
// anything else goes to strtod. False when no number is there.
bool ReadNumber(const char*& next, double& value)
{
    const char* p = next;
    while (*p == ' ' || (*p >= '\t' && *p <= '\r'))
        ++p;
    const bool negative = *p == '-';
    if (*p == '-' || *p == '+')
        ++p;
    long long whole = 0;
    int digits = 0;
    for (; *p >= '0' && *p <= '9' && digits < 15; ++p, ++digits)
        whole = whole * 10 + (*p - '0');
    // strtod would read on into a fraction, an exponent or a hex number.
    const bool numberEnds = *p == '\0' || !std::strchr("0123456789.eExX", *p);
    if (digits > 0 && numberEnds)
    {
        value = negative ? -static_cast<double>(whole) : static_cast<double>(whole);
        next = p;
        return true;
    }
    char* end = nullptr;
    value = std::strtod(next, &end);
    if (end == next)
        return false;
    next = end;
    return true;
}

// The box line as numbers are read from it: under a locale whose decimal
// point is not ".", that point is taken as "." too, since such a locale's
// users and their programs write the box with it ("0 0 612,5 792").
std::string WithFullStops(const char* line)
{
    std::string text = line;
    const std::string point = CurrentLocaleDecimalPoint();
    if (point.empty() || LocaleUsesFullStop(point))
        return text;
    for (size_t at = text.find(point); at != std::string::npos; at = text.find(point, at + 1))
        text.replace(at, point.size(), ".");
    return text;
}

// Parses the four numbers after a bounding-box keyword of keywordLength
// characters; false when there are fewer. Only the first 255 characters of
// the line count; they are kept in copy.
bool ParseBox(const char* line, size_t keywordLength, double box[4], char (&copy)[256])
{
    const size_t length = std::min(std::strlen(line), sizeof copy - 1);
    std::memcpy(copy, line, length);
    copy[length] = '\0';
    const std::string numbers = WithFullStops(copy);
    // Parsed in the C locale, which reads "." whatever the process's locale.
    posix::CLocaleScope cLocale;
    double values[4];
    const char* next = numbers.c_str() + keywordLength;
    for (double& value : values)
        if (!ReadNumber(next, value))
            return false;
    std::memcpy(box, values, sizeof values);
    return true;
}

// Reads up to wanted bytes at offset without moving the stream, so that one
// system call serves the header, the first line and the first lines of
// comments. False on a read error; *got is short only at the end of the file
// (a regular file's reads come back short there and nowhere else).
bool ReadAt(FILE* file, int64_t offset, char* dest, size_t wanted, size_t* got)
{
    ssize_t n;
    do
        n = pread(fileno(file), dest, wanted, static_cast<off_t>(offset));
    while (n < 0 && errno == EINTR);
    if (n < 0)
        return false;
    *got = static_cast<size_t>(n);
    return true;
}

// The size of the whole file: the length of a plain EPS program.
bool FileLength(FILE* file, int64_t* length)
{
    struct stat status;
    if (fstat(fileno(file), &status) == 0 && S_ISREG(status.st_mode))
    {
        *length = static_cast<int64_t>(status.st_size);
        return true;
    }
    // Not a regular file: ask the stream, which says whether it can seek.
    if (fseek(file, 0, SEEK_END) != 0)
    {
        WriteEngineMessage("Error from fseek in IsThisEPS\n");
        return false;
    }
    const long end = ftell(file);
    if (end == -1)
    {
        WriteEngineMessage("Error from ftell in IsThisEPS\n");
        return false;
    }
    *length = end;
    return true;
}

// The first bytes of the file as read into the work buffer.
struct Head
{
    char* bytes;
    size_t capacity; // what a fill asks for: the buffer size less the sentinel
    size_t got;      // fewer than capacity only when the file ended
};

void RecordNotEps(const std::string& why)
{
    RecordFailure(EPS_FAILURE_NOT_EPS, "not an EPS file: " + why);
}

// Why a DOS EPS binary's section start shows no signature: a start outside
// the file or inside its header is damage, anything else is no EPS.
void RecordNoDosSignature(const EPSinfo_t* info)
{
    struct stat status;
    const bool sized = fstat(fileno(info->epsFile), &status) == 0 && S_ISREG(status.st_mode);
    const std::string start = "the file is damaged: its PostScript section should start at byte " +
                              std::to_string(info->psOffset);
    if (sized && info->psOffset >= status.st_size)
        RecordFailure(EPS_FAILURE_DAMAGED, start + ", but the file ends after " +
                                               std::to_string(status.st_size) + " bytes");
    else if (info->psOffset < kDosEpsHeaderBytes)
        RecordFailure(EPS_FAILURE_DAMAGED, start + ", inside the " +
                                               std::to_string(kDosEpsHeaderBytes) +
                                               "-byte DOS EPS header");
    else
        RecordNotEps(std::string("the first line of its PostScript section is not ") +
                     kSignatureWanted);
}

// Finds the PostScript program and checks its signature; false rejects.
bool LocateProgram(EPSinfo_t* info, const Head& head, const char* path)
{
    const auto* header = reinterpret_cast<const unsigned char*>(head.bytes);
    if (head.got < 12)
    {
        RecordNotEps(head.got == 0 ? "it is empty" : "it is shorter than 12 bytes");
        return false;
    }

    const bool dosBinary = std::memcmp(header, kDosEpsMagic, sizeof kDosEpsMagic) == 0;
    if (dosBinary)
    {
        info->psOffset = LittleEndian32(header + 4);
        info->psLength = LittleEndian32(header + 8);
        if (info->psOffset == 0 || info->psLength == 0)
        {
            RecordNotEps(std::string("its DOS EPS header gives the PostScript section ") +
                         (info->psOffset == 0 ? "offset 0" : "length 0"));
            info->psOffset = 0;
            info->psLength = 0;
            return false;
        }
    }
    else if (head.got < head.capacity)
        info->psLength = static_cast<int64_t>(head.got); // the whole file is in the head
    else if (!FileLength(info->epsFile, &info->psLength))
    {
        RecordReadFailure(path, errno);
        info->psLength = 0;
        return false;
    }

    char firstLine[kFirstLineBytes + 1];
    size_t got = 0;
    const auto offset = static_cast<size_t>(info->psOffset);
    const bool inHead = offset + kFirstLineBytes <= head.got || head.got < head.capacity;
    if (inHead)
    {
        got = offset < head.got ? std::min(kFirstLineBytes, head.got - offset) : 0;
        if (got > 0)
            std::memcpy(firstLine, head.bytes + offset, got);
    }
    else if (!ReadAt(info->epsFile, info->psOffset, firstLine, kFirstLineBytes, &got))
    {
        const int error = errno;
        WriteEngineMessage("Error from fread in IsThisEPS\n");
        RecordReadFailure(path, error);
        return false;
    }
    firstLine[got] = '\0';
    if (IsEpsSignature(firstLine))
        return true;
    if (dosBinary)
        RecordNoDosSignature(info);
    else
        RecordNotEps(std::string("its first line is not ") + kSignatureWanted);
    return false;
}

// Reads one bounding-box line into the context; false, with the reason,
// when it does not hold four numbers.
bool TakeBox(EPSinfo_t* info, const char* line, size_t keywordLength)
{
    if (ParseBox(line, keywordLength, info->boundingBox, info->boxLine))
        return true;
    RecordNotEps("its bounding box \"" + posix::ShownText(info->boxLine) +
                 "\" does not hold four numbers");
    return false;
}

// Scans the header comments for the bounding box; false rejects.
bool ScanHeader(EPSinfo_t* info, Head& head)
{
    // The head already holds the first fill when the program starts the file.
    size_t preloaded = head.got;
    if (info->psOffset != 0 &&
        !ReadAt(info->epsFile, info->psOffset, head.bytes, head.capacity, &preloaded))
    {
        WriteEngineMessage("IOfread error in readline()\n");
        return true; // a scan that cannot read ends without a box, as at the end of the file
    }
    LineReader reader(info->epsFile, head.bytes, head.capacity + 2, preloaded,
                      static_cast<long>(info->psOffset + preloaded));
    int linesRead = 0;
    while (linesRead + static_cast<int>(reader.DroppedPieces()) < kMaxHeaderLines)
    {
        const char* line = reader.Next();
        if (!line)
            break;
        ++linesRead;
        if (line[0] != '%' || line[1] != '%')
            continue;
        if (std::strncmp(line, "%%BoundingBox:", 14) == 0)
        {
            if (!TakeBox(info, line, 14))
                return false;
        }
        else if (std::strncmp(line, "%%HiResBoundingBox:", 19) == 0)
        {
            if (!TakeBox(info, line, 19))
                return false;
            break;
        }
        else if (std::strncmp(line, "%%EndComments", 13) == 0)
            break;
    }
    return true;
}

void RecordNoMemory(const char* path)
{
    RecordFailure(EPS_FAILURE_RESOURCES, "not enough memory to read " + ShownFileName(path));
}

// Reads the head of the open file; false, with the reason, when it cannot.
bool ReadHead(EPSinfo_t* info, Head& head, const char* path)
{
    if (ReadAt(info->epsFile, 0, head.bytes, head.capacity, &head.got))
        return true;
    const int error = errno;
    WriteEngineMessage("Error from fread of header in IsThisEPS\n");
    if (error == EISDIR)
        RecordNotEps("it is a folder");
    else
        RecordReadFailure(path, error);
    return false;
}
} // namespace

unsigned int IsThisEPS(const char* path, void** context)
{
    ClearFailure();
    if (!context)
    {
        RecordFailure(EPS_FAILURE_RESOURCES, "no place was given for the file's description");
        return 0;
    }
    auto* info = static_cast<EPSinfo_t*>(EngineAlloc(sizeof(EPSinfo_t)));
    *context = info;
    if (!info)
    {
        WriteEngineMessage("Error from malloc in IsThisEPS\n");
        RecordNoMemory(path);
        return 0;
    }
    std::memset(info, 0, sizeof *info);

    size_t bufferSize = 0;
    char* buffer = AllocateWorkBuffer(65536, &bufferSize);
    if (!buffer)
    {
        RecordNoMemory(path);
        EPStoPSfreeMemory(context);
        return 0;
    }

    unsigned int result = 0;
    if (path)
    {
        FillDocName(info, path);
        info->epsFile = fopen(path, "rb");
        Head head{buffer, bufferSize - 2, 0};
        if (!info->epsFile)
        {
            const int error = errno;
            WriteEngineMessage("Error from fopen in IsThisEPS\n");
            RecordReadFailure(path, error);
        }
        else if (ReadHead(info, head, path) && LocateProgram(info, head, path) &&
                 ScanHeader(info, head))
            result = 1;
    }
    else
    {
        WriteEngineMessage("Error from fopen in IsThisEPS\n");
        RecordFailure(EPS_FAILURE_MISSING, "no file was named");
    }

    ReleaseWorkBuffer(buffer, bufferSize);
    if (!result)
        EPStoPSfreeMemory(context);
    return result;
}

void EPStoPSfreeMemory(void** context)
{
    if (!context || !*context)
        return;
    auto* info = static_cast<EPSinfo_t*>(*context);
    if (info->epsFile)
        fclose(info->epsFile);
    EngineFree(info);
    *context = nullptr;
}
