#include "jobs/JobExecution.h"

#include <cerrno>
#include <chrono>
#include <cstring>
#include <sys/stat.h>
#include <unistd.h>

#include <wx/filename.h>

static bool IsRegularFile(const wxString& path)
{
    struct stat info;
    return stat(path.fn_str(), &info) == 0 && S_ISREG(info.st_mode);
}

JobOutput ProcessJob(HFPlugin& filter, const ReadyToProcessJobInfo& job,
                     const wxString& workDirectory, IProgressTracker* tracker)
{
    JobOutput output;
    const wxString source = job.files.empty() ? wxString() : job.files[0];
    auto started = std::chrono::steady_clock::now();
    output.status = filter.Process(source, job, workDirectory, output.outputName, tracker);
    output.processSeconds =
        std::chrono::duration<double>(std::chrono::steady_clock::now() - started).count();
    if (output.status != 0 || output.outputName.empty())
        return output;

    wxString written = wxFileName(workDirectory, output.outputName).GetFullPath();
    if (IsRegularFile(written))
        output.producedPath = written;
    else
    {
        // Pass-through: the filter names the job's input as its output.
        for (const wxString& file : job.files)
            if (wxFileName(file).GetFullName() == output.outputName)
            {
                output.producedPath = file;
                output.passThrough = true;
            }
    }
    return output;
}

wxString MakeUniqueDirectory(const wxString& parent, const wxString& prefix, wxString& error)
{
    static unsigned counter = 0;
    for (int attempt = 0; attempt < 1000; ++attempt)
    {
        auto now = std::chrono::system_clock::now().time_since_epoch();
        long long micros = std::chrono::duration_cast<std::chrono::microseconds>(now).count();
        wxString name =
            wxString::Format("%s%lld-%d-%u", prefix, micros, static_cast<int>(getpid()), ++counter);
        wxString path = wxFileName(parent, name).GetFullPath();
        if (mkdir(path.fn_str(), 0777) == 0)
            return path;
        if (errno != EEXIST)
        {
            error = wxString::Format("cannot create a work directory in %s: %s", parent,
                                     wxString::FromUTF8(std::strerror(errno)));
            return wxString();
        }
    }
    error = wxString::Format("cannot create a work directory in %s", parent);
    return wxString();
}
