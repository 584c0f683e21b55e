// Every capability query on arbitrary description text. The queries parse
// the text themselves, so each one is a separate way into the parser and
// into its own element walk.
#include <vector>

#include "FuzzToolkit.h"
#include "db/PluginInitialize.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    fuzzsupport::InitialiseToolkitOnce();
    const wxString xml = fuzzsupport::TextOf(data, size);

    std::vector<stPageAttribute> sheets;
    const bool haveSheets = PluginInitialize::InitializeSheetInfo(xml, sheets);
    FUZZ_REQUIRE(haveSheets || sheets.empty());
    stPageAttribute page;
    PluginInitialize::InitializeDefaultSheetInfo(xml, page);
    stCustomPageSizeAttribute custom;
    PluginInitialize::InitializeCustomPageSizeInfo(xml, custom);

    int dpi = 0;
    PluginInitialize::InitializeResolution(xml, dpi);
    wxString text;
    PluginInitialize::InitializePreferenceUnit(xml, text);
    PluginInitialize::InitializeOSUnit(xml, text);
    PluginInitialize::InitializeDecimalSeparator(xml, text);

    PluginInitialize::IsServerGA2Enabled(xml);
    PluginInitialize::IsServerGA1Enabled(xml);
    PluginInitialize::IsServerXRXEnabled(xml);
    PluginInitialize::IsServerVDPEnabled(xml);
    PluginInitialize::IsServerOneBitTiffEnabled(xml);
    PluginInitialize::IsXeroxServer(xml);
    PluginInitialize::IsFeatureEnabled(xml, "HF_EPS_FILTER");
    PluginInitialize::IsFeatureEnabled(xml, "SubstrateFamilySupported");
    for (const int required : {0, 3, 2147483647})
        PluginInitialize::IsRequiredServerVersion(xml, required);

    wxString option, value;
    PluginInitialize::InitializeEngineScreenInfo(xml, option, value);
    PluginInitialize::InitializeImageCompressionInfo(xml, option, value);
    PluginInitialize::InitializeResolutionInfo(xml, option, value);
    return 0;
}
