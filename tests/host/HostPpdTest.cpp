// Printer descriptions as the host takes them: server-from-ppd, and a hot
// folder bound to a printer by init --ppd that then converts on its papers.
#include <algorithm>

#include "HostTestSupport.h"
#include "PpdSources.h"
#include "db/PluginInitialize.h"

using namespace host_test;

namespace
{
std::vector<std::string> PaperNames(const std::string& xml)
{
    std::vector<stPageAttribute> sheets;
    EXPECT_TRUE(PluginInitialize::InitializeSheetInfo(wxString::FromUTF8(xml), sheets));
    std::vector<std::string> names;
    for (const stPageAttribute& sheet : sheets)
        names.push_back(sheet.PaperName.ToStdString());
    return names;
}
} // namespace

TEST_F(HostTest, ServerFromPpdWritesThePapersOfThePrinter)
{
    const std::string xml = scratch + "/server.xml";
    testkit::ProcessResult made = Host({"server-from-ppd", ppd_sources::TestPpd(), "-o", xml});
    ASSERT_EQ(made.exitCode, 0) << made.err;
    const std::string written = ReadFile(xml);
    EXPECT_EQ(PaperNames(written), (std::vector<std::string>{"Letter", "A4", "Postcard", "Tab"}));
    std::vector<stPageAttribute> sheets;
    ASSERT_TRUE(PluginInitialize::InitializeSheetInfo(wxString::FromUTF8(written), sheets));
    ASSERT_EQ(sheets.size(), 4u);
    EXPECT_NEAR(sheets[3].Width, 792, 0.01);
    EXPECT_NEAR(sheets[3].Height, 1224, 0.01);
    stPageAttribute defaultPaper;
    ASSERT_TRUE(
        PluginInitialize::InitializeDefaultSheetInfo(wxString::FromUTF8(written), defaultPaper));
    EXPECT_EQ(defaultPaper.PaperName, "A4");

    // Without -o the same description goes to standard output.
    testkit::ProcessResult printed = Host({"server-from-ppd", ppd_sources::TestPpd()});
    EXPECT_EQ(printed.exitCode, 0) << printed.err;
    EXPECT_EQ(printed.out, written);

    testkit::ProcessResult help = Host({"server-from-ppd", "--help"});
    EXPECT_EQ(help.exitCode, 0);
    EXPECT_NE(help.out.find("server-from-ppd FILE.ppd"), std::string::npos) << help.out;
    EXPECT_NE(Host({"--help"}).out.find("server-from-ppd"), std::string::npos);

    testkit::ProcessResult missing = Host({"server-from-ppd", scratch + "/absent.ppd"});
    EXPECT_EQ(missing.exitCode, 3);
    EXPECT_FALSE(missing.err.empty());
    EXPECT_EQ(Host({"server-from-ppd"}).exitCode, 2);
}

TEST_F(HostTest, InitFromAPpdStoresItsDescriptionAndConvertsOnItsPaper)
{
    const std::string folder = scratch + "/hot";
    testkit::ProcessResult init = Host({"init", folder, "--ppd", ppd_sources::TestPpd()});
    ASSERT_EQ(init.exitCode, 0) << init.err;
    EXPECT_NE(init.out.find("Server:         " + ppd_sources::TestPpd()), std::string::npos)
        << init.out;

    // The same description server-from-ppd writes, where --server puts it,
    // and the printer description itself beside it.
    testkit::ProcessResult made = Host({"server-from-ppd", ppd_sources::TestPpd()});
    ASSERT_EQ(made.exitCode, 0);
    EXPECT_EQ(ReadFile(Container(folder) + "/ServerDescription.xml"), made.out);
    EXPECT_EQ(ReadFile(Container(folder) + "/server.ppd"), ReadFile(ppd_sources::TestPpd()));

    // "Tab" exists only in this printer's list: the settings and the run
    // both read the stored description.
    testkit::ProcessResult set = Host({"settings", folder, "--set", "OUTPUTFILETYPEEPS=0",
                                       "OUTPUTFILETYPEPS=1", "DEFAULTPAGESIZE=Tab"});
    ASSERT_EQ(set.exitCode, 0) << set.err;
    CopyExample("label.eps", folder);
    testkit::ProcessResult run = Host({"run", folder});
    ASSERT_EQ(run.exitCode, 0) << run.err;
    EXPECT_EQ(run.err.find("does not offer"), std::string::npos) << run.err;
    const std::string output = folder + "/Output/label.ps";
    EXPECT_NE(ReadFile(output + ".Folder.cfg").find("Key=\"PageSize\" Value=\"Tab\""),
              std::string::npos);
    hf_test::GhostscriptReport report = hf_test::RunGhostscriptBBox(output);
    ASSERT_FALSE(report.postscriptError) << report.process.err;
    ASSERT_TRUE(report.pageSeen);
    EXPECT_NEAR(report.pageWidth, 792, 0.5);
    EXPECT_NEAR(report.pageHeight, 1224, 0.5);
}

TEST_F(HostTest, InitRefusesABadPpdAndTwoServerSources)
{
    const std::string folder = scratch + "/hot";
    testkit::ProcessResult both =
        Host({"init", folder, "--ppd", ppd_sources::TestPpd(), "--server", kServer});
    EXPECT_EQ(both.exitCode, 2);
    EXPECT_NE(both.err.find("--server and --ppd"), std::string::npos) << both.err;

    WriteFile(scratch + "/broken.ppd", "this is no printer description\n");
    testkit::ProcessResult broken = Host({"init", folder, "--ppd", scratch + "/broken.ppd"});
    EXPECT_EQ(broken.exitCode, 3);
    EXPECT_FALSE(broken.err.empty());
    testkit::ProcessResult absent = Host({"init", folder, "--ppd", scratch + "/absent.ppd"});
    EXPECT_EQ(absent.exitCode, 3);
    // Nothing was made for a refused init.
    EXPECT_FALSE(Exists(folder));
}
