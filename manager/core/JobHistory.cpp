// A job leaves its traces in several places, none of which names the others:
//   - its original in the kept-originals folder once its output is delivered
//     (the move's change time is when it was done);
//   - a line in failed-jobs.log when it failed (the original then lies in the
//     failed folder; a later "retried:" line means it went back in);
//   - for a folder that prints, an open print record in the journal while it
//     prints, then a line in printed-jobs.log with the scheduler's verdict
//     (an aborted one also as a "printer:" line in failed-jobs.log, and its
//     original stays kept).
// The logs name the original as dropped, the folders as stored (a taken name
// gets a counter: "a (2).eps"), so jobs are matched by name, counter aside:
// each verdict and each open print takes the newest kept original of its name
// done before it, so that a printed job is one "printed" row, not also a
// "done" one. The output is the file in the output folder named as the filter
// names it (the original's name, or its stem with ".ps"), counter aside,
// placed closest in time to the original's keeping.
#include "core/JobHistory.h"

#include <algorithm>
#include <cmath>
#include <sys/stat.h>

#include <wx/filename.h>
#include <wx/intl.h>

#include "core/JobLogs.h"
#include "db/PathResolver.h"
#include "folder/FileMoves.h"
#include "folder/HotFolder.h"
#include "posix/NativePath.h"
#include "posix/UniqueDir.h"
#include "service/FailedOriginals.h"
#include "service/FolderJournal.h"

namespace
{
// A verdict logged a moment before the move's time stamp still counts.
const long kClockSlackSeconds = 2;
// An output placed further than this from its original's keeping is another job's.
const long kOutputWindowSeconds = 600;
// A job ticket beside an output.
const char kTicketEnding[] = ".Folder.cfg";

struct PlacedFile
{
    wxString name;
    wxString path;
    wxDateTime time; // last change: when it was moved or renamed there
    bool taken = false;
};

std::vector<PlacedFile> FilesIn(const wxString& directory)
{
    std::vector<PlacedFile> files;
    posix::UniqueDir dir(posix::NativePath(directory).c_str());
    if (!dir)
        return files;
    while (const dirent* entry = dir.Next())
    {
        const std::string path = posix::NativePath(directory) + "/" + entry->d_name;
        struct stat info;
        if (entry->d_name[0] == '.' || lstat(path.c_str(), &info) != 0 || !S_ISREG(info.st_mode))
            continue;
        files.push_back({posix::FromNativePath(entry->d_name), posix::FromNativePath(path.c_str()),
                         wxDateTime(info.st_ctime)});
    }
    return files;
}

// "a (2).eps" -> "a.eps": the name before a counter was added for a taken one.
wxString WithoutCounter(const wxString& name)
{
    const wxFileName parts(name);
    wxString stem = parts.GetName();
    const size_t open = stem.rfind(" (");
    if (open != wxString::npos && stem.EndsWith(")"))
    {
        const wxString digits = stem.Mid(open + 2, stem.length() - open - 3);
        if (!digits.empty() && digits.find_first_not_of("0123456789") == wxString::npos)
            stem.Truncate(open);
    }
    return parts.HasExt() ? stem + "." + parts.GetExt() : stem;
}

bool SameJobName(const wxString& stored, const wxString& logged)
{
    return WithoutCounter(stored) == WithoutCounter(logged);
}

// The newest kept original of the name not yet given to a job, done no later
// than before (any time when before is invalid).
PlacedFile* TakeKept(std::vector<PlacedFile>& kept, const wxString& name, const wxDateTime& before)
{
    PlacedFile* best = nullptr;
    for (PlacedFile& file : kept)
        if (!file.taken && SameJobName(file.name, name) &&
            (!before.IsValid() || file.time <= before + wxTimeSpan::Seconds(kClockSlackSeconds)) &&
            (!best || file.time > best->time))
            best = &file;
    if (best)
        best->taken = true;
    return best;
}

wxString FindOutput(std::vector<PlacedFile>& outputs, const wxString& original,
                    const wxDateTime& when)
{
    const wxString name = WithoutCounter(original);
    const wxString postscript = wxFileName(name).GetName() + ".ps";
    PlacedFile* best = nullptr;
    double bestDistance = kOutputWindowSeconds + 1;
    for (PlacedFile& file : outputs)
    {
        const wxString base = WithoutCounter(file.name);
        if (file.taken || file.name.EndsWith(kTicketEnding) || (base != name && base != postscript))
            continue;
        const double distance = std::fabs((file.time - when).GetSeconds().ToDouble());
        if (distance < bestDistance)
        {
            best = &file;
            bestDistance = distance;
        }
    }
    if (!best)
        return wxString();
    best->taken = true;
    return best->path;
}

bool HasFailedOriginal(const std::vector<FailedOriginal>& originals, const wxString& name,
                       bool atThePrinter)
{
    return std::any_of(originals.begin(), originals.end(),
                       [&](const FailedOriginal& original) {
                           return original.atThePrinter == atThePrinter &&
                                  SameJobName(original.name, name);
                       });
}

// Failed rows; only the last failure of a name can be retried, and only while
// its original still waits in the failed folder.
void AddFailures(const HotFolder& folder, const std::vector<FailedOriginal>& originals,
                 std::vector<JobEntry>& rows)
{
    const std::vector<FailureLine> failures = ReadFailureLog(folder.GetFailedFolder());
    for (size_t i = 0; i < failures.size(); ++i)
    {
        const FailureLine& failure = failures[i];
        if (failure.retried || failure.printer)
            continue;
        bool last = true;
        for (size_t later = i + 1; later < failures.size() && last; ++later)
            last = !SameJobName(failures[later].name, failure.name) || failures[later].printer;
        JobEntry row{failure.time, failure.name, JobOutcome::Failed, failure.reason, wxString()};
        row.retryable = last && HasFailedOriginal(originals, failure.name, false);
        rows.push_back(row);
    }
}

void AddPrinted(const wxString& container, std::vector<PlacedFile>& kept,
                std::vector<PlacedFile>& outputs, const std::vector<FailedOriginal>& originals,
                std::vector<JobEntry>& rows)
{
    const std::vector<PrintedLine> printed = ReadPrintedLog(container);
    for (size_t i = 0; i < printed.size(); ++i)
    {
        const PrintedLine& line = printed[i];
        JobEntry row{line.time, line.name,
                     line.Completed() ? JobOutcome::Printed : JobOutcome::PrinterFailed,
                     line.Completed() ? wxString() : line.Describe(), wxString()};
        if (const PlacedFile* original = TakeKept(kept, line.name, line.time))
            row.output = FindOutput(outputs, original->name, original->time);
        bool last = true;
        for (size_t later = i + 1; later < printed.size() && last; ++later)
            last = !SameJobName(printed[later].name, line.name);
        row.retryable = !line.Completed() && last && HasFailedOriginal(originals, line.name, true);
        rows.push_back(row);
    }
}
} // namespace

std::vector<JobEntry> ReadRecentJobs(const wxString& folder, size_t limit)
{
    std::vector<JobEntry> rows;
    HotFolder hotFolder;
    wxString error;
    if (!hotFolder.Open(folder, error))
        return rows;
    const wxString container = db::PathResolver::GetContainerFolderPath(hotFolder.GetFolder());
    std::vector<PlacedFile> kept = FilesIn(hotFolder.GetKeptOriginalsFolder());
    std::vector<PlacedFile> outputs = FilesIn(hotFolder.GetDefaultOutputFolder());
    const std::vector<FailedOriginal> originals = ListFailedOriginals(hotFolder);

    AddFailures(hotFolder, originals, rows);
    AddPrinted(container, kept, outputs, originals, rows);
    for (const PrintRecord& print : FolderJournal::ReadOnly(container).Prints())
    {
        const PlacedFile* original = TakeKept(kept, print.jobName, wxDateTime());
        JobEntry row{original ? original->time : wxDateTime::Now(), print.jobName,
                     JobOutcome::Printing, wxString(), wxString()};
        // The journal names the output itself.
        for (PlacedFile& output : outputs)
            if (output.path == print.output)
            {
                output.taken = true;
                row.output = output.path;
            }
        rows.push_back(row);
    }
    for (PlacedFile& original : kept)
        if (!original.taken)
            rows.push_back({original.time, original.name, JobOutcome::Done, wxString(),
                            FindOutput(outputs, original.name, original.time)});

    std::stable_sort(rows.begin(), rows.end(),
                     [](const JobEntry& a, const JobEntry& b)
                     { return a.time.IsValid() && (!b.time.IsValid() || a.time > b.time); });
    if (rows.size() > limit)
        rows.resize(limit);
    return rows;
}

bool RetryJob(const wxString& folder, const JobEntry& job, wxString& error)
{
    HotFolder hotFolder;
    if (!hotFolder.Open(folder, error))
        return false;
    const bool atThePrinter = job.outcome == JobOutcome::PrinterFailed;
    const FailedOriginal* chosen = nullptr;
    const std::vector<FailedOriginal> originals = ListFailedOriginals(hotFolder);
    for (const FailedOriginal& original : originals)
        if (original.atThePrinter == atThePrinter && SameJobName(original.name, job.name) &&
            (!chosen || original.name == job.name))
            chosen = &original;
    if (!job.retryable || !chosen)
    {
        error = wxString::Format(_("%s cannot be retried: its original is no longer waiting."),
                                 job.name);
        return false;
    }
    wxString movedTo;
    return RetryFailedOriginal(hotFolder, *chosen, movedTo, error);
}

wxString JobOutcomeText(JobOutcome outcome)
{
    switch (outcome)
    {
    case JobOutcome::Done:
        return _("done");
    case JobOutcome::Failed:
        return _("failed");
    case JobOutcome::Printing:
        return _("printing");
    case JobOutcome::Printed:
        return _("printed");
    case JobOutcome::PrinterFailed:
        return _("printer failed");
    }
    return wxString();
}
