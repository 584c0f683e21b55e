// Runs every file of one fuzz corpus through the fuzz entry point it was
// found with. A broken promise or a sanitizer report aborts the program,
// which fails the test; the file being run is named first so the failure
// points at it.
#include <string>

#include <gtest/gtest.h>

#include "FuzzSupport.h"
#include "TestKit.h"

TEST(CorpusReplay, CorpusHoldsInputs)
{
    // An empty or misplaced corpus would make the replay pass vacuously.
    EXPECT_FALSE(testkit::ListDirectory(HF_FUZZ_CORPUS_DIR).empty()) << HF_FUZZ_CORPUS_DIR;
}

TEST(CorpusReplay, EveryInputRunsClean)
{
    LLVMFuzzerInitialize(nullptr, nullptr);
    for (const std::string& name : testkit::ListDirectory(HF_FUZZ_CORPUS_DIR))
    {
        const std::string file = std::string(HF_FUZZ_CORPUS_DIR) + "/" + name;
        SCOPED_TRACE(file);
        std::fprintf(stderr, "replaying %s\n", file.c_str());
        const std::string bytes = testkit::ReadFile(file);
        // The entry point never reads its data pointer past size; a
        // one-byte buffer stands in for an empty file.
        const uint8_t none = 0;
        const auto* data = reinterpret_cast<const uint8_t*>(bytes.data());
        EXPECT_EQ(0, LLVMFuzzerTestOneInput(bytes.empty() ? &none : data, bytes.size()));
    }
}
