// The built module, set up from a description made from a PPD, lays EPS
// artwork out on each printer paper: Ghostscript sees that paper's size.
#include <algorithm>
#include <cmath>
#include <cstdio>

#include <gtest/gtest.h>

#include "CupsJobOptions.h"
#include "GhostscriptOracle.h"
#include "HostModule.h"
#include "PageSizeKeys.h"
#include "PpdSources.h"
#include "SampleEps.h"
#include "TestKit.h"
#include "ServerFromPpd.h"
#include "db/PluginInitialize.h"

using printing::ServerDescriptionFromPpd;

using hf_test::AddSetting;

namespace
{
// Some HP descriptions select paper through a procedure set that lives in
// the printer; Ghostscript gets a stand-in that takes the margins and does
// nothing with them, so the rest of the command is what gets checked.
const char* const kHpResidentProcSet =
    "%!PS\n/HPDict << /SetMargins { pop } bind >> /ProcSet defineresource pop\n";

hf_test::GhostscriptReport RunOnPrinter(const wxString& psFile, const wxString& command)
{
    if (command.Find("/HPDict") == wxNOT_FOUND)
        return hf_test::RunGhostscriptBBox(psFile.ToStdString());
    const wxString withPrinter = psFile + ".printer.ps";
    testkit::WriteFile(withPrinter.ToStdString(),
                       kHpResidentProcSet + testkit::ReadFile(psFile.ToStdString()));
    return hf_test::RunGhostscriptBBox(withPrinter.ToStdString());
}

class PaperConversion : public hf_test::ModuleTest
{
protected:
    void SetUp() override
    {
        if (!testkit::ProgramAvailable("gs"))
            GTEST_SKIP() << "Ghostscript (gs) is not installed";
        ModuleTest::SetUp();
    }

    // The settings a folder has after the user picked a page, written by
    // the settings panel's own key writers. A filter object keeps the first
    // page command it is given, so every page gets a fresh one, as a host
    // does per folder.
    void LoadSettings(const wxString& server, const MapPropToValue& page)
    {
        NewPlugin();
        ASSERT_EQ(plugin->Initialize(server), 0);
        wxXmlNode filter(wxXML_ELEMENT_NODE, "Filter");
        auto* ui = new wxXmlNode(wxXML_ELEMENT_NODE, "UI");
        filter.AddChild(ui);
        AddSetting(ui, "OUTPUTFILETYPEEPS", "0");
        AddSetting(ui, "ORIGINALSIZE", "1");
        AddSetting(ui, "IMAGEPOSITION", "Center");
        for (auto it = page.begin(); it != page.end(); ++it)
            AddSetting(ui, it->first, it->second);
        ASSERT_EQ(plugin->InitilaizeFromPreference(&filter), 0);
    }

    struct Outcome
    {
        hf_test::GhostscriptReport gs;
        printing::OptionList cupsOptions; // the job overrides as CUPS options
    };

    // Converts a small artwork with the loaded settings; command tells the
    // printer-side stand-ins Ghostscript needs.
    void Convert(const wxString& command, Outcome& outcome)
    {
        testkit::ScratchDir hot, out;
        ASSERT_TRUE(testkit::WriteFile(hot.File("art.eps"), sample::RectangleEps(0, 0, 72, 36)));
        hf_test::WriteEmptyFolderConfig(out.File("Folder.cfg"));

        wxArrayString files, second, rejected;
        files.Add(hot.File("art.eps"));
        JobInfoCollection jobs;
        ASSERT_EQ(plugin->SniffFiles(files, second, rejected, jobs), 0);
        ASSERT_EQ(jobs.GetCount(), 1u);
        wxString outputName;
        ASSERT_EQ(plugin->Process("", jobs[0], out.Path(), outputName, nullptr), 0);
        outcome.gs = RunOnPrinter(out.File(outputName.ToStdString()), command);

        printing::OptionList pairs;
        for (const auto& [key, property] : hf_test::FolderOverrides(out.File("Folder.cfg")))
            pairs.emplace_back(std::string(key.utf8_str()),
                               std::string(property.GetValue().utf8_str()));
        outcome.cupsOptions = printing::CupsOptionsFromOverrides(pairs);
    }

    void ExpectPrintsOnPaper(const wxString& server, const stPageAttribute& sheet)
    {
        SCOPED_TRACE(std::string(sheet.PaperName.utf8_str()));
        MapPropToValue page;
        page["DEFAULTPAGESIZE"] = sheet.PaperName;
        WriteSheetPageKeys(page, sheet);
        LoadSettings(server, page);
        Outcome outcome;
        Convert(sheet.PSCommand, outcome);
        const auto& gs = outcome.gs;
        EXPECT_FALSE(gs.postscriptError) << gs.process.err;
        ASSERT_TRUE(gs.pageSeen && gs.marked) << gs.process.out << gs.process.err;
        EXPECT_EQ(gs.pages, 1);
        EXPECT_NEAR(gs.pageWidth, sheet.Width, 1);
        EXPECT_NEAR(gs.pageHeight, sheet.Height, 1);
        // The artwork stays inside the paper's imageable area.
        EXPECT_GE(gs.marks.llx, sheet.Left - 1);
        EXPECT_GE(gs.marks.lly, sheet.Top - 1);
        EXPECT_LE(gs.marks.urx, sheet.Right + 1);
        EXPECT_LE(gs.marks.ury, sheet.Bottom + 1);
        // The paper goes on to CUPS as the job's page size.
        EXPECT_EQ(outcome.cupsOptions,
                  (printing::OptionList{{"PageSize", std::string(sheet.PaperName.utf8_str())}}));
    }

    // Converts on the named papers (all when names is empty); returns how
    // many were tried.
    size_t ConvertOnPapers(const std::string& ppd, const std::vector<wxString>& names)
    {
        SCOPED_TRACE(ppd);
        wxString server;
        std::string error;
        EXPECT_TRUE(ServerDescriptionFromPpd(ppd, server, error)) << error;
        std::vector<stPageAttribute> sheets;
        PluginInitialize::InitializeSheetInfo(server, sheets);
        size_t tried = 0;
        for (const stPageAttribute& sheet : sheets)
        {
            if (!names.empty() &&
                std::find(names.begin(), names.end(), sheet.PaperName) == names.end())
                continue;
            ExpectPrintsOnPaper(server, sheet);
            ++tried;
        }
        return tried;
    }
};
} // namespace

TEST_F(PaperConversion, EveryPaperOfTheTestPrinter)
{
    EXPECT_EQ(ConvertOnPapers(ppd_sources::TestPpd(), {}), 4u);
}

// An A4 job through each description of the table lands on a 595 x 842 page,
// whether the description kept the printer's code or has the standard one.
TEST_F(PaperConversion, A4ThroughEachDescriptionOfTheTable)
{
    size_t tried = 0;
    for (const ppd_sources::TableCase& row : ppd_sources::DescriptionTable())
        if (access(row.path.c_str(), R_OK) == 0)
            tried += ConvertOnPapers(row.path, {"A4"});
    EXPECT_GE(tried, 2u);
}

TEST_F(PaperConversion, GenericPostScriptPrinterPapers)
{
    testkit::ScratchDir dir;
    const std::string ppd = ppd_sources::GenericPostScriptPpd(dir.Path());
    if (ppd.empty())
        GTEST_SKIP() << "ppdc or " << ppd_sources::kSampleDriver << " missing";
    EXPECT_EQ(ConvertOnPapers(ppd, {"Letter", "A4", "A5", "Env10"}), 4u);
}

TEST_F(PaperConversion, HpPrinterPapers)
{
    testkit::ScratchDir dir;
    const auto ppds = ppd_sources::HpPpds(dir.Path(), 3);
    if (ppds.empty())
        GTEST_SKIP() << ppd_sources::kHpArchive << " missing";
    for (const std::string& ppd : ppds)
        EXPECT_GE(ConvertOnPapers(ppd, {"Letter", "A4", "Legal", "Executive", "A5"}), 2u);
}

// A custom size inside the printer's limits, set up as the custom page size
// dialog does, runs through the printer's own custom size code.
TEST_F(PaperConversion, CustomSizesThroughThePrintersOwnCode)
{
    testkit::ScratchDir dir;
    std::vector<std::string> ppds = {ppd_sources::TestPpd(),
                                     std::string(HF_TEST_DATA_DIR) + "/ppd/test-jcl-custom.ppd"};
    for (const std::string& hp : ppd_sources::HpPpds(dir.Path(), 3))
        ppds.push_back(hp);
    size_t tried = 0;
    for (const std::string& ppd : ppds)
    {
        SCOPED_TRACE(ppd);
        wxString server;
        std::string error;
        ASSERT_TRUE(ServerDescriptionFromPpd(ppd, server, error)) << error;
        stCustomPageSizeAttribute custom;
        if (!PluginInitialize::InitializeCustomPageSizeInfo(server, custom))
            continue;
        const double width = std::floor((custom.MinMediaWidth + custom.MaxMediaWidth) / 2);
        const double height = std::floor((custom.MinMediaHeight + custom.MaxMediaHeight) / 2);
        MapPropToValue page;
        page["DEFAULTPAGESIZE"] = "Custom";
        WriteCustomPageKeys(page, width, height, custom, UNIT_POINT);
        LoadSettings(server, page);
        Outcome outcome;
        Convert(custom.command, outcome);
        const auto& gs = outcome.gs;
        EXPECT_FALSE(gs.postscriptError) << gs.process.err;
        ASSERT_TRUE(gs.pageSeen) << gs.process.out << gs.process.err;
        EXPECT_NEAR(gs.pageWidth, width, 1);
        EXPECT_NEAR(gs.pageHeight, height, 1);
        char expected[64];
        std::snprintf(expected, sizeof expected, "Custom.%gx%g", width, height);
        EXPECT_EQ(outcome.cupsOptions, (printing::OptionList{{"PageSize", expected}}));
        ++tried;
    }
    EXPECT_GE(tried, 1u);
}
