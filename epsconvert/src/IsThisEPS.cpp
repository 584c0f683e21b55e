// EPS detection and header scan: recognises plain EPS files and DOS EPS
// binaries and fills the context that conversion needs.
#include <cstdint>
#include <cstdio>
#include <cstring>

#include "CLocaleScope.h"
#include "EPStoPS.h"
#include "EngineAlloc.h"
#include "EngineMessages.h"
#include "LineReader.h"

namespace
{
constexpr unsigned char kDosEpsMagic[4] = {0xC5, 0xD0, 0xD3, 0xC6};
constexpr int kMaxHeaderLines = 1000;
constexpr size_t kFirstLineBytes = 255;

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

bool IsEpsSignature(char* firstLine)
{
    firstLine[std::strcspn(firstLine, "\r\n")] = '\0';
    char last[2];
    CLocaleScope cLocale;
    return std::sscanf(firstLine, "%%!PS-Adobe%*[^ \t\f]%*[ \t\f]EPSF%1c", last) == 1;
}

// Parses one bounding-box comment; false when it lacks four numbers.
bool ParseBox(const char* line, const char* pattern, double box[4])
{
    char copy[256];
    copy[0] = '\0';
    // Numbers in EPS files always use "."; parse them in the C locale.
    CLocaleScope cLocale;
    std::sscanf(line, "%255[^\r\n]", copy);
    double values[4];
    if (std::sscanf(copy, pattern, &values[0], &values[1], &values[2], &values[3]) != 4)
        return false;
    std::memcpy(box, values, sizeof values);
    return true;
}

enum class ScanResult
{
    Accepted,
    Rejected
};

ScanResult ScanHeader(EPSinfo_t* info, char* buffer, size_t size)
{
    LineReader reader(info->epsFile, buffer, size);
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
            if (!ParseBox(line, "%%%%BoundingBox: %lf %lf %lf %lf", info->boundingBox))
                return ScanResult::Rejected;
        }
        else if (std::strncmp(line, "%%HiResBoundingBox:", 19) == 0)
        {
            if (!ParseBox(line, "%%%%HiResBoundingBox: %lf %lf %lf %lf", info->boundingBox))
                return ScanResult::Rejected;
            break;
        }
        else if (std::strncmp(line, "%%EndComments", 13) == 0)
            break;
    }
    return ScanResult::Accepted;
}

// Finds the PostScript program and checks its signature; false rejects.
bool LocateProgram(EPSinfo_t* info)
{
    FILE* file = info->epsFile;
    unsigned char header[12];
    if (fseek(file, 0, SEEK_SET) != 0)
    {
        WriteEngineMessage("Error from fseek in IsThisEPS\n");
        return false;
    }
    if (fread(header, 1, sizeof header, file) != sizeof header)
    {
        if (ferror(file))
            WriteEngineMessage("Error from fread of header in IsThisEPS\n");
        return false;
    }

    if (std::memcmp(header, kDosEpsMagic, sizeof kDosEpsMagic) == 0)
    {
        info->psOffset = LittleEndian32(header + 4);
        info->psLength = LittleEndian32(header + 8);
        if (info->psOffset == 0 || info->psLength == 0)
        {
            info->psOffset = 0;
            info->psLength = 0;
            return false;
        }
    }
    else
    {
        if (fseek(file, 0, SEEK_END) != 0)
        {
            WriteEngineMessage("Error from fseek in IsThisEPS\n");
            return false;
        }
        info->psLength = ftell(file);
        if (info->psLength == -1)
        {
            WriteEngineMessage("Error from ftell in IsThisEPS\n");
            info->psLength = 0;
            return false;
        }
    }

    if (fseek(file, static_cast<long>(info->psOffset), SEEK_SET) != 0)
    {
        WriteEngineMessage("Error from fseek in IsThisEPS\n");
        return false;
    }
    char firstLine[kFirstLineBytes + 1];
    const size_t got = fread(firstLine, 1, kFirstLineBytes, file);
    if (got < kFirstLineBytes && ferror(file))
    {
        WriteEngineMessage("Error from fread in IsThisEPS\n");
        return false;
    }
    firstLine[got] = '\0';
    return IsEpsSignature(firstLine);
}
} // namespace

unsigned int IsThisEPS(const char* path, void** context)
{
    if (!context)
        return 0;
    auto* info = static_cast<EPSinfo_t*>(EngineAlloc(sizeof(EPSinfo_t)));
    *context = info;
    if (!info)
    {
        WriteEngineMessage("Error from malloc in IsThisEPS\n");
        return 0;
    }
    std::memset(info, 0, sizeof *info);

    size_t bufferSize = 0;
    char* buffer = AllocateWorkBuffer(65536, &bufferSize);
    if (!buffer)
    {
        EPStoPSfreeMemory(context);
        return 0;
    }

    unsigned int result = 0;
    if (path)
    {
        FillDocName(info, path);
        info->epsFile = fopen(path, "rb");
        if (!info->epsFile)
            WriteEngineMessage("Error from fopen in IsThisEPS\n");
        else if (LocateProgram(info))
        {
            if (fseek(info->epsFile, static_cast<long>(info->psOffset), SEEK_SET) != 0)
                WriteEngineMessage("Error from fseek in IsThisEPS\n");
            else if (ScanHeader(info, buffer, bufferSize) == ScanResult::Accepted)
                result = 1;
        }
    }
    else
        WriteEngineMessage("Error from fopen in IsThisEPS\n");

    EngineFree(buffer);
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
