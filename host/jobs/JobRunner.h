#pragma once
#include <cstddef>
#include <string>

#include <hotfolder/HFPlugin.h>

class FilterSession;
class ProgressDisplay;
class RunStatistics;

// Where a hot folder's jobs go.
struct JobPlaces
{
    wxString configFile;   // the folder's Folder.cfg, copied into every job
    wxString workFolder;   // parent of the per-job work directories
    wxString failedFolder; // failed originals and the failure log
    wxString keptFolder;   // originals of successful jobs
    wxString outputFolder; // outputs and their job tickets
    std::string cupsQueue; // where delivered outputs are printed; empty: nowhere
};

enum class JobOutcome
{
    Done,
    Failed,
    OriginalStuck // processed or not, the original could not be moved away
};

// Takes one sniffed job through the filter: a fresh work directory with a
// copy of Folder.cfg, Process into it, then the output and its ticket (the
// work copy of Folder.cfg with the filter's overrides) to the output folder
// and the original to the kept-originals folder; on failure the original
// goes to the failed folder with a line in its log. With a print queue the
// delivered output is submitted to it; a refused submission fails the job
// but leaves output and original where they were delivered and kept.
// Inputs are only ever moved, never deleted.
class JobRunner
{
public:
    static const char kFailureLogName[];
    static const char kTicketSuffix[];

    JobRunner(FilterSession& session, const JobPlaces& places, ProgressDisplay& progress,
              RunStatistics& statistics)
        : m_session(session), m_places(places), m_progress(progress), m_statistics(statistics)
    {
    }

    JobOutcome Run(const ReadyToProcessJobInfo& job, size_t index, size_t total);

private:
    JobOutcome Fail(const ReadyToProcessJobInfo& job, const wxString& reason);
    // Empty on success, else why the queue did not take the output.
    wxString Submit(const ReadyToProcessJobInfo& job, const wxString& output,
                    const wxString& ticket, wxString& note);
    void LogFailure(const wxString& name, const wxString& reason);

    FilterSession& m_session;
    JobPlaces m_places;
    ProgressDisplay& m_progress;
    RunStatistics& m_statistics;
};
