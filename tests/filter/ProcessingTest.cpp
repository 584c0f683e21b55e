// Jobs through the converter: results, outputs, progress, job overrides.
#include <clocale>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>
#include <wx/filename.h>

#include "EPS.h"
#include "HostModule.h"
#include "SampleEps.h"

using hf_test::FolderOverrides;

namespace
{
struct Jobs : ::testing::Test
{
    sample::ScratchDir in, out;
    EPS eps{"x"};
    hf_test::ProgressRecorder progress;

    void SetUp() override
    {
        // Normal mode with A4 as the page.
        eps.GetSettings()["OUTPUTFILETYPEEPS"] = "0";
        eps.GetSettings()["DEFAULTPAGESIZE"] = "A4 ";
        eps.GetSettings()["FORCEPAGESIZEX"] = "595";
        eps.GetSettings()["FORCEPAGESIZEY"] = "842";
        wxXmlNode none(wxXML_ELEMENT_NODE, "Filter");
        eps.InitilaizeFromPreference(&none);
        hf_test::WriteEmptyFolderConfig(out.File("Folder.cfg"), "folder");
    }

    db::JobConfiguration::Map Overrides() { return FolderOverrides(out.File("Folder.cfg")); }

    ReadyToProcessJobInfo Job(std::initializer_list<wxString> files)
    {
        ReadyToProcessJobInfo job;
        job.filterId = "Orv.EPS.1";
        for (const wxString& f : files)
            job.files.Add(f);
        return job;
    }

    wxString Eps(const wxString& name)
    {
        const wxString path = in.File(name);
        sample::WriteFile(path, sample::RectangleEps(0, 0, 200, 100));
        return path;
    }
};
} // namespace

TEST_F(Jobs, ConvertsIntoTheOutputFolderAndWritesThePageSize)
{
    const wxString input = Eps("art.work.eps");
    wxString name;
    EXPECT_EQ(eps.Process("", Job({input}), out.Path(), name, &progress), 0);
    EXPECT_EQ(name, "art.work.ps");
    EXPECT_TRUE(wxFileName::FileExists(out.File("art.work.ps")));
    ASSERT_EQ(progress.calls.size(), 2u);
    EXPECT_EQ(progress.calls[0], std::make_pair(input, 10));
    EXPECT_EQ(progress.calls[1], std::make_pair(input, 100));

    const auto overrides = Overrides();
    ASSERT_EQ(overrides.size(), 1u);
    EXPECT_EQ(overrides.at("PageSize").GetValue(), "A4"); // trailing blank trimmed
}

TEST_F(Jobs, CustomPageSizeOverridesKeepTheStoredTexts)
{
    eps.GetSettings()["CUSTOMPAGESIZE"] = "1";
    eps.GetSettings()["FORCEPAGESIZEX"] = "612";
    eps.GetSettings()["FORCEPAGESIZEY"] = "792.500000";
    wxString name;
    EXPECT_EQ(eps.Process("", Job({Eps("a.eps")}), out.Path(), name, nullptr), 0);
    const auto overrides = Overrides();
    ASSERT_EQ(overrides.size(), 2u);
    EXPECT_EQ(overrides.at("PageSize").GetValue(), "Custom");
    EXPECT_EQ(overrides.at("CustomPageSize").GetValue(), "612 792.500000");
    EXPECT_EQ(overrides.at("CustomPageSize").GetDisplayValue(), "612 792.500000");
}

TEST_F(Jobs, OnlyTheLastFileDecides)
{
    const wxString first = Eps("first.eps"), second = Eps("second.eps");
    // A directory where the first output should go makes its conversion fail.
    out.Sub("first.ps");
    wxString name;
    EXPECT_EQ(eps.Process("", Job({first, second}), out.Path(), name, &progress), 0);
    EXPECT_EQ(name, "second.ps");
    EXPECT_EQ(progress.calls.size(), 4u);
    EXPECT_EQ(Overrides().count("PageSize"), 1u);

    // The other way round the job fails and writes no overrides.
    hf_test::WriteEmptyFolderConfig(out.File("Folder.cfg"), "folder");
    out.Sub("second2.ps");
    const wxString second2 = Eps("second2.eps");
    EXPECT_EQ(eps.Process("", Job({first, second2}), out.Path(), name, nullptr), -1003);
    EXPECT_EQ(eps.GetStatus(), -1003);
    EXPECT_EQ(name, "second2.ps");
    EXPECT_TRUE(Overrides().empty());
}

TEST_F(Jobs, NonEpsStopsAtOnceAfterTheFirstReport)
{
    const wxString good = Eps("good.eps");
    const wxString bad = in.File("bad.eps");
    sample::WriteFile(bad, "plain text\n");
    const wxString after = Eps("after.eps");
    wxString name;
    EXPECT_EQ(eps.Process("", Job({good, bad, after}), out.Path(), name, &progress), -1005);
    EXPECT_EQ(eps.GetStatus(), -1005);
    EXPECT_TRUE(wxFileName::FileExists(out.File("good.ps")));
    EXPECT_FALSE(wxFileName::FileExists(out.File("after.ps")));
    ASSERT_EQ(progress.calls.size(), 3u);
    EXPECT_EQ(progress.calls[2], std::make_pair(bad, 10));
    EXPECT_TRUE(Overrides().empty());
}

TEST_F(Jobs, EmptyJobsAndMissingFilter)
{
    wxString name = "unchanged";
    EXPECT_EQ(eps.Process("", Job({}), out.Path(), name, &progress), -1002);
    ReadyToProcessJobInfo anonymous = Job({Eps("a.eps")});
    anonymous.filterId.clear();
    EXPECT_EQ(eps.Process("", anonymous, out.Path(), name, &progress), -1006);
    EXPECT_EQ(eps.GetStatus(), -1006);
    EXPECT_EQ(name, "unchanged");
    EXPECT_TRUE(progress.calls.empty());
}

TEST_F(Jobs, PassThroughTouchesNothing)
{
    EPS passThrough("p");
    wxXmlNode none(wxXML_ELEMENT_NODE, "Filter");
    passThrough.InitilaizeFromPreference(&none); // the constructor's default is pass-through
    ASSERT_TRUE(passThrough.IsOutputTypeOne());
    const wxString a = Eps("a.eps");
    const wxString b = in.File("b.EPS");
    sample::WriteFile(b, "not even EPS");
    wxString name;
    EXPECT_EQ(passThrough.Process("", Job({a, b}), out.Path(), name, &progress), 0);
    EXPECT_EQ(name, "b.EPS");
    EXPECT_EQ(progress.calls.size(), 4u);
    EXPECT_EQ(progress.calls[3], std::make_pair(b, 100));
    EXPECT_FALSE(wxFileName::FileExists(out.File("a.ps")));
    EXPECT_TRUE(Overrides().empty());
}

TEST_F(Jobs, SubstrateFamiliesMeanNoOverrides)
{
    eps.Initialize("<S><SubstrateFamilySupported>yes</SubstrateFamilySupported></S>");
    wxString name;
    EXPECT_EQ(eps.Process("", Job({Eps("a.eps")}), out.Path(), name, nullptr), 0);
    EXPECT_TRUE(Overrides().empty());
}

TEST_F(Jobs, NoFolderConfigurationNoOverridesNoFailure)
{
    wxRemoveFile(out.File("Folder.cfg"));
    wxString name;
    EXPECT_EQ(eps.Process("", Job({Eps("a.eps")}), out.Path(), name, nullptr), 0);
    EXPECT_FALSE(wxFileName::FileExists(out.File("Folder.cfg")));
}

TEST_F(Jobs, DecimalCommaLanguageStillWritesPoints)
{
    const std::string saved = std::setlocale(LC_ALL, nullptr);
    if (!std::setlocale(LC_ALL, "de_DE.UTF-8"))
        GTEST_SKIP() << "de_DE.UTF-8 is not generated";
    // What a German application language leaves behind: a decimal-comma C
    // locale. The stored settings keep their points.
    eps.GetSettings()["IMAGEEABLESIZELLX"] = "12.5";
    eps.GetSettings()["IMAGEEABLESIZELLY"] = "12.5";
    eps.GetSettings()["IMAGEEABLESIZEURX"] = "582.5";
    eps.GetSettings()["IMAGEEABLESIZEURY"] = "829.5";
    eps.LoadEPSParams();
    wxString name;
    const long status = eps.Process("", Job({Eps("komma.eps")}), out.Path(), name, nullptr);
    std::setlocale(LC_ALL, saved.c_str());
    ASSERT_EQ(status, 0);
    const std::string ps = sample::ReadFile(out.File("komma.ps"));
    EXPECT_NE(ps.find("%%HiResBoundingBox: 12.5 12.5 582.5 829.5\r\n"), std::string::npos);
    EXPECT_EQ(ps.find("12,5"), std::string::npos);
}
