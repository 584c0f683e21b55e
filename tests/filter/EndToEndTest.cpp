// The whole road of jobs through the loaded module, as a host drives it:
// dlopen, initialise with a server description, load the folder's filter
// node, sniff, process with progress, and look at what came out.
#include <sstream>

#include <gtest/gtest.h>
#include <wx/dir.h>
#include <wx/filename.h>

#include "GhostscriptOracle.h"
#include "HostModule.h"
#include "SampleEps.h"

using namespace hf_test;

namespace
{
const char* const kServer =
    "<?xml version=\"1.0\" encoding=\"UTF-8\"?><Server><GA2_HOTFOLDERS>yes</GA2_HOTFOLDERS>"
    "<SheetInfo><PaperName>Letter</PaperName><Width>612</Width><Height>792</Height>"
    "<PSCommand>&lt;&lt;/PageSize [612 792]&gt;&gt; setpagedevice</PSCommand></SheetInfo></Server>";

class Host : public ModuleTest
{
protected:
    void SetUp() override
    {
        ModuleTest::SetUp();
        if (!HasFatalFailure())
            NewPlugin();
        WriteEmptyFolderConfig(out.File("Folder.cfg"));
    }
    // The folder's filter node as the host keeps it in Folder.cfg.
    void LoadSettings(const std::string& settings) // "KEY=value; ..."
    {
        wxXmlNode filter(wxXML_ELEMENT_NODE, "Filter");
        auto* ui = new wxXmlNode(&filter, wxXML_ELEMENT_NODE, "UI");
        std::istringstream items(settings);
        for (std::string item; std::getline(items >> std::ws, item, ';');)
            AddSetting(ui, item.substr(0, item.find('=')), item.substr(item.find('=') + 1));
        ASSERT_EQ(plugin->Initialize(kServer), 0);
        ASSERT_EQ(plugin->InitilaizeFromPreference(&filter), 0);
    }
    testkit::ScratchDir hot{"hf-hot"}, out{"hf-out"};
};
} // namespace

TEST_F(Host, FolderOfMixedFilesToPlacedPages)
{
    const std::string artwork = sample::RectangleEps(0, 0, 200, 100);
    testkit::WriteFile(hot.File("plain.eps"), artwork);
    testkit::WriteFile(hot.File("binary.eps"),
                       sample::DosEpsBinary(artwork, std::string(5000, '\x7f')));
    const bool epstool = testkit::ProgramAvailable("epstool");
    if (epstool)
    {
        const auto made =
            testkit::RunProgram({"epstool", "--add-tiff-preview", "--device", "tiffg3",
                                 hot.File("plain.eps"), hot.File("tool.eps")});
        ASSERT_EQ(made.exitCode, 0) << made.err;
    }
    testkit::WriteFile(hot.File("letter.eps"), "Dear printer,\nthis is not PostScript.\n");
    testkit::WriteFile(hot.File("notes.txt"), "notes\n");
    LoadSettings("OUTPUTFILETYPEEPS=0; ORIGINALSIZE=1; DEFAULTPAGESIZE=Letter; "
                 "PAGESIZE_COMMAND=<</PageSize [612 792]>> setpagedevice; FORCEPAGESIZEX=612; "
                 "FORCEPAGESIZEY=792; IMAGEEABLESIZELLX=18; IMAGEEABLESIZELLY=18; "
                 "IMAGEEABLESIZEURX=594; IMAGEEABLESIZEURY=774; IMAGEPOSITION=Top Left");

    // The .eps that is no EPS is dropped, the text file refused.
    wxArrayString rejected;
    JobInfoCollection jobs;
    ASSERT_EQ(plugin->SniffFolder(hot.Path(), rejected, jobs), 0);
    ASSERT_EQ(rejected.size(), 1u);
    EXPECT_EQ(wxFileName(rejected[0]).GetFullName(), "notes.txt");
    ASSERT_EQ(jobs.GetCount(), epstool ? 3u : 2u);
    for (size_t i = 0; i < jobs.GetCount(); ++i)
    {
        SCOPED_TRACE(jobs[i].jobName);
        ProgressRecorder progress;
        wxString outputName;
        ASSERT_EQ(plugin->Process("", jobs[i], out.Path(), outputName, &progress), 0);
        const wxString input = jobs[i].files[0];
        ASSERT_EQ(progress.calls.size(), 2u);
        EXPECT_EQ(progress.calls[0], std::make_pair(input, 10));
        EXPECT_EQ(progress.calls[1], std::make_pair(input, 100));
        EXPECT_EQ(outputName, wxFileName(input).GetName() + ".ps");

        const std::string ps = out.File(outputName.ToStdString());
        EXPECT_EQ(testkit::ReadFile(ps).find("\x7f\x7f\x7f"), std::string::npos)
            << "preview copied";
        const GhostscriptReport gs = RunGhostscriptBBox(ps);
        EXPECT_FALSE(gs.postscriptError) << gs.process.err;
        ASSERT_TRUE(gs.pageSeen && gs.marked) << gs.process.out << gs.process.err;
        EXPECT_NEAR(gs.pageWidth, 612, 0.5);
        EXPECT_NEAR(gs.pageHeight, 792, 0.5);
        // Landscape artwork on a portrait area is turned, then placed top left.
        EXPECT_NEAR(gs.marks.llx, 18, 1);
        EXPECT_NEAR(gs.marks.lly, 574, 1);
        EXPECT_NEAR(gs.marks.urx, 118, 1);
        EXPECT_NEAR(gs.marks.ury, 774, 1);
    }
    const auto overrides = FolderOverrides(out.File("Folder.cfg"));
    ASSERT_EQ(overrides.size(), 1u);
    EXPECT_EQ(overrides.at("PageSize").GetValue(), "Letter");
}
