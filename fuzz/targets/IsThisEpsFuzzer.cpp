// Detection on arbitrary file content: whatever the bytes, IsThisEPS answers
// 0 or 1, leaves a context exactly when it answers 1, and that context
// describes the file it was given.
#include <cstring>

#include "EPStoPS.h"
#include "FuzzSupport.h"

namespace
{
constexpr unsigned char kDosEpsMagic[4] = {0xC5, 0xD0, 0xD3, 0xC6};
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    fuzzsupport::InitialiseOnce();
    static const std::string path = fuzzsupport::ScratchDirectory() + "/input.eps";
    fuzzsupport::WriteScratchFile(path, data, size);

    void* context = reinterpret_cast<void*>(&context); // a stale value the call must overwrite
    const unsigned int recognised = IsThisEPS(path.c_str(), &context);
    FUZZ_REQUIRE(recognised == 0 || recognised == 1);
    if (!recognised)
    {
        FUZZ_REQUIRE(context == nullptr);
        return 0;
    }

    FUZZ_REQUIRE(context != nullptr);
    const auto* info = static_cast<const EPSinfo_t*>(context);
    FUZZ_REQUIRE(info->epsFile != nullptr);
    FUZZ_REQUIRE(std::strcmp(info->docName, "/input.eps") == 0);
    const bool dosBinary = size >= 4 && std::memcmp(data, kDosEpsMagic, 4) == 0;
    if (dosBinary)
        FUZZ_REQUIRE(info->psOffset > 0 && info->psLength > 0);
    else
        FUZZ_REQUIRE(info->psOffset == 0 && info->psLength == static_cast<int64_t>(size));

    EPStoPSfreeMemory(&context);
    FUZZ_REQUIRE(context == nullptr);
    EPStoPSfreeMemory(&context); // a second release must be harmless
    return 0;
}
