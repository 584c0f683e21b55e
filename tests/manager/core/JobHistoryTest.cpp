// A folder's recent jobs read from kept originals, outputs, the failure and
// printed logs and the journal; retry where an original can go back in.
#include <wx/filename.h>

#include "CoreTestSupport.h"
#include "core/JobHistory.h"
#include "folder/FolderWatcher.h"
#include "service/FailureLog.h"
#include "service/FolderJournal.h"

using namespace core_test;

namespace
{
std::string Describe(const JobEntry& job)
{
    std::string text = JobOutcomeText(job.outcome).utf8_string() + " " + job.name.utf8_string();
    if (job.retryable)
        text += " retry";
    if (!job.output.empty())
        text += " -> " + wxFileName(job.output).GetFullName().utf8_string();
    if (!job.reason.empty())
        text += ": " + job.reason.utf8_string();
    return text;
}

wxString At(const std::string& seconds)
{
    return (wxDateTime::Now() + wxTimeSpan::Seconds(std::stol(seconds))).FormatISOCombined(' ');
}

class JobHistory : public CoreTest
{
protected:
    void Place(const std::string& folder, const testkit::CaseFields& step)
    {
        const std::string container = Container(folder);
        const std::string& kind = step[0];
        const auto field = [&](size_t i) { return wxString::FromUTF8(step.at(i).c_str()); };
        if (kind == "kept")
            testkit::WriteFile(container + "/[MoveFolder]/" + step.at(1), "%!PS-Adobe-3.0 EPSF\n");
        else if (kind == "output")
            testkit::WriteFile(scratchDir.Sub(folder.substr(scratch.size() + 1) + "/Output") + "/" +
                                   step.at(1),
                               "%!PS\n");
        else if (kind == "original")
            testkit::WriteFile(container + "/[FailedFolder]/" + step.at(1), "x\n");
        else if (kind == "failure")
            ASSERT_TRUE(AppendLogLine(container + "/[FailedFolder]/failed-jobs.log",
                                      {At(step.at(2)), field(1), field(3)}));
        else if (kind == "printed")
            ASSERT_TRUE(AppendLogLine(container + "/printed-jobs.log",
                                      {At(step.at(3)), field(1), "q1", "7", field(2),
                                       "w-" + field(2), step.size() > 4 ? field(4) : ""}));
        else if (kind == "journal")
        {
            FolderJournal journal;
            wxString error;
            ASSERT_TRUE(journal.Open(container, error)) << error;
            PrintRecord print{"w-" + field(1), "q1", folder + "/Output/" + field(2), field(1)};
            ASSERT_TRUE(journal.Append(
                {FolderJournal::Deliver(print.id, field(2)), FolderJournal::Print(print)}));
        }
        else
            FAIL() << "unknown step " << kind;
    }
};

TEST_F(JobHistory, OneRowPerJobNewestFirstAndRetryWhereTheOriginalWaits)
{
    int number = 0;
    for (const auto& c : testkit::Cases("manager/core-jobs.txt", 4, 10))
    {
        SCOPED_TRACE(c[0]);
        const std::string folder = MakeFolder("j" + std::to_string(++number));
        for (const std::string& step : testkit::Split(c[2], "; "))
            Place(folder, testkit::Split(step, ","));
        const std::vector<JobEntry> jobs = ReadRecentJobs(folder, std::stoul(c[1]));
        std::vector<std::string> rows;
        for (const JobEntry& job : jobs)
            rows.push_back(Describe(job));
        EXPECT_EQ(rows, testkit::Split(c[3], "; "));

        // Retry takes exactly the rows offered; their originals come back in once.
        for (const JobEntry& job : jobs)
        {
            wxString error;
            EXPECT_EQ(RetryJob(folder, job, error), job.retryable) << Describe(job) << error;
            if (job.retryable)
            {
                EXPECT_TRUE(testkit::Exists(folder + "/" + job.name.utf8_string()));
            }
        }
        for (const JobEntry& job : ReadRecentJobs(folder, 10))
            EXPECT_FALSE(job.retryable) << Describe(job);
    }
}

TEST_F(JobHistory, NoFolderNoJobs)
{
    EXPECT_TRUE(ReadRecentJobs(scratch + "/missing", 10).empty());
    EXPECT_TRUE(ReadRecentJobs(scratch, 10).empty());
}
} // namespace
