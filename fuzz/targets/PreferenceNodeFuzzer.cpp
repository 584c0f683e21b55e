// The filter's saved settings as the host hands them back: the bytes are
// parsed as an XML document and its root goes to both loaders, then the
// settings are turned into conversion parameters and saved again.
#include <memory>

#include <wx/mstream.h>
#include <wx/xml/xml.h>

#include "EPS.h"
#include "FuzzToolkit.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    fuzzsupport::InitialiseToolkitOnce();
    wxMemoryInputStream stream(data, size);
    wxXmlDocument document;
    if (!document.Load(stream, "UTF-8") || !document.GetRoot())
        return 0;
    wxXmlNode* root = document.GetRoot();

    EPS filter("EPS");
    FUZZ_REQUIRE(filter.InitilaizeFromPreference(root) == 0);
    FUZZ_REQUIRE(filter.LoadPreference(root) == 0);
    filter.LoadEPSParams();
    FUZZ_REQUIRE(filter.GetParams().setPageDeviceString != nullptr);
    FUZZ_REQUIRE(filter.GetParams().imagePosition <= IMG_POS_CENTER);

    auto saved = std::make_unique<wxXmlNode>(wxXML_ELEMENT_NODE, "Filter");
    FUZZ_REQUIRE(filter.SavePreference(saved.get()) == 0);
    EPS reloaded("EPS");
    reloaded.LoadPreference(saved.get());
    return 0;
}
