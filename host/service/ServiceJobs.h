#pragma once
#include <vector>

#include <hotfolder/HFPlugin.h>

#include "jobs/JobPlaces.h"

class FilterSession;
class FolderJournal;
class JobReport;
class RunStatistics;

// The service's road of one job, made so that a kill at any instant leaves,
// after a restart, each original kept once and one whole output per
// original. Every job has a work directory "svc-<id>" in the work folder:
//
// 1. The originals are claimed: renamed from the hot folder into
//    "svc-<id>/original/". From here on the work directory, not the hot
//    folder, says the job is in hand.
// 2. Process writes the output (and merges the job overrides into the work
//    copy of Folder.cfg) in the work directory.
// 3. Ticket and output are staged in the output folder under hidden names
//    ".hf-<id>.ticket" and ".hf-<id>.output" (a copy goes to a ".tmp" name
//    first and is renamed when whole), and a free output name is chosen.
// 4. For the whole batch at once: the staged files are synced to disk, then
//    the chosen names are recorded in the folder's journal (synced), then
//    output and ticket are renamed to their final names without replacing
//    anything, and the output folder is synced. For a folder that prints,
//    each delivery's record goes with the record that its output is to be
//    printed, so no output can be delivered and then forgotten by the
//    printing (FolderPrinting takes it from there).
// 5. The originals move to the kept-originals folder; the work directory is
//    emptied and kept as a spare "spare-<n>" for the next job of a burst;
//    spares go when the folder has nothing more to do.
// Doing step 4 once per batch keeps the disk syncs off the cost of each job.
// Renaming a spare costs a few microseconds where making and removing two
// directories costs about 150 (ext4 allocates and discards their blocks).
//
// At start the work folder is replayed: a work directory without originals
// is removed, and so are spares; one whose recorded output is staged or
// delivered is finished from step 4 or 5; any other is processed again from
// step 2.
class ServiceJobs
{
public:
    ServiceJobs(FilterSession& session, const JobPlaces& places, const wxString& hotFolder,
                FolderJournal& journal, RunStatistics& statistics, JobReport& report)
        : m_session(session), m_places(places), m_hotFolder(hotFolder), m_journal(journal),
          m_statistics(statistics), m_report(report)
    {
    }

    // Claims the job's files and takes them through step 3; a failure ends
    // it at once.
    JobResult Run(const ReadyToProcessJobInfo& job);
    // Delivers every job staged since the last call (steps 4 and 5).
    void Commit();
    // Removes the spare work directories: the folder has nothing more to do.
    void ReleaseSpares();
    // Finishes or cleans what an earlier service left in the work folder.
    void Recover();

private:
    // Steps 2 and 3 in a work directory that holds only the originals.
    JobResult Continue(const wxString& id, ReadyToProcessJobInfo job);
    // What an earlier attempt at the job left beside the originals goes.
    void ClearEarlierAttempt(const wxString& id);
    // Everything in the work directory but its originals folder goes; true
    // when there was something.
    bool RemoveAllButOriginals(const wxString& id);
    struct Staged
    {
        wxString id, name, jobName;
    };
    // Renames the staged output and ticket; false after failing the job.
    bool Place(const wxString& id, wxString& name, const wxString& jobName);
    JobResult Deliver(const wxString& id, const wxString& recordedName, const wxString& jobName);
    JobResult KeepOriginals(const wxString& id, const wxString& result);
    JobResult Fail(const wxString& id, const wxString& name, const wxString& reason);
    void RemoveStaged(const wxString& id);
    // A fresh work directory with its empty originals folder, from a spare
    // where one is left.
    bool MakeWorkDirectory(const wxString& id);
    // The work directory of a finished job, its originals gone: emptied and
    // kept as a spare, or removed when there are enough.
    void Retire(const wxString& id);
    // The records that announce a delivery (and its printing) under name.
    std::vector<std::vector<std::string>> DeliveryRecords(const wxString& id, const wxString& name,
                                                          const wxString& jobName) const;
    wxString WorkDirectory(const wxString& id) const;
    wxString OriginalsDirectory(const wxString& id) const;
    wxString StagedPath(const wxString& id, const char* what) const;
    std::vector<wxString> Originals(const wxString& id) const;

    FilterSession& m_session;
    JobPlaces m_places;
    wxString m_hotFolder;
    FolderJournal& m_journal;
    RunStatistics& m_statistics;
    JobReport& m_report;
    std::vector<Staged> m_staged;
    std::vector<wxString> m_spares;
    unsigned m_spareCounter = 0;
};
