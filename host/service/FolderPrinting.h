#pragma once
#include <chrono>
#include <map>
#include <set>
#include <string>
#include <vector>

#include <wx/string.h>

#include "CupsJobs.h"
#include "service/FolderJournal.h"

class JobReport;
class RunStatistics;

// Takes a folder's delivered outputs to the printer exactly once and follows
// each job to the scheduler's verdict. Every step is recorded in the
// folder's journal before or after it happens, so that after a kill at any
// instant the replay knows which window it was in:
//
// - "print" recorded, no job id: the job may or may not exist. The scheduler
//   is asked for jobs carrying the record's marker; one that has its whole
//   document is adopted, one still waiting for it is cancelled, and the
//   output is sent again only then.
// - "job" recorded, not "sent": the same check by marker (it also finds the
//   recorded job).
// - "sent" recorded: only the verdict is missing; the job is followed.
// - the verdict is logged, then "ended" recorded; a verdict logged but not
//   recorded is found in the log by the record's id and not logged twice.
//
// A scheduler that cannot be reached or a queue that takes no jobs holds the
// printing: outputs stay delivered and are tried again with a growing pause;
// the reason stands in the container's "printing-held" file for "status".
// A queue that refuses a job for good (no such queue) ends it as a printer
// failure. An aborted or cancelled job is a line in the failure log.
class FolderPrinting
{
public:
    static const char kPrintedLogName[];
    static const char kHeldName[];

    FolderPrinting(FolderJournal& journal, const wxString& container, const wxString& failedFolder,
                   JobReport& report, RunStatistics& statistics);

    // Sends every output waiting to be printed, unless printing is held and
    // its pause has not passed. Asks stop between outputs.
    template <class Stop> void Submit(const Stop& stop)
    {
        if (!Waiting() || (!m_held.empty() && Clock::now() < m_retryAt))
            return;
        for (const PrintRecord& print : m_journal.Prints())
        {
            if (stop())
                return;
            if (!print.sent && !SubmitOne(print))
                return;
        }
        Resume();
    }
    // Asks the scheduler for the verdicts of sent jobs (at most every
    // interval unless now) and logs them.
    void Follow(bool now = false);

    bool Waiting() const;   // outputs not sent yet
    bool Following() const; // jobs sent, verdict missing
    size_t Outstanding() const { return m_journal.Prints().size(); }
    const wxString& Held() const { return m_held; }

    // The pause before the next try once printing is held: the first one,
    // then each doubled up to the longest.
    static std::chrono::milliseconds NextPause(std::chrono::milliseconds previous);

private:
    using Clock = std::chrono::steady_clock;
    // False when printing is held.
    bool SubmitOne(const PrintRecord& print);
    // A record from an earlier process, not sent: its job found or cleared.
    bool Check(const PrintRecord& print);
    // False when printing is now held, true when the record ended for good.
    bool Trouble(const PrintRecord& print, const printing::CupsError& error);
    void Hold(const std::string& queue, const std::string& reason);
    void Resume();
    void End(const PrintRecord& print, printing::JobEnd end, const std::string& reasons);
    void Refuse(const PrintRecord& print, const wxString& reason);
    bool AlreadyLogged(const wxString& id);

    FolderJournal& m_journal;
    wxString m_container;
    wxString m_failedFolder;
    JobReport& m_report;
    RunStatistics& m_statistics;
    // Records found in the journal at the start (a replay), and those of
    // them (or of this process's tries) whose job must be looked for first.
    std::set<wxString> m_replayed;
    std::set<wxString> m_unchecked;
    // Marked jobs of a queue as last listed, for checking replayed records.
    std::map<std::string, std::map<std::string, std::vector<printing::JobState>>> m_marked;
    std::set<std::string> m_listed; // queues whose marked jobs m_marked holds
    std::set<wxString> m_loggedIds;
    bool m_logRead = false;
    wxString m_held;
    std::chrono::milliseconds m_pause{0};
    Clock::time_point m_retryAt;
    Clock::time_point m_nextFollow;
};
