// Detection on arbitrary file content: whatever the bytes, IsThisEPS answers
// 0 or 1, leaves a context exactly when it answers 1, and that context
// describes the file it was given; a refusal has a reason, and the check of
// a recognised file passes exactly what can be printed.
#include <cmath>
#include <cstring>

#include "EPStoPS.h"
#include "FuzzSupport.h"

namespace
{
constexpr unsigned char kDosEpsMagic[4] = {0xC5, 0xD0, 0xD3, 0xC6};

// A reason is a sentence of one line: no control character from the file.
bool ShownReason(const char* reason)
{
    if (*reason == '\0')
        return false;
    for (const char* c = reason; *c; ++c)
        if (static_cast<unsigned char>(*c) < 0x20 || *c == 0x7F)
            return false;
    return true;
}

bool Printable(const EPSinfo_t& info, size_t size)
{
    const double* box = info.boundingBox;
    for (int i = 0; i < 4; ++i)
        if (!std::isfinite(box[i]) || std::fabs(box[i]) > kEPSLargestBoxValue)
            return false;
    if (box[0] > box[2] || box[1] > box[3])
        return false;
    return info.psOffset == 0 || (info.psOffset >= kDosEpsHeaderBytes &&
                                  static_cast<size_t>(info.psOffset + info.psLength) <= size);
}
} // namespace

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
        FUZZ_REQUIRE(EPStoPSFailureKind() != EPS_FAILURE_NONE);
        FUZZ_REQUIRE(ShownReason(EPStoPSFailureReason()));
        return 0;
    }
    FUZZ_REQUIRE(EPStoPSFailureKind() == EPS_FAILURE_NONE && *EPStoPSFailureReason() == '\0');

    FUZZ_REQUIRE(context != nullptr);
    const auto* info = static_cast<const EPSinfo_t*>(context);
    FUZZ_REQUIRE(info->epsFile != nullptr);
    FUZZ_REQUIRE(std::strcmp(info->docName, "/input.eps") == 0);
    const bool dosBinary = size >= 4 && std::memcmp(data, kDosEpsMagic, 4) == 0;
    if (dosBinary)
        FUZZ_REQUIRE(info->psOffset > 0 && info->psLength > 0);
    else
        FUZZ_REQUIRE(info->psOffset == 0 && info->psLength == static_cast<int64_t>(size));

    const bool printable = Printable(*info, size);
    FUZZ_REQUIRE(CheckEPSInput(context) == (printable ? 1 : 0));
    if (printable)
        FUZZ_REQUIRE(EPStoPSFailureKind() == EPS_FAILURE_NONE);
    else
        FUZZ_REQUIRE((EPStoPSFailureKind() == EPS_FAILURE_DAMAGED ||
                      EPStoPSFailureKind() == EPS_FAILURE_BAD_BOX) &&
                     ShownReason(EPStoPSFailureReason()));

    EPStoPSfreeMemory(&context);
    FUZZ_REQUIRE(context == nullptr);
    EPStoPSfreeMemory(&context); // a second release must be harmless
    return 0;
}
