// The machine-wide HotFolderList.cfg, read from the warehouse and from an
// explicit directory. Entries name directories on this machine; only the
// ones that exist come back, each once in any case.
#include <wx/filename.h>

#include "FuzzToolkit.h"
#include "db/HFDatabase.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    fuzzsupport::InitialiseToolkitOnce();
    static const std::string file = fuzzsupport::WarehouseDirectory() + "/HotFolderList.cfg";
    fuzzsupport::WriteScratchFile(file, data, size);

    wxArrayString folders;
    if (db::HFDatabase::ReadFoldersList(folders))
    {
        for (size_t i = 0; i < folders.size(); ++i)
        {
            FUZZ_REQUIRE(wxFileName::DirExists(folders[i]));
            for (size_t j = i + 1; j < folders.size(); ++j)
                FUZZ_REQUIRE(!folders[i].IsSameAs(folders[j], false));
        }
    }

    wxArrayString fromPath;
    const bool listed = db::HFDatabase::GetHotFolderListFromPath(
        fromPath, wxString::FromUTF8(fuzzsupport::WarehouseDirectory()));
    FUZZ_REQUIRE(listed || fromPath.empty());
    FUZZ_REQUIRE(fromPath == folders);
    return 0;
}
