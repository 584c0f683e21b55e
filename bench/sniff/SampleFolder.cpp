#include "SampleFolder.h"

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <stdexcept>

namespace sniffbench
{
std::string MakeScratchDirectory(const char* prefix)
{
    const char* base = std::getenv("TMPDIR");
    std::string pattern = std::string(base && *base ? base : "/tmp") + "/" + prefix + "-XXXXXX";
    if (!mkdtemp(pattern.data()))
        throw std::runtime_error("mkdtemp failed for " + pattern);
    return pattern;
}

void WriteEpsFiles(const std::string& folder, int count, long bytesEach)
{
    std::string content = "%!PS-Adobe-3.0 EPSF-3.0\n"
                          "%%BoundingBox: 0 0 612 792\n"
                          "%%Title: benchmark sample\n"
                          "%%EndComments\n";
    while (static_cast<long>(content.size()) < bytesEach)
        content += "0 0 moveto 612 792 lineto stroke % a line of drawing\n";
    content += "%%EOF\n";
    for (int i = 0; i < count; ++i)
    {
        const std::string path = folder + "/" + std::to_string(i) + ".eps";
        FILE* out = std::fopen(path.c_str(), "wb");
        if (!out || std::fwrite(content.data(), 1, content.size(), out) != content.size() ||
            std::fclose(out) != 0)
            throw std::runtime_error("cannot write " + path);
    }
}

void RemoveTree(const std::string& path)
{
    std::error_code ignored;
    std::filesystem::remove_all(path, ignored);
}
} // namespace sniffbench
