// The machine-wide Preferences.cfg in the warehouse.
#include "FuzzToolkit.h"
#include "db/HFDatabase.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    fuzzsupport::InitialiseToolkitOnce();
    static const std::string file = fuzzsupport::WarehouseDirectory() + "/Preferences.cfg";
    fuzzsupport::WriteScratchFile(file, data, size);

    db::Preference preference;
    // Whatever it holds, an existing file reads as -1.
    FUZZ_REQUIRE(db::HFDatabase::ReadPreferences(preference) == -1);
    // The unit is looked up through the translations on every read.
    (void)preference.GetUnit();
    return 0;
}
