// The built module, set up from a description made from a PPD, lays EPS
// artwork out on a printer's paper: Ghostscript sees that paper's size.
// One case a line of papers.txt.
#include <cstdio>

#include <gtest/gtest.h>

#include "CupsJobOptions.h"
#include "GhostscriptOracle.h"
#include "HostModule.h"
#include "PageSizeKeys.h"
#include "PpdCases.h"
#include "SampleEps.h"
#include "ServerFromPpd.h"
#include "db/PluginInitialize.h"

namespace
{
// Some HP descriptions select paper through a procedure set that lives in
// the printer; Ghostscript gets a stand-in that takes the margins (or the
// margin type) and does nothing with them, so the rest of the command is
// what gets checked.
const char* const kHpResidentProcSet =
    "%!PS\n/HPDict << /SetMargins { pop } bind /SetMarginType { pop } bind >>\n"
    "/ProcSet defineresource pop\n";

class PaperConversion : public hf_test::ModuleTest
{
protected:
    void SetUp() override
    {
        if (!testkit::ProgramAvailable("gs"))
            GTEST_SKIP() << "Ghostscript (gs) is not installed";
        ModuleTest::SetUp();
    }

    // Converts a rectangle with the settings the panel writes for the page;
    // the printed PostScript goes to Ghostscript, the job overrides to CUPS
    // options.
    void Convert(const wxString& server, const MapPropToValue& page, const wxString& command,
                 hf_test::GhostscriptReport& gs, printing::OptionList& cupsOptions)
    {
        NewPlugin();
        ASSERT_EQ(plugin->Initialize(server), 0);
        wxXmlNode filter(wxXML_ELEMENT_NODE, "Filter");
        auto* ui = new wxXmlNode(wxXML_ELEMENT_NODE, "UI");
        filter.AddChild(ui);
        hf_test::AddSetting(ui, "OUTPUTFILETYPEEPS", "0");
        hf_test::AddSetting(ui, "ORIGINALSIZE", "1");
        hf_test::AddSetting(ui, "IMAGEPOSITION", "Center");
        for (const auto& [key, value] : page)
            hf_test::AddSetting(ui, key, value);
        ASSERT_EQ(plugin->InitilaizeFromPreference(&filter), 0);

        testkit::ScratchDir dir;
        testkit::WriteFile(dir.File("art.eps"), sample::RectangleEps(0, 0, 72, 36));
        hf_test::WriteEmptyFolderConfig(dir.File("Folder.cfg"));
        wxArrayString files, second, rejected;
        files.Add(dir.File("art.eps"));
        JobInfoCollection jobs;
        ASSERT_EQ(plugin->SniffFiles(files, second, rejected, jobs), 0);
        ASSERT_EQ(jobs.GetCount(), 1u);
        wxString output;
        ASSERT_EQ(plugin->Process("", jobs[0], dir.Path(), output, nullptr), 0);
        std::string ps = testkit::ReadFile(dir.File(output.ToStdString()));
        if (command.Find("/HPDict") != wxNOT_FOUND)
            ps = kHpResidentProcSet + ps;
        testkit::WriteFile(dir.File("printer.ps"), ps);
        gs = hf_test::RunGhostscriptBBox(dir.File("printer.ps"));

        printing::OptionList pairs;
        for (const auto& [key, property] : hf_test::FolderOverrides(dir.File("Folder.cfg")))
            pairs.emplace_back(std::string(key.utf8_str()),
                               std::string(property.GetValue().utf8_str()));
        cupsOptions = printing::CupsOptionsFromOverrides(pairs);
    }
};
} // namespace

TEST_F(PaperConversion, EachPaperOfTheTable)
{
    testkit::ScratchDir dir;
    size_t tried = 0;
    for (const testkit::CaseFields& row : testkit::ReadCaseTable("ppd/papers.txt"))
    {
        SCOPED_TRACE(row[0] + " " + row[1] + ": " + row.back());
        const std::string ppd = ppd_cases::Resolve(row[0], dir.Path());
        if (ppd.empty())
            continue;
        wxString server;
        std::string error;
        ASSERT_TRUE(printing::ServerDescriptionFromPpd(ppd, server, error)) << error;
        double width = 0, height = 0;
        ASSERT_EQ(std::sscanf(row[2].c_str(), "%lf %lf", &width, &height), 2);

        MapPropToValue page;
        page["DEFAULTPAGESIZE"] = row[1].substr(0, row[1].find(' '));
        std::string expectedPaper = row[1];
        hf_test::Box imageable{0, 0, width, height};
        wxString command;
        if (row[1].rfind("Custom ", 0) == 0)
        {
            stCustomPageSizeAttribute custom;
            ASSERT_TRUE(PluginInitialize::InitializeCustomPageSizeInfo(server, custom));
            WriteCustomPageKeys(page, width, height, custom, UNIT_POINT);
            command = custom.command;
            expectedPaper = "Custom." + row[1].substr(7);
        }
        else
        {
            std::vector<stPageAttribute> sheets;
            PluginInitialize::InitializeSheetInfo(server, sheets);
            for (const stPageAttribute& sheet : sheets)
                if (sheet.PaperName == row[1])
                {
                    WriteSheetPageKeys(page, sheet);
                    command = sheet.PSCommand;
                    imageable = {sheet.Left, sheet.Top, sheet.Right, sheet.Bottom};
                }
            ASSERT_FALSE(command.empty()) << "no such paper";
        }
        hf_test::GhostscriptReport gs;
        printing::OptionList cupsOptions;
        Convert(server, page, command, gs, cupsOptions);
        EXPECT_FALSE(gs.postscriptError) << gs.process.err;
        ASSERT_TRUE(gs.pageSeen && gs.marked) << gs.process.out << gs.process.err;
        EXPECT_EQ(gs.pages, 1);
        EXPECT_NEAR(gs.pageWidth, width, 1);
        EXPECT_NEAR(gs.pageHeight, height, 1);
        EXPECT_GE(gs.marks.llx, imageable.llx - 1);
        EXPECT_GE(gs.marks.lly, imageable.lly - 1);
        EXPECT_LE(gs.marks.urx, imageable.urx + 1);
        EXPECT_LE(gs.marks.ury, imageable.ury + 1);
        EXPECT_EQ(cupsOptions, (printing::OptionList{{"PageSize", expectedPaper}}));
        ++tried;
    }
    EXPECT_GE(tried, 7u);
}
