#pragma once
#include <map>
#include <set>
#include <string>
#include <vector>

#include "CupsJobOptions.h"

namespace printing
{
// The steps of a print job at the CUPS scheduler the client is set up for,
// one at a time, so a caller can record each one before the next: create
// the job (carrying a marker it can be found by later), send its document,
// follow it to its end.

// What a failed call means for the caller.
enum class CupsTrouble
{
    None,
    Wait,   // the scheduler is down, busy or the queue takes no jobs now: try later
    Refused // the scheduler will never take this job (no such queue, bad request)
};

struct CupsError
{
    CupsTrouble trouble = CupsTrouble::None;
    std::string reason;
};

// The option that carries a job's marker.
extern const char kJobMarkerOption[];

// A new job on queue named title, with the options and the marker (none
// when empty); waiting for its document. 0 with error set on failure.
int CreateMarkedJob(const std::string& queue, const std::string& title, const OptionList& options,
                    const std::string& marker, CupsError& error);

// Sends the file as the job's only and last document.
bool SendJobDocument(const std::string& queue, int job, const std::string& title,
                     const std::string& path, CupsError& error);

// Cancels a job that has not ended and purges it from the scheduler's
// history (it never printed, so nobody should count it).
bool CancelJob(const std::string& queue, int job, CupsError& error);

enum class JobEnd
{
    Open, // not ended yet
    Completed,
    Aborted,
    Cancelled
};

struct JobState
{
    int id = 0;
    JobEnd end = JobEnd::Open;
    bool complete = false; // the scheduler has the whole document
    std::string reasons;   // job-state-reasons, or the printer's message
    std::string marker;    // given at creation; empty when none
    std::string name;      // job-name
    std::string user;      // job-originating-user-name: whose job it is
};

// The state of one job; found false when the scheduler no longer knows it.
bool GetJobState(int job, JobState& state, bool& found, CupsError& error);

// Every job of the queue that carries a marker, ended ones too, by marker.
bool ListMarkedJobs(const std::string& queue, std::map<std::string, std::vector<JobState>>& jobs,
                    CupsError& error);

// The ids of the queue's jobs that have not ended.
bool OpenJobIds(const std::string& queue, std::set<int>& ids, CupsError& error);

struct QueueState
{
    std::string state; // "idle", "processing" or "stopped"
    std::vector<std::string> reasons;
    std::string message;
    bool accepting = true;
};

bool GetQueueState(const std::string& queue, QueueState& state, CupsError& error);
} // namespace printing
