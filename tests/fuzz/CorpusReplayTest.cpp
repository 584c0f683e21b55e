// Runs every file of one fuzz corpus through the fuzz entry point it was
// found with. A broken promise or a sanitizer report aborts the program,
// which fails the test; the file being run is named first so the failure
// points at it.
#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "FuzzSupport.h"

namespace
{
std::vector<std::filesystem::path> CorpusFiles()
{
    std::vector<std::filesystem::path> files;
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(HF_FUZZ_CORPUS_DIR, error))
        if (entry.is_regular_file())
            files.push_back(entry.path());
    std::sort(files.begin(), files.end());
    return files;
}

std::vector<uint8_t> ReadAll(const std::filesystem::path& path)
{
    std::ifstream in(path, std::ios::binary);
    return std::vector<uint8_t>(std::istreambuf_iterator<char>(in),
                                std::istreambuf_iterator<char>());
}
} // namespace

TEST(CorpusReplay, CorpusHoldsInputs)
{
    // An empty or misplaced corpus would make the replay pass vacuously.
    EXPECT_FALSE(CorpusFiles().empty()) << HF_FUZZ_CORPUS_DIR;
}

TEST(CorpusReplay, EveryInputRunsClean)
{
    LLVMFuzzerInitialize(nullptr, nullptr);
    for (const auto& file : CorpusFiles())
    {
        SCOPED_TRACE(file.string());
        std::fprintf(stderr, "replaying %s\n", file.c_str());
        const std::vector<uint8_t> bytes = ReadAll(file);
        // The entry point never reads its data pointer past size; a
        // one-byte buffer stands in for an empty file.
        const uint8_t none = 0;
        EXPECT_EQ(0, LLVMFuzzerTestOneInput(bytes.empty() ? &none : bytes.data(), bytes.size()));
    }
}
