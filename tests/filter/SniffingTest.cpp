// Which files become jobs, which go back to the host, which are dropped:
// the cases of tests/data/filter/sniffing.txt.
#include <unistd.h>

#include <algorithm>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "EPS.h"
#include "SampleEps.h"
#include "TestKit.h"

namespace
{
const std::string kEps = sample::RectangleEps(0, 0, 100, 50);
const std::string kFake = "%!PS-Adobe-3.0\nnot encapsulated\n";

// The words of a table field, {N*TEXT} repeated and \xHH bytes decoded.
std::vector<std::string> Words(const std::string& text)
{
    std::string expanded;
    for (size_t i = 0; i < text.size(); ++i)
    {
        const size_t star = text.find('*', i), close = text.find('}', i);
        if (text.compare(i, 2, "\\x") == 0)
            expanded += static_cast<char>(std::stoi(text.substr(i + 2, 2), nullptr, 16));
        else if (text[i] == '{')
            for (int n = std::stoi(text.substr(i + 1, star - i - 1)); n > 0; --n)
                expanded += text.substr(star + 1, close - star - 1);
        else
            expanded += text[i];
        i = text[i] == '{' ? close : text.compare(i, 2, "\\x") == 0 ? i + 3 : i;
    }
    std::istringstream in(expanded);
    std::vector<std::string> words;
    for (std::string word; in >> word;)
        words.push_back(word);
    return words;
}

void MakeEntry(const testkit::ScratchDir& dir, const std::string& entry)
{
    const size_t arrow = entry.find("->"), equals = entry.find('=');
    const std::string name = entry.substr(0, std::min(arrow, equals));
    if (arrow != std::string::npos)
        ASSERT_EQ(symlink(entry.substr(arrow + 2).c_str(), dir.File(name).c_str()), 0);
    else if (entry.back() == '/')
        dir.Sub(entry.substr(0, entry.size() - 1));
    else
        testkit::WriteFile(dir.File(name), entry.substr(name.size()) == "=text"   ? "hello\n"
                                           : entry.substr(name.size()) == "=fake" ? kFake
                                                                                  : kEps);
}

// Paths as names inside the folder, "-" for none.
std::string Names(const wxArrayString& paths, const std::string& folder, bool sort)
{
    std::vector<std::string> names;
    for (const wxString& path : paths)
        names.push_back(path.ToStdString(wxConvUTF8).substr(folder.size() + 1));
    if (sort)
        std::sort(names.begin(), names.end());
    std::string text;
    for (const std::string& name : names)
        text += (text.empty() ? "" : " ") + name;
    return names.empty() ? "-" : text;
}
} // namespace

TEST(Sniffing, TableOfFolders)
{
    for (const auto& c : testkit::Cases("filter/sniffing.txt", 6, 11))
    {
        SCOPED_TRACE(c[0]);
        testkit::ScratchDir dir("hf-sniff");
        for (const std::string& entry : Words(c[1]))
            MakeEntry(dir, entry);
        std::vector<std::string> call = Words(c[2]);
        const std::string what = call[0];
        wxArrayString paths, second, rejected;
        second.Add("stale");
        for (size_t i = 1; i < call.size(); ++i)
            paths.Add(call[i] == "-" ? wxString() : wxString::FromUTF8(dir.File(call[i])));
        const wxString folder = wxString::FromUTF8(dir.Path()) + (what == "folder/" ? "/" : "");
        EPS eps("x");
        JobInfoCollection jobs;
        long status = 0;
        if (what == "files")
        {
            status = eps.SniffFiles(paths, second, rejected, jobs);
            EXPECT_TRUE(second.empty());
        }
        else if (what == "listing")
        {
            FolderContent content;
            content.m_arrFiles = paths;
            FolderContent* listing = &content;
            status = eps.SniffFolder(folder, rejected, jobs, listing);
        }
        else if (what == "ppml")
            status = eps.IsPPMLFolder(paths.empty() ? folder : paths[0]);
        else
            status = eps.SniffFolder(folder, rejected, jobs);
        EXPECT_EQ(std::to_string(status), c[5]);
        EXPECT_EQ(what == "ppml" ? 0 : eps.GetStatus(), what == "ppml" ? 0 : status);
        EXPECT_EQ(Names(rejected, dir.Path(), what.rfind("folder", 0) == 0), c[4]);

        wxArrayString jobFiles;
        for (size_t i = 0; i < jobs.GetCount(); ++i)
        {
            EXPECT_EQ(jobs[i].filterId, "Orv.EPS.1");
            ASSERT_EQ(jobs[i].files.size(), 1u);
            EXPECT_EQ(jobs[i].jobName, jobs[i].files[0].AfterLast('/'));
            EXPECT_TRUE(jobs[i].auxText.empty());
            EXPECT_EQ(jobs[i].auxValue, 0u);
            jobFiles.Add(jobs[i].files[0]);
        }
        EXPECT_EQ(Names(jobFiles, dir.Path(), true), c[3]);
    }
}
