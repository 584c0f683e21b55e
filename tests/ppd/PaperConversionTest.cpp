// The built module, set up from a description made from a PPD, lays EPS
// artwork out on each printer paper: Ghostscript sees that paper's size.
#include <dlfcn.h>

#include <algorithm>
#include <charconv>

#include <gtest/gtest.h>
#include <hotfolder/HFPlugin.h>
#include <wx/filename.h>
#include <wx/xml/xml.h>

#include "GhostscriptOracle.h"
#include "PpdSources.h"
#include "SampleEps.h"
#include "ServerFromPpd.h"
#include "db/ConfigurationReader.h"
#include "db/FilterConfiguration.h"
#include "db/FolderConfiguration.h"
#include "db/HFDatabase.h"
#include "db/ImposeConfiguration.h"
#include "db/JobConfiguration.h"
#include "db/PluginInitialize.h"
#include "db/PreflightConfiguration.h"
#include "db/Setting.h"

namespace
{
wxString Points(double value)
{
    char text[64];
    const auto end = std::to_chars(text, text + sizeof text, value).ptr;
    return wxString::FromAscii(text, end - text);
}

void AddSetting(wxXmlNode* ui, const wxString& key, const wxString& value)
{
    auto* node = new wxXmlNode(wxXML_ELEMENT_NODE, key);
    node->AddChild(new wxXmlNode(wxXML_TEXT_NODE, "text", value));
    ui->AddChild(node);
}

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
    sample::WriteFile(withPrinter,
                      kHpResidentProcSet + hf_test::ReadWholeFile(psFile.ToStdString()));
    return hf_test::RunGhostscriptBBox(withPrinter.ToStdString());
}

class PaperConversion : public ::testing::Test
{
protected:
    void SetUp() override
    {
        if (!hf_test::ProgramAvailable("gs"))
            GTEST_SKIP() << "Ghostscript (gs) is not installed";
        module = dlopen(HF_MODULE_PATH, RTLD_NOW | RTLD_LOCAL);
        ASSERT_NE(module, nullptr) << dlerror();
        make = reinterpret_cast<GetPluginInstanceFn>(dlsym(module, "GetPluginInstance"));
        release = reinterpret_cast<ReleasePluginInstanceFn>(dlsym(module, "ReleasePluginInstance"));
        ASSERT_TRUE(make && release);
    }
    void TearDown() override
    {
        if (plugin)
            release(plugin);
        if (module)
            dlclose(module);
    }

    // The settings a folder has after the user picked this paper. A filter
    // object keeps the first page command it is given, so every paper gets
    // a fresh one, as a host does per folder.
    void ChoosePaper(const wxString& server, const stPageAttribute& sheet)
    {
        if (plugin)
            release(plugin);
        plugin = make(L"EPS");
        ASSERT_NE(plugin, nullptr);
        ASSERT_EQ(plugin->Initialize(server), 0);
        wxXmlNode filter(wxXML_ELEMENT_NODE, "Filter");
        auto* ui = new wxXmlNode(wxXML_ELEMENT_NODE, "UI");
        filter.AddChild(ui);
        AddSetting(ui, "OUTPUTFILETYPEEPS", "0");
        AddSetting(ui, "ORIGINALSIZE", "1");
        AddSetting(ui, "DEFAULTPAGESIZE", sheet.PaperName);
        AddSetting(ui, "PAGESIZE_COMMAND", sheet.PSCommand);
        AddSetting(ui, "FORCEPAGESIZEX", Points(sheet.Width));
        AddSetting(ui, "FORCEPAGESIZEY", Points(sheet.Height));
        AddSetting(ui, "IMAGEEABLESIZELLX", Points(sheet.Left));
        AddSetting(ui, "IMAGEEABLESIZELLY", Points(sheet.Top));
        AddSetting(ui, "IMAGEEABLESIZEURX", Points(sheet.Right));
        AddSetting(ui, "IMAGEEABLESIZEURY", Points(sheet.Bottom));
        AddSetting(ui, "IMAGEPOSITION", "Center");
        ASSERT_EQ(plugin->InitilaizeFromPreference(&filter), 0);
    }

    void ExpectPrintsOnPaper(const wxString& server, const stPageAttribute& sheet)
    {
        SCOPED_TRACE(std::string(sheet.PaperName.utf8_str()));
        ChoosePaper(server, sheet);
        sample::ScratchDir hot, out;
        ASSERT_TRUE(sample::WriteFile(hot.File("art.eps"), sample::RectangleEps(0, 0, 72, 36)));
        db::Setting setting;
        setting.SetName("hot");
        wxString saved;
        db::HFDatabase::WriteFolderProperties(
            wxFileName(out.Path(), "Folder.cfg").GetFullPath(), setting, db::JobConfiguration(),
            db::FolderConfiguration(), db::FilterConfiguration(), db::ImposeConfiguration(),
            db::PreflightConfiguration(), saved);

        wxArrayString files, second, rejected;
        files.Add(hot.File("art.eps"));
        JobInfoCollection jobs;
        ASSERT_EQ(plugin->SniffFiles(files, second, rejected, jobs), 0);
        ASSERT_EQ(jobs.GetCount(), 1u);
        wxString outputName;
        ASSERT_EQ(plugin->Process("", jobs[0], out.Path(), outputName, nullptr), 0);

        const auto gs = RunOnPrinter(out.File(outputName), sheet.PSCommand);
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

        // The paper goes on to the print server as the job's page size.
        db::JobConfiguration overrides;
        db::ConfigurationReader::ReadJobConfiguration(out.File("Folder.cfg"), overrides);
        ASSERT_EQ(overrides.GetProperties().count("PageSize"), 1u);
        EXPECT_EQ(overrides.GetProperties().at("PageSize").GetValue(), sheet.PaperName);
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

    void* module = nullptr;
    HFPlugin* plugin = nullptr;
    GetPluginInstanceFn make = nullptr;
    ReleasePluginInstanceFn release = nullptr;
};
} // namespace

TEST_F(PaperConversion, EveryPaperOfTheTestPrinter)
{
    EXPECT_EQ(ConvertOnPapers(ppd_sources::TestPpd(), {}), 4u);
}

TEST_F(PaperConversion, GenericPostScriptPrinterPapers)
{
    sample::ScratchDir dir;
    const std::string ppd = ppd_sources::GenericPostScriptPpd(dir.Path().ToStdString());
    if (ppd.empty())
        GTEST_SKIP() << "ppdc or " << ppd_sources::kSampleDriver << " missing";
    EXPECT_EQ(ConvertOnPapers(ppd, {"Letter", "A4", "A5", "Env10"}), 4u);
}

TEST_F(PaperConversion, HpPrinterPapers)
{
    sample::ScratchDir dir;
    const auto ppds = ppd_sources::HpPpds(dir.Path().ToStdString(), 3);
    if (ppds.empty())
        GTEST_SKIP() << ppd_sources::kHpArchive << " missing";
    for (const std::string& ppd : ppds)
        EXPECT_GE(ConvertOnPapers(ppd, {"Letter", "A4", "Legal", "Executive", "A5"}), 2u);
}
