// The client configuration HFConfig.cfg in the application's Resources.
// The configuration is one object per process and keeps the keys it has
// seen, as it does in the client when the file is loaded again.
#include "FuzzToolkit.h"
#include "utils/Config.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    fuzzsupport::InitialiseToolkitOnce();
    static const std::string file = fuzzsupport::ResourcesDirectory() + "/HFConfig.cfg";
    fuzzsupport::WriteScratchFile(file, data, size);

    utils::Config& config = utils::Config::GetInstance();
    config.Initialize();

    wxArrayString keys, names;
    config.GetJPDisplayKeys(keys, names);
    FUZZ_REQUIRE(names.size() <= keys.size()); // a name is only read beside its key

    wxString value;
    utils::Config::ReadString("APP_HF_VERSION", value);
    utils::Config::ReadLong("POLL_INTERVAL", 30);
    utils::Config::ReadLong("MAX_JOBS", 12);
    return 0;
}
