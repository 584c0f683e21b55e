#pragma once
// What every fuzz entry point shares: a private scratch directory the
// configuration readers are pointed at, and a hard stop when the code under
// test breaks one of its promises. Needs no toolkit, so the engine's targets
// run without one; FuzzToolkit.h adds it for the others.
#include <cstddef>
#include <cstdint>
#include <string>

// Stops the run (libFuzzer keeps the input) when a documented promise of the
// code under test does not hold.
#define FUZZ_REQUIRE(condition)                                                                    \
    do                                                                                             \
    {                                                                                              \
        if (!(condition))                                                                          \
            fuzzsupport::Fail(#condition, __FILE__, __LINE__);                                     \
    } while (false)

namespace fuzzsupport
{
[[noreturn]] void Fail(const char* condition, const char* file, int line);

// Sets up the scratch directory; later calls do nothing.
void InitialiseOnce();

// The process's scratch directory, without a trailing '/'. Holds
// "HotFolders" (HOTFOLDER_WAREHOUSE_ROOT points here) and "Resources"
// (HOTFOLDER_RESOURCES_DIR points there).
const std::string& ScratchDirectory();
std::string WarehouseDirectory();
std::string ResourcesDirectory();

// Replaces the file with exactly these bytes; the path is returned.
std::string WriteScratchFile(const std::string& path, const uint8_t* data, size_t size);
} // namespace fuzzsupport

extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv);
extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);
