#include "CupsSubmission.h"

#include "CupsJobOptions.h"
#include "CupsJobs.h"
#include "posix/PathNames.h"

namespace printing
{
bool SubmitToCups(const std::string& queue, const std::string& psFile, const std::string& jobName,
                  const std::vector<std::pair<std::string, std::string>>& overrides,
                  std::string& error, int* jobId)
{
    if (queue.empty())
    {
        error = "no CUPS queue named";
        return false;
    }
    const std::string title = jobName.empty() ? posix::BaseName(psFile) : jobName;
    CupsError trouble;
    const int job =
        CreateMarkedJob(queue, title, CupsOptionsFromOverrides(overrides), std::string(), trouble);
    if (job == 0)
    {
        error = trouble.reason;
        return false;
    }
    if (!SendJobDocument(queue, job, title, psFile, trouble))
    {
        error = trouble.reason;
        // A job without its document would sit in the queue for ever.
        CupsError ignored;
        CancelJob(queue, job, ignored);
        return false;
    }
    if (jobId)
        *jobId = job;
    return true;
}
} // namespace printing
