// Jobs through the converter: results, outputs, progress and job overrides
// over the table tests/data/filter/processing.txt; broken files, sniffed and
// processed, and the reasons given for them over tests/data/filter/broken.txt.
#include <sys/stat.h>
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

uint32_t HeaderField(const std::string& bytes, size_t at)
{
    uint32_t value = 0;
    for (int i = 3; i >= 0; --i)
        value = value << 8 | static_cast<unsigned char>(bytes[at + i]);
    return value;
}

// A DOS EPS binary around the rectangle whose header fields are set by the
// words "OFFSET LENGTH"; "+N" adds N to the true value.
std::string DosFile(std::istream& words)
{
    std::string bytes = sample::DosEpsBinary(sample::RectangleEps(0, 0, 200, 100), "PREVIEW");
    for (size_t at : {4, 8})
    {
        std::string word;
        words >> word;
        const uint32_t value = word[0] == '+' ? HeaderField(bytes, at) + std::stoul(word.substr(1))
                                              : static_cast<uint32_t>(std::stoul(word));
        for (int i = 0; i < 4; ++i)
            bytes[at + i] = static_cast<char>((value >> (8 * i)) & 0xFF);
    }
    return bytes;
}

// The bytes of a content field of broken.txt; "" for missing.
std::string ContentBytes(const std::string& content)
{
    std::istringstream words(content);
    std::string kind;
    words >> kind;
    if (kind == "text")
        return "plain text, no PostScript\n";
    if (kind == "box")
        return "%!PS-Adobe-3.0 EPSF-3.0\n%%BoundingBox:" + content.substr(content.find(' ')) +
               "\n%%EndComments\n0 0 moveto 1 1 lineto\n";
    if (kind == "dos")
        return DosFile(words);
    return kind == "missing" ? "" : sample::RectangleEps(0, 0, 200, 100);
}

// Sniffs the one file, processes it when it is a job and asks for the texts:
// "SNIFFED | RESULT | ERROR TEXT | REFUSAL REASON" as in broken.txt.
std::string SniffAndProcess(const std::string& path, const std::string& mode,
                            const std::string& outFolder)
{
    EPS eps("x");
    SetUpFilter(eps, {{"OUTPUTFILETYPEEPS", mode == "pass-through" ? "1" : "0"}});
    wxArrayString files, second, rejected;
    files.Add(wxString::FromUTF8(path));
    JobInfoCollection jobs;
    eps.SniffFiles(files, second, rejected, jobs);
    const std::string refusal = RefusalReason(path.c_str());
    std::string seen = jobs.empty() ? "refused | -" : "job";
    if (!jobs.empty())
    {
        wxString name;
        const long result = eps.Process("", jobs[0], wxString::FromUTF8(outFolder), name, nullptr);
        // As a host does after a failure: the object is initialised again
        // and then asked for the text.
        eps.Initialize("");
        wxString text;
        eps.GetErrorString(result, text);
        seen += " | " + std::to_string(result) + " | " +
                (result == 0 ? "-" : text.ToStdString(wxConvUTF8));
    }
    else
        seen += " | -";
    return seen + " | " + (refusal.empty() ? "-" : refusal);
}

std::string Replace(std::string text, const std::string& from, const std::string& to)
{
    for (size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
    return text;
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

TEST(Processing, BrokenFilesAndTheirReasons)
{
    for (const auto& c : testkit::Cases("filter/broken.txt", 8, 18))
    {
        SCOPED_TRACE(c[0]);
        testkit::ScratchDir in("hf-broken-in"), out("hf-broken-out");
        const std::string path = in.File(c[1]);
        const std::string bytes = ContentBytes(c[2]);
        if (c[2] != "missing")
        {
            ASSERT_TRUE(testkit::WriteFile(path, bytes));
        }
        if (c[3] == "blocked")
            out.Sub(c[1].substr(0, c[1].rfind('.')) + ".ps");
        std::string seen;
        if (c[2] == "locked")
        {
            // Only the file's own mode keeps the reader out.
            ASSERT_EQ(chmod(path.c_str(), 0), 0);
            ASSERT_EQ(chmod(in.Path().c_str(), 0755), 0);
            ASSERT_EQ(chmod(out.Path().c_str(), 0777), 0);
            seen = testkit::AsUnprivileged([&] { return SniffAndProcess(path, c[3], out.Path()); });
        }
        else
        {
            testkit::StderrCapture quiet; // the engine's own messages
            seen = SniffAndProcess(path, c[3], out.Path());
        }
        std::string expected = c[4] + " | " + c[5] + " | " + c[6] + " | " + c[7];
        expected = Replace(expected, "$SIZE", std::to_string(bytes.size()));
        if (bytes.size() >= 12)
            expected = Replace(expected, "$LENGTH", std::to_string(HeaderField(bytes, 8)));
        EXPECT_EQ(seen, expected);
    }
}

TEST(Processing, TheReasonBelongsToTheCodeOfTheLastFailedJob)
{
    testkit::ScratchDir in("hf-broken-in"), out("hf-broken-out");
    testkit::WriteFile(in.File("bad.eps"), ContentBytes("box 0 0 inf 1"));
    testkit::WriteFile(in.File("good.eps"), ContentBytes("eps"));
    EPS eps("x");
    SetUpFilter(eps, {});
    const auto process = [&](const std::string& name)
    {
        ReadyToProcessJobInfo job;
        job.filterId = "Orv.EPS.1";
        job.files.Add(wxString::FromUTF8(in.File(name)));
        wxString output;
        return eps.Process("", job, wxString::FromUTF8(out.Path()), output, nullptr);
    };
    const auto text = [&](long code)
    {
        wxString out;
        eps.GetErrorString(code, out);
        return out.ToStdString(wxConvUTF8);
    };
    const std::string reason =
        "the bounding box \"%%BoundingBox: 0 0 inf 1\" is not four finite numbers";
    EXPECT_EQ(text(-1005), "Invalid input file"); // a fresh filter has no reason
    EXPECT_EQ(process("bad.eps"), -1005);
    EXPECT_EQ(text(-1005), "Invalid input file: " + reason);
    EXPECT_EQ(text(-1003), "Filter conversion failed"); // other codes stay plain
    EXPECT_EQ(text(0), "No Error");
    eps.Initialize(""); // as hosts do after a failure: the status goes, the reason stays
    EXPECT_EQ(text(-1005), "Invalid input file: " + reason);
    EXPECT_EQ(process("good.eps"), 0);
    EXPECT_EQ(text(-1005), "Invalid input file"); // a later job starts without it
}
