// A hot folder's Folder.cfg as found on disk, read by the root reader and
// by every block reader.
#include "FuzzToolkit.h"
#include "db/ConfigurationReader.h"
#include "db/HFDatabase.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    fuzzsupport::InitialiseToolkitOnce();
    static const std::string file = fuzzsupport::ScratchDirectory() + "/Folder.cfg";
    const wxString path = wxString::FromUTF8(fuzzsupport::WriteScratchFile(file, data, size));

    db::Setting setting;
    const int read = db::HFDatabase::ReadSetting(path, setting);
    FUZZ_REQUIRE(read == -1 || read == 1); // the file exists, so never "no file"

    db::FolderConfiguration folder;
    FUZZ_REQUIRE(db::ConfigurationReader::ReadFolderConfiguration(path, folder) == 0);
    db::FilterConfiguration filter;
    FUZZ_REQUIRE(db::ConfigurationReader::ReadFilterConfiguration(path, filter) == 0);
    db::JobConfiguration job;
    FUZZ_REQUIRE(db::ConfigurationReader::ReadJobConfiguration(path, job) == 0);
    db::ImposeConfiguration impose;
    FUZZ_REQUIRE(db::ConfigurationReader::ReadImposeConfiguration(path, impose) == 0);
    db::PreflightConfiguration preflight;
    FUZZ_REQUIRE(db::ConfigurationReader::ReadPreflightConfiguration(path, preflight) == 0);
    return 0;
}
