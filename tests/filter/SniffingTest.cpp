// Which files become jobs, which go back to the host, which are dropped.
#include <unistd.h>

#include <cstdio>

#include <gtest/gtest.h>

#include "EPS.h"
#include "SampleEps.h"

namespace
{
struct Folder : ::testing::Test
{
    sample::ScratchDir dir;
    EPS eps{"x"};
    wxString Eps(const wxString& name)
    {
        const wxString path = dir.File(name);
        sample::WriteFile(path, sample::RectangleEps(0, 0, 100, 50));
        return path;
    }
    wxString Text(const wxString& name, const std::string& content = "hello\n")
    {
        const wxString path = dir.File(name);
        sample::WriteFile(path, content);
        return path;
    }
};

wxArrayString List(std::initializer_list<wxString> items)
{
    wxArrayString list;
    for (const wxString& item : items)
        list.Add(item);
    return list;
}
} // namespace

TEST_F(Folder, FileListAcceptsEpsAndReportsEarlierRefusals)
{
    const wxString a = Text("a.txt"), b = Eps("b.eps"), c = Text("c.txt");
    wxArrayString second = List({"stale"}), rejected;
    JobInfoCollection jobs;
    EXPECT_EQ(eps.SniffFiles(List({a, b, c}), second, rejected, jobs), 0);
    ASSERT_EQ(jobs.GetCount(), 1u);
    EXPECT_EQ(jobs[0].filterId, "Orv.EPS.1");
    EXPECT_EQ(jobs[0].jobName, "b.eps");
    ASSERT_EQ(jobs[0].files.size(), 1u);
    EXPECT_EQ(jobs[0].files[0], b);
    EXPECT_TRUE(jobs[0].auxText.empty());
    EXPECT_EQ(jobs[0].auxValue, 0u);
    EXPECT_EQ(rejected, List({a}));
    EXPECT_TRUE(second.empty());
}

TEST_F(Folder, ExtensionInAnyCaseButOnlyEps)
{
    const wxString mixed = Eps("x.EpS"), ps = Eps("x.ps"), epsf = Eps("x.epsf");
    const wxString fake = Text("fake.eps", "%!PS-Adobe-3.0\nnot encapsulated\n");
    wxArrayString second, rejected;
    JobInfoCollection jobs;
    eps.SniffFiles(List({ps, epsf, fake, mixed}), second, rejected, jobs);
    ASSERT_EQ(jobs.GetCount(), 1u);
    EXPECT_EQ(jobs[0].jobName, "x.EpS");
    EXPECT_EQ(rejected, List({ps, epsf, fake}));
}

TEST_F(Folder, EmptyPathStopsButKeepsEarlierJobs)
{
    const wxString first = Eps("1.eps"), later = Eps("2.eps");
    wxArrayString second, rejected;
    JobInfoCollection jobs;
    EXPECT_EQ(eps.SniffFiles(List({first, "", later}), second, rejected, jobs), -1002);
    EXPECT_EQ(eps.GetStatus(), -1002);
    EXPECT_EQ(jobs.GetCount(), 1u);

    jobs.Clear();
    EXPECT_EQ(eps.SniffFiles(wxArrayString(), second, rejected, jobs), 0);
    EXPECT_EQ(jobs.GetCount(), 0u);
    EXPECT_TRUE(rejected.empty());
}

TEST_F(Folder, FolderListingDropsFakeEpsAndRefusesOthers)
{
    Eps("good.eps");
    const wxString note = Text("note.txt");
    Text("bad.eps", "not PostScript at all\n");
    dir.Sub("sub");
    sample::WriteFile(dir.File("sub/inner.eps"), sample::RectangleEps(0, 0, 10, 10));
    wxArrayString rejected;
    JobInfoCollection jobs;
    EXPECT_EQ(eps.SniffFolder(dir.Path(), rejected, jobs), 0);
    ASSERT_EQ(jobs.GetCount(), 1u);
    EXPECT_EQ(jobs[0].jobName, "good.eps");
    EXPECT_EQ(rejected, List({note}));
}

TEST_F(Folder, HostListingIsUsedAsGiven)
{
    const wxString listed = Eps("listed.eps");
    Eps("unlisted.eps");
    FolderContent content;
    content.m_arrFiles.Add(listed);
    FolderContent* pointer = &content;
    wxArrayString rejected;
    JobInfoCollection jobs;
    EXPECT_EQ(eps.SniffFolder(dir.Path(), rejected, jobs, pointer), 0);
    ASSERT_EQ(jobs.GetCount(), 1u);
    EXPECT_EQ(jobs[0].files[0], listed);
}

TEST_F(Folder, PpmlJobsAreLeftAloneOrRefusedWhole)
{
    const wxString artwork = Eps("art.eps");
    dir.Sub("job");
    Text("job/Job.PPML", "<PPML/>");
    EXPECT_TRUE(eps.IsPPMLFolder(dir.Path()));

    wxArrayString rejected;
    JobInfoCollection jobs;
    eps.GetSettings(); // status untouched by the three-argument form
    EXPECT_EQ(eps.SniffFolder(dir.Path(), rejected, jobs), 0);
    EXPECT_EQ(jobs.GetCount(), 0u);
    EXPECT_TRUE(rejected.empty());

    FolderContent content;
    content.m_arrFiles.Add(artwork);
    content.m_arrFiles.Add(dir.File("job/Job.PPML"));
    FolderContent* pointer = &content;
    rejected.Add("replaced");
    EXPECT_EQ(eps.SniffFolder(dir.Path(), rejected, jobs, pointer), 0);
    EXPECT_EQ(rejected, content.m_arrFiles);
    EXPECT_EQ(jobs.GetCount(), 0u);

    // A second PPML file makes it an ordinary folder again.
    Text("other.PPML", "<PPML/>");
    EXPECT_FALSE(eps.IsPPMLFolder(dir.Path()));
    EXPECT_FALSE(eps.IsPPMLFolder(dir.File("missing")));
}

TEST_F(Folder, ListingSkipsHiddenNamesAndFolderLinksButFollowsFileLinks)
{
    Eps(".hidden.eps");
    const wxString target = Eps("target.eps");
    const wxString link = dir.File("link.eps");
    ASSERT_EQ(symlink(target.fn_str(), link.fn_str()), 0);
    dir.Sub("folder.eps");
    ASSERT_EQ(symlink(dir.File("folder.eps").fn_str(), dir.File("dirlink.eps").fn_str()), 0);
    const wxString dangling = dir.File("dangling.txt");
    ASSERT_EQ(symlink("nowhere", dangling.fn_str()), 0);

    wxArrayString rejected;
    JobInfoCollection jobs;
    EXPECT_EQ(eps.SniffFolder(dir.Path() + "/", rejected, jobs), 0);
    wxArrayString names;
    for (size_t i = 0; i < jobs.GetCount(); ++i)
        names.Add(jobs[i].files[0]);
    names.Sort();
    EXPECT_EQ(names, List({link, target}));
    EXPECT_EQ(rejected, List({dangling}));
}

TEST_F(Folder, PpmlNamesCountAtAnyDepthLowerCaseFirstAndLinksUnfollowed)
{
    // Deeper than any limit on open folders; lower case outranks upper case.
    wxString deep = "d";
    for (int level = 0; level < 60; ++level)
        deep += "/d";
    dir.Sub(deep);
    Text(deep + "/.job.ppml", "<PPML/>");
    Text("one.PPML", "<PPML/>");
    Text("two.PPML", "<PPML/>");
    dir.Sub("folder.ppml"); // a folder is not a PPML file
    EXPECT_TRUE(eps.IsPPMLFolder(dir.Path()));

    // A link counts by its own name; the folder it points to is not entered.
    ASSERT_EQ(symlink(dir.File("d").fn_str(), dir.File("d-link").fn_str()), 0);
    EXPECT_TRUE(eps.IsPPMLFolder(dir.Path()));
    ASSERT_EQ(symlink("nowhere", dir.File("link.ppml").fn_str()), 0);
    EXPECT_FALSE(eps.IsPPMLFolder(dir.Path()));
}

TEST_F(Folder, ListingKeepsNamesBeyondAscii)
{
    const wxString name = wxString::FromUTF8("Gr\xc3\xbc\xc3\x9f"
                                             "e-\xc3\xb1.eps");
    const wxString path = Eps(name);
    // Bytes that are no text in any encoding: never a crash, never a job.
    const std::string raw = std::string(dir.Path().fn_str()) + "/\xff\xfe.eps";
    FILE* file = std::fopen(raw.c_str(), "w");
    ASSERT_NE(file, nullptr);
    std::fputs("not an EPS file\n", file);
    std::fclose(file);

    wxArrayString rejected;
    JobInfoCollection jobs;
    EXPECT_EQ(eps.SniffFolder(dir.Path(), rejected, jobs), 0);
    ASSERT_EQ(jobs.GetCount(), 1u);
    EXPECT_EQ(jobs[0].jobName, name);
    EXPECT_EQ(jobs[0].files[0], path);
    EXPECT_TRUE(rejected.empty());
}
