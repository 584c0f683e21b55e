// The folder's journal read back as a killed process left it, its rewrite,
// the folder lock's holder and the pause of held printing.
#include <sys/stat.h>

#include "HostTestSupport.h"
#include "cli/ConsoleText.h"
#include "service/FolderJournal.h"
#include "service/FolderLock.h"
#include "service/FolderPrinting.h"

using namespace host_test;

namespace
{
std::string Unescaped(const std::string& text)
{
    std::string out;
    for (size_t i = 0; i < text.size(); ++i)
        if (text[i] == '\\' && i + 1 < text.size() && (text[i + 1] == 't' || text[i + 1] == 'n'))
            out += text[++i] == 't' ? '\t' : '\n';
        else
            out += text[i];
    return out;
}

// "deliveries j1=a.ps; prints j1@office:12:sent", "-" for none.
std::string ReadBack(const FolderJournal& journal, const std::vector<std::string>& ids)
{
    std::string deliveries, prints;
    for (const std::string& id : ids)
        if (!journal.DeliveryOf(id).empty())
            deliveries += " " + id + "=" + ToUtf8(journal.DeliveryOf(id));
    for (const PrintRecord& print : journal.Prints())
        prints += " " + ToUtf8(print.id) + "@" + print.queue + ":" +
                  std::to_string(print.schedulerJob) + (print.sent ? ":sent" : ":unsent");
    return "deliveries" + (deliveries.empty() ? " -" : deliveries) + "; prints" +
           (prints.empty() ? " -" : prints);
}
} // namespace

TEST(HostJournal, WhatAKilledProcessLeftIsReadBack)
{
    for (const testkit::CaseFields& row : testkit::Cases("host/journal.txt", 3, 10))
    {
        SCOPED_TRACE(row[2]);
        testkit::ScratchDir dir{"hf-journal"};
        testkit::WriteFile(dir.File(FolderJournal::kFileName), Unescaped(row[0]));
        FolderJournal journal;
        wxString error;
        ASSERT_TRUE(journal.Open(FromUtf8(dir.Path()), error)) << error;
        EXPECT_EQ(ReadBack(journal, {"j1", "j2", "j9"}), Unescaped(row[1]));
    }
}

TEST(HostJournal, ARewriteKeepsTheLiveRecordsAndTheFilesMode)
{
    testkit::ScratchDir dir{"hf-journal"};
    const std::string path = dir.File(FolderJournal::kFileName);
    {
        FolderJournal journal;
        wxString error;
        ASSERT_TRUE(journal.Open(FromUtf8(dir.Path()), error)) << error;
        PrintRecord print;
        print.id = "live";
        print.queue = "office";
        print.output = "/o/live.ps";
        print.jobName = "live.eps";
        ASSERT_TRUE(journal.Append({FolderJournal::Print(print), FolderJournal::Job("live", 7)}));
        for (int i = 0; i < 400; ++i)
        {
            const wxString id = wxString::Format("done%d", i);
            ASSERT_TRUE(journal.Append({FolderJournal::Deliver(id, id + ".ps")}));
            journal.ForgetDelivery(id);
            journal.CompactIfLarge();
        }
        ASSERT_TRUE(journal.Append({FolderJournal::Deliver("kept", "kept.ps")}, false));
    }
    EXPECT_LT(testkit::ReadFile(path).size(), 4000u) << "rewritten with the live records";
    struct stat info;
    ASSERT_EQ(stat(path.c_str(), &info), 0);
    EXPECT_EQ(info.st_mode & 07777, 0644u);
    FolderJournal journal;
    wxString error;
    ASSERT_TRUE(journal.Open(FromUtf8(dir.Path()), error)) << error;
    EXPECT_EQ(ReadBack(journal, {"kept", "live", "done0"}),
              "deliveries kept=kept.ps; prints live@office:7:unsent");
}

TEST(HostFolderLock, TheHolderIsNamedWhateverErrnoWasBefore)
{
    testkit::ScratchDir dir{"hf-lock"};
    FolderLock lock;
    wxString error;
    errno = EACCES; // left over from an earlier call: no reason to open read-only
    ASSERT_TRUE(lock.Acquire(FromUtf8(dir.Path()), FolderLock::Holder::Run, error)) << error;
    EXPECT_EQ(ToUtf8(FolderLock::HolderOf(FromUtf8(dir.Path()))),
              "worked by another run, pid " + std::to_string(getpid()));
}

TEST(HostPrintingHold, ThePauseDoublesUpToItsLongest)
{
    std::vector<long> pauses;
    std::chrono::milliseconds pause{0};
    for (int i = 0; i < 7; ++i)
        pauses.push_back((pause = FolderPrinting::NextPause(pause)).count());
    EXPECT_EQ(pauses, (std::vector<long>{500, 1000, 2000, 4000, 8000, 8000, 8000}));
}
