#pragma once
#include <chrono>
#include <functional>
#include <map>
#include <memory>
#include <set>
#include <string>

#include <wx/string.h>

#include "folder/FolderWatcher.h"
#include "folder/HotFolder.h"
#include "jobs/JobPlaces.h"
#include "jobs/RunStatistics.h"
#include "module/FilterSession.h"
#include "posix/ActingUser.h"
#include "service/FolderJournal.h"
#include "service/FolderLock.h"
#include "service/FolderPrinting.h"
#include "service/ServiceJobs.h"

class JobReport;

// How a folder is worked: by the service, or by "hotfolder run" with its
// command-line choices.
struct FolderOptions
{
    wxString modulePath;
    std::chrono::milliseconds settle{500};
    wxString outputFolder; // empty: the folder's own output folder
    std::string queue;     // empty: the queue the folder is bound to, if any
    long delayJobsMs = 0;  // a pause between sniffing and processing (tests)
    FolderLock::Holder holder = FolderLock::Holder::Service;
};

// One hot folder worked by one process, with its own Folder.cfg, server
// description, filter object, journal and printing. Files are offered to it
// by name as events report them; it takes them once no process holds them
// open for writing. Files that change without events are found by a rescan
// and taken once they have stayed unchanged for the settle time.
class ServedFolder
{
public:
    // Locks the folder, opens it and finishes what an earlier process left
    // in its work folder. Null with a reason when it cannot be worked.
    static std::unique_ptr<ServedFolder> Open(const wxString& path, const FolderOptions& options,
                                              JobReport& report, wxString& error);
    ~ServedFolder();

    const wxString& Path() const { return m_folder.GetFolder(); }
    RunStatistics& Statistics() { return m_statistics; }
    // The queue its outputs are printed on; empty when none.
    const std::string& Queue() const { return m_places.cupsQueue; }

    // A name an event reported as written, renamed in or linked in.
    void Offer(const wxString& name) { m_offered.insert(name); }
    // Every visible file of the folder, as after an overflow of events.
    void OfferAll();
    // Looks for files changed without events; settled ones are offered.
    // False when the folder itself is gone.
    bool Rescan();
    bool HasOffers() const { return !m_offered.empty(); }

    // Takes up to limit offered files through the filter; stop is asked
    // between jobs. Returns the number of jobs run.
    size_t TakeOffered(size_t limit, const std::function<bool()>& stop);
    // Sends delivered outputs to the printer and follows the jobs sent.
    void Print(const std::function<bool()>& stop);
    FolderPrinting& Printing() { return *m_printing; }

private:
    size_t TakeBatch(size_t limit, const std::function<bool()>& stop);
    ServedFolder(const FolderOptions& options, JobReport& report)
        : m_options(options), m_report(report), m_settle(options.settle)
    {
    }
    bool IsSetAside(const wxString& path) const;
    void SetAside(const wxString& path);

    FolderOptions m_options;
    JobReport& m_report;
    // The folder's owner, whose rights its work is done with.
    posix::UserIdentity m_owner;
    FolderLock m_lock;
    HotFolder m_folder;
    JobPlaces m_places;
    std::unique_ptr<FilterSession> m_session;
    FolderJournal m_journal;
    RunStatistics m_statistics;
    std::unique_ptr<ServiceJobs> m_jobs;
    std::unique_ptr<FolderPrinting> m_printing;
    SettleTracker m_settle;
    std::set<wxString> m_offered;
    // Refused files and stuck originals, by their size and time when seen,
    // so they are looked at again only once they change.
    std::map<wxString, std::pair<long long, long long>> m_setAside;
};
