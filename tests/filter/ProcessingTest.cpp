// Jobs through the converter: results, outputs, progress and job overrides
// over the table tests/data/filter/processing.txt.
#include <unistd.h>

#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "EPS.h"
#include "HostModule.h"
#include "SampleEps.h"
#include "TestKit.h"

namespace
{
std::vector<std::string> Items(const std::string& text, char separator)
{
    std::vector<std::string> items;
    std::istringstream in(text);
    for (std::string item; std::getline(in >> std::ws, item, separator);)
        if (item != "-")
            items.push_back(item);
    return items;
}

// A filter in normal mode with A4 as the page, then the given settings.
void SetUpFilter(EPS& eps, const std::vector<std::pair<std::string, std::string>>& settings)
{
    eps.GetSettings()["OUTPUTFILETYPEEPS"] = "0";
    eps.GetSettings()["DEFAULTPAGESIZE"] = "A4 ";
    eps.GetSettings()["FORCEPAGESIZEX"] = "595";
    eps.GetSettings()["FORCEPAGESIZEY"] = "842";
    for (const auto& [key, value] : settings)
        eps.GetSettings()[key] = value;
    wxXmlNode none(wxXML_ELEMENT_NODE, "Filter");
    eps.InitilaizeFromPreference(&none);
}
} // namespace

TEST(Processing, TableOfJobs)
{
    for (const auto& c : testkit::Cases("filter/processing.txt", 8, 9))
    {
        SCOPED_TRACE(c[0]);
        testkit::ScratchDir in("hf-jobs-in"), out("hf-jobs-out");
        const std::string config = out.File("Folder.cfg");
        hf_test::WriteEmptyFolderConfig(config, "folder");
        EPS eps("x");
        ReadyToProcessJobInfo job;
        job.filterId = "Orv.EPS.1";
        std::vector<std::pair<std::string, std::string>> settings;
        for (const std::string& item : Items(c[1], ';'))
        {
            const size_t equals = item.find('=');
            if (item == "pass-through") // the constructor's output type
                settings.emplace_back("OUTPUTFILETYPEEPS", "1");
            else if (item == "substrate")
                eps.Initialize("<S><SubstrateFamilySupported>yes</SubstrateFamilySupported></S>");
            else if (item == "no-config")
                unlink(config.c_str());
            else if (item == "no-filter-id")
                job.filterId.clear();
            else if (item.rfind("blocked ", 0) == 0)
                out.Sub(item.substr(8));
            else if (equals != std::string::npos)
                settings.emplace_back(item.substr(0, equals), item.substr(equals + 1));
        }
        SetUpFilter(eps, settings);
        for (const std::string& file : Items(c[2], ' '))
        {
            const std::string name = file.substr(0, file.find('='));
            testkit::WriteFile(in.File(name), file.find("=text") == std::string::npos
                                                  ? sample::RectangleEps(0, 0, 200, 100)
                                                  : "plain text\n");
            job.files.Add(in.File(name));
        }

        hf_test::ProgressRecorder progress;
        wxString name = "(unchanged)";
        const long result = eps.Process("", job, out.Path(), name, &progress);
        EXPECT_EQ(std::to_string(result), c[3]);
        EXPECT_EQ(result == 0 ? 0 : eps.GetStatus(), result);
        EXPECT_EQ(name.ToStdString(), c[4]);
        for (const std::string& output : Items(c[5], ' '))
            EXPECT_EQ(testkit::Exists(out.File(output.substr(output[0] == '!'))), output[0] != '!')
                << output;
        std::string calls;
        for (const auto& call : progress.calls)
            calls += (calls.empty() ? "" : ", ") + call.first.AfterLast('/').ToStdString() + " " +
                     std::to_string(call.second);
        EXPECT_EQ(calls.empty() ? "-" : calls, c[6]);
        std::string overrides;
        for (const auto& entry : hf_test::FolderOverrides(config))
        {
            EXPECT_EQ(entry.second.GetValue(), entry.second.GetDisplayValue());
            overrides += (overrides.empty() ? "" : "; ") + entry.first.ToStdString() + "=" +
                         entry.second.GetValue().ToStdString();
        }
        EXPECT_EQ(overrides.empty() ? "-" : overrides, c[7]);
    }
}
