// Notices over sequences of rescans: each failure, printer failure and
// printer problem once, nothing for what was there before.
#include <wx/datetime.h>

#include "CoreTestSupport.h"
#include "core/NoticeTracker.h"
#include "service/FailureLog.h"

using namespace core_test;

namespace
{
class NoticeTracking : public CoreTest
{
protected:
    void Step(const std::string& step)
    {
        const std::vector<std::string> words = testkit::Split(step, " ");
        const wxString now = wxDateTime::Now().FormatISOCombined(' ');
        const auto text = [](const std::string& word) { return wxString::FromUTF8(word.c_str()); };
        if (words[0] == "fail" || words[0] == "retried")
            ASSERT_TRUE(
                AppendLogLine(Container(folder) + "/[FailedFolder]/failed-jobs.log",
                              {now, text(words[1]),
                               words[0] == "fail" ? "not an EPS file" : "retried: moved back"}));
        else if (words[0] == "printed")
            ASSERT_TRUE(AppendLogLine(Container(folder) + "/printed-jobs.log",
                                      {now, text(words[1]), "q1", "7", text(words[2]),
                                       wxString::Format("w%d", ++jobs), "job-stopped"}));
        else if (words[0] == "reason")
            reasons = {words[1]};
        else if (words[0] == "clear")
            reasons.clear();
        else if (words[0] == "add")
        {
            const std::string late = MakeFolder(words[1]);
            ASSERT_TRUE(AppendLogLine(Container(late) + "/[FailedFolder]/failed-jobs.log",
                                      {now, "old.eps", "not an EPS file"}));
        }
        else
            ASSERT_EQ(words[0], "rescan");
    }

    std::vector<FolderRow> Rows()
    {
        std::vector<FolderRow> rows = ReadFolderRows();
        for (FolderRow& row : rows)
            if (row.path.utf8_string() == folder)
                row.status.queueReasons = reasons;
        return rows;
    }

    std::string folder;
    std::vector<std::string> reasons;
    int jobs = 0; // each verdict is another job's
};

TEST_F(NoticeTracking, EachNewFailureAndProblemOnce)
{
    std::string sequence;
    std::unique_ptr<NoticeTracker> tracker;
    int number = 0;
    for (const auto& c : testkit::Cases("manager/core-notices.txt", 4, 15))
    {
        SCOPED_TRACE(c[0] + ": " + c[1]);
        if (c[0] != sequence)
        {
            // A new sequence: a fresh warehouse with one folder, a fresh tracker.
            sequence = c[0];
            setenv("HOTFOLDER_WAREHOUSE_ROOT",
                   scratchDir.Sub("w" + std::to_string(++number)).c_str(), 1);
            folder = MakeFolder("n" + std::to_string(number));
            reasons.clear();
            tracker = std::make_unique<NoticeTracker>();
        }
        for (const std::string& step : testkit::Split(c[1], "; "))
            Step(step);
        const std::vector<Notice> notices = tracker->Update(Rows());
        EXPECT_EQ(std::to_string(notices.size()), c[2]);
        for (const Notice& notice : notices)
        {
            EXPECT_FALSE(notice.title.empty());
            EXPECT_NE((notice.title + " " + notice.message).utf8_string().find(c[3]),
                      std::string::npos)
                << notice.message;
        }
    }
}
} // namespace
