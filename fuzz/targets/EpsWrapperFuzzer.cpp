// Conversion of whatever detection accepts, under parameters taken from the
// same input: the leading bytes are the parameters, the rest the file.
#include <string>

#include "EPStoPS.h"
#include "FuzzSupport.h"
#include "ParameterBytes.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    fuzzsupport::InitialiseOnce();
    static const std::string input = fuzzsupport::ScratchDirectory() + "/wrapped.eps";
    static const std::string output = fuzzsupport::ScratchDirectory() + "/wrapped.ps";

    fuzzsupport::ParameterBytes bytes(data, size);
    std::string command;
    const EPStoPSparams_t params = bytes.Parameters(command);
    fuzzsupport::WriteScratchFile(input, data + bytes.Consumed(), size - bytes.Consumed());

    void* context = nullptr;
    if (!IsThisEPS(input.c_str(), &context))
        return 0;
    const int converted = ConvertEPStoPS(&context, &params, output.c_str());
    FUZZ_REQUIRE(converted == 0 || converted == 1);
    FUZZ_REQUIRE(context == nullptr); // released on every path
    return 0;
}
