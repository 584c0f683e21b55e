// Outside text as shown in logs and PostScript comments: any bytes show as
// one line of UTF-8 without control characters that reads back to them, a
// DSC comment value keeps its line within 255 bytes, and reading back any
// text never yields what the shown text of it would not.
#include <cstdint>
#include <string>

#include "FuzzSupport.h"
#include "posix/OutsideText.h"

namespace
{
bool IsOneCleanLine(const std::string& text)
{
    for (unsigned char c : text)
        if (c < 0x20 || c == 0x7f)
            return false;
    return true;
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    const std::string shown = posix::ShownText(bytes);
    FUZZ_REQUIRE(IsOneCleanLine(shown));
    std::string back;
    FUZZ_REQUIRE(posix::ReadShownText(shown, back) && back == bytes);
    FUZZ_REQUIRE(posix::ShownText(shown) == shown || shown.find('\\') != std::string::npos);

    const std::string value = posix::DscCommentValue("%%Title: ", bytes);
    FUZZ_REQUIRE(IsOneCleanLine(value) && value.size() + 9 <= 255);

    std::string raw;
    if (posix::ReadShownText(bytes, raw))
    {
        std::string twice;
        FUZZ_REQUIRE(posix::ReadShownText(posix::ShownText(raw), twice) && twice == raw);
    }
    return 0;
}
