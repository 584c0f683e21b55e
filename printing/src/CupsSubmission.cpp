#include "CupsSubmission.h"

#include <cstdio>
#include <memory>

#include <cups/cups.h>

#include "CupsJobOptions.h"
#include "posix/PathNames.h"

namespace printing
{
namespace
{
struct OptionsHolder
{
    int count = 0;
    cups_option_t* options = nullptr;
    ~OptionsHolder() { cupsFreeOptions(count, options); }
};

struct FileCloser
{
    void operator()(FILE* file) const { std::fclose(file); }
};

std::string LastCupsError(const char* what)
{
    std::string reason = cupsLastErrorString() ? cupsLastErrorString() : "";
    if (reason.empty())
        reason = ippErrorString(cupsLastError());
    return std::string(what) + ": " + reason;
}

// Streams the file as the job's only document. False with the reason set.
bool SendDocument(const char* queue, int job, const std::string& title, FILE* file,
                  std::string& error)
{
    if (cupsStartDocument(CUPS_HTTP_DEFAULT, queue, job, title.c_str(), CUPS_FORMAT_POSTSCRIPT,
                          1) != HTTP_STATUS_CONTINUE)
    {
        error = LastCupsError("the scheduler refused the document");
        return false;
    }
    char buffer[64 * 1024];
    size_t got = 0;
    while ((got = std::fread(buffer, 1, sizeof buffer, file)) > 0)
    {
        if (cupsWriteRequestData(CUPS_HTTP_DEFAULT, buffer, got) != HTTP_STATUS_CONTINUE)
        {
            cupsFinishDocument(CUPS_HTTP_DEFAULT, queue);
            error = LastCupsError("sending the document failed");
            return false;
        }
    }
    const bool readFailed = std::ferror(file) != 0;
    if (cupsFinishDocument(CUPS_HTTP_DEFAULT, queue) != IPP_STATUS_OK)
    {
        error = LastCupsError("the scheduler did not accept the document");
        return false;
    }
    if (readFailed)
    {
        error = "reading the output file failed";
        return false;
    }
    return true;
}
} // namespace

bool SubmitToCups(const std::string& queue, const std::string& psFile, const std::string& jobName,
                  const std::vector<std::pair<std::string, std::string>>& overrides,
                  std::string& error, int* jobId)
{
    if (queue.empty())
    {
        error = "no CUPS queue named";
        return false;
    }
    std::unique_ptr<FILE, FileCloser> file(std::fopen(psFile.c_str(), "rb"));
    if (!file)
    {
        error = "cannot read " + psFile;
        return false;
    }

    OptionsHolder options;
    for (const auto& [name, value] : CupsOptionsFromOverrides(overrides))
        options.count = cupsAddOption(name.c_str(), value.c_str(), options.count, &options.options);

    const std::string title = jobName.empty() ? posix::BaseName(psFile) : jobName;
    const int job = cupsCreateJob(CUPS_HTTP_DEFAULT, queue.c_str(), title.c_str(), options.count,
                                  options.options);
    if (job <= 0)
    {
        error = LastCupsError(("cannot create a job on " + queue).c_str());
        return false;
    }
    if (!SendDocument(queue.c_str(), job, title, file.get(), error))
    {
        // A job without its document would sit in the queue for ever.
        cupsCancelJob2(CUPS_HTTP_DEFAULT, queue.c_str(), job, 1);
        return false;
    }
    if (jobId)
        *jobId = job;
    return true;
}
} // namespace printing
