#include "FuzzSupport.h"

#include <cstdio>
#include <cstdlib>
#include <filesystem>

namespace fuzzsupport
{
namespace
{
// Removes the scratch directory when the run ends normally.
struct Scratch
{
    std::string path;
    ~Scratch()
    {
        std::error_code ignored;
        if (!path.empty())
            std::filesystem::remove_all(path, ignored);
    }
};

Scratch& TheScratch()
{
    static Scratch scratch;
    return scratch;
}

std::string MakeScratchDirectory()
{
    const char* base = std::getenv("TMPDIR");
    std::string pattern = std::string(base && *base ? base : "/tmp") + "/hf-fuzz-XXXXXX";
    if (!mkdtemp(pattern.data()))
    {
        std::perror("mkdtemp");
        std::abort();
    }
    return pattern;
}
} // namespace

void Fail(const char* condition, const char* file, int line)
{
    std::fprintf(stderr, "broken promise: %s (%s:%d)\n", condition, file, line);
    std::abort();
}

void InitialiseOnce()
{
    Scratch& scratch = TheScratch();
    if (!scratch.path.empty())
        return;
    scratch.path = MakeScratchDirectory();
    std::filesystem::create_directories(WarehouseDirectory());
    std::filesystem::create_directories(ResourcesDirectory());
    // The readers find their files through these; nothing outside the
    // scratch directory is read or written.
    setenv("HOTFOLDER_WAREHOUSE_ROOT", scratch.path.c_str(), 1);
    setenv("HOTFOLDER_RESOURCES_DIR", ResourcesDirectory().c_str(), 1);
    setenv("HOME", scratch.path.c_str(), 1);
}

const std::string& ScratchDirectory()
{
    return TheScratch().path;
}

std::string WarehouseDirectory()
{
    return ScratchDirectory() + "/HotFolders";
}

std::string ResourcesDirectory()
{
    return ScratchDirectory() + "/Resources";
}

std::string WriteScratchFile(const std::string& path, const uint8_t* data, size_t size)
{
    FILE* file = std::fopen(path.c_str(), "wb");
    if (!file)
    {
        std::perror(path.c_str());
        std::abort();
    }
    const bool written = size == 0 || std::fwrite(data, 1, size, file) == size;
    if (std::fclose(file) != 0 || !written)
    {
        std::perror(path.c_str());
        std::abort();
    }
    return path;
}
} // namespace fuzzsupport

extern "C" int LLVMFuzzerInitialize(int*, char***)
{
    fuzzsupport::InitialiseOnce();
    return 0;
}
