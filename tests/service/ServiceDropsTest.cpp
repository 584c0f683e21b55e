// What droppers may try on a served folder: names that carry line ends or
// PostScript.
#include "OutsideNames.h"
#include "ServiceTestSupport.h"

using namespace service_test;

namespace
{
size_t Outputs(const std::string& folder)
{
    size_t outputs = 0;
    for (const std::string& name : ListDirectory(folder + "/Output"))
        outputs += !EndsWith(name, ".Folder.cfg");
    return outputs;
}
} // namespace

TEST_F(ServiceTest, NamesReachTheJournalOnlyAsShownText)
{
    const std::vector<DroppedName> names = DroppedNames();
    const std::string folder = MakePostScriptFolder();
    auto host = Serve(1);
    DropUnderEachName(names, folder, label);
    EXPECT_TRUE(WaitFor([&] { return Outputs(folder) == names.size(); }, 20000)) << host->Err();
    host->Signal(SIGTERM);
    EXPECT_EQ(host->Wait(20000), 0);
    EXPECT_EQ(LinesWithControls(host->Err()), std::vector<std::string>()) << host->Err();
    for (const DroppedName& name : names)
        EXPECT_NE(host->Err().find("<6>" + posix::ShownText(name.raw) + " -> "), std::string::npos)
            << name.line << "\n"
            << host->Err();
}
