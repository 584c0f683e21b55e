#pragma once
// Helpers shared by the engine tests: scratch folders, fixtures written on
// the fly, standard-error capture and input fingerprints.
#include <fcntl.h>
#include <locale.h>
#include <ftw.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <string>

#include "EPStoPS.h"
#include "GhostscriptOracle.h"

namespace hf_test
{
class ScratchDir
{
public:
    ScratchDir()
    {
        char name[] = "/tmp/hf-engine-XXXXXX";
        m_path = mkdtemp(name) ? name : "";
    }
    ~ScratchDir()
    {
        if (!m_path.empty())
            nftw(m_path.c_str(), RemoveOne, 16, FTW_DEPTH | FTW_PHYS);
    }
    ScratchDir(const ScratchDir&) = delete;
    ScratchDir& operator=(const ScratchDir&) = delete;

    const std::string& Path() const { return m_path; }
    std::string File(const std::string& name) const { return m_path + "/" + name; }

private:
    static int RemoveOne(const char* path, const struct stat*, int type, struct FTW*)
    {
        chmod(path, 0700);
        if (type == FTW_DP)
            rmdir(path);
        else
            unlink(path);
        return 0;
    }
    std::string m_path;
};

inline void WriteBytes(const std::string& path, const std::string& bytes)
{
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
}

// Collects what is written to standard error while it lives.
class StderrCapture
{
public:
    StderrCapture()
    {
        fflush(stderr);
        char name[] = "/tmp/hf-engine-stderr-XXXXXX";
        m_fd = mkstemp(name);
        m_name = name;
        m_saved = dup(2);
        dup2(m_fd, 2);
    }
    ~StderrCapture() { Restore(); }
    StderrCapture(const StderrCapture&) = delete;
    StderrCapture& operator=(const StderrCapture&) = delete;

    // Stops capturing and returns everything captured.
    std::string Text()
    {
        Restore();
        return m_text;
    }

private:
    void Restore()
    {
        if (m_saved < 0)
            return;
        fflush(stderr);
        dup2(m_saved, 2);
        close(m_saved);
        m_saved = -1;
        close(m_fd);
        m_text = testkit::ReadFile(m_name);
        unlink(m_name.c_str());
    }
    int m_fd = -1;
    int m_saved = -1;
    std::string m_name;
    std::string m_text;
};

// Size, modification time and content hash: an input file must never change.
struct Fingerprint
{
    long long size = -1;
    long long mtimeNs = -1;
    unsigned long long hash = 0;
    bool operator==(const Fingerprint& o) const
    {
        return size == o.size && mtimeNs == o.mtimeNs && hash == o.hash;
    }
};

inline Fingerprint TakeFingerprint(const std::string& path)
{
    Fingerprint print;
    struct stat info;
    if (stat(path.c_str(), &info) != 0)
        return print;
    print.size = info.st_size;
    print.mtimeNs = info.st_mtim.tv_sec * 1000000000LL + info.st_mtim.tv_nsec;
    if (S_ISREG(info.st_mode))
    {
        unsigned long long hash = 1469598103934665603ULL; // FNV-1a
        for (unsigned char c : testkit::ReadFile(path))
            hash = (hash ^ c) * 1099511628211ULL;
        print.hash = hash;
    }
    return print;
}

// Numbers in EPS files use "." whatever locale a test switched to.
class CNumbers
{
public:
    CNumbers() : m_c(newlocale(LC_ALL_MASK, "C", static_cast<locale_t>(nullptr)))
    {
        m_previous = uselocale(m_c);
    }
    ~CNumbers()
    {
        uselocale(m_previous);
        freelocale(m_c);
    }
    CNumbers(const CNumbers&) = delete;
    CNumbers& operator=(const CNumbers&) = delete;

private:
    locale_t m_c;
    locale_t m_previous;
};

// An EPS program that fills exactly its bounding box.
inline std::string FilledBoxEps(double llx, double lly, double urx, double ury)
{
    CNumbers cNumbers;
    char text[1024];
    std::snprintf(text, sizeof text,
                  "%%!PS-Adobe-3.0 EPSF-3.0\n"
                  "%%%%BoundingBox: %.17g %.17g %.17g %.17g\n"
                  "%%%%EndComments\n"
                  "newpath %.17g %.17g moveto %.17g %.17g lineto %.17g %.17g lineto "
                  "%.17g %.17g lineto closepath fill\n"
                  "%%%%EOF\n",
                  llx, lly, urx, ury, llx, lly, urx, lly, urx, ury, llx, ury);
    return text;
}

// The 30-byte DOS EPS binary header with the PostScript section's place.
inline std::string DosEpsHeader(uint32_t offset, uint32_t length)
{
    std::string header = "\xC5\xD0\xD3\xC6";
    for (uint32_t value : {offset, length, 0u, 0u, 0u, 0u})
        for (int i = 0; i < 4; ++i)
            header += static_cast<char>((value >> (8 * i)) & 0xFF);
    return header + "\xFF\xFF"; // checksum
}

inline EPStoPSparams_t NoParams()
{
    EPStoPSparams_t params;
    std::memset(&params, 0, sizeof params);
    return params;
}

// Detects and converts in one go; the result of ConvertEPStoPS, or -1 when
// the file was not recognised.
inline int DetectAndConvert(const std::string& input, const EPStoPSparams_t& params,
                            const std::string& output)
{
    void* context = nullptr;
    if (IsThisEPS(input.c_str(), &context) != 1)
        return -1;
    return ConvertEPStoPS(&context, &params, output.c_str());
}
} // namespace hf_test
