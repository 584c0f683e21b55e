#pragma once
#include <chrono>
#include <functional>
#include <map>
#include <memory>
#include <set>

#include <wx/string.h>

#include "folder/FolderWatcher.h"
#include "folder/HotFolder.h"
#include "jobs/JobRunner.h"
#include "jobs/RunStatistics.h"
#include "service/FolderJournal.h"
#include "module/FilterSession.h"
#include "service/ServiceJobs.h"

// One hot folder of the service, with its own Folder.cfg, server
// description, filter object and journal. Files are offered to it by name as
// events report them; it takes them once no process holds them open for
// writing. Files that change without events are found by a rescan and taken
// once they have stayed unchanged for the settle time.
class ServedFolder
{
public:
    // Opens the folder and finishes what an earlier service left in its work
    // folder. Null with a reason when the folder cannot be served.
    static std::unique_ptr<ServedFolder> Open(const wxString& path, const wxString& modulePath,
                                              std::chrono::milliseconds settle, wxString& error);
    ~ServedFolder();

    const wxString& Path() const { return m_folder.GetFolder(); }
    RunStatistics& Statistics() { return m_statistics; }

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

private:
    size_t TakeBatch(size_t limit, const std::function<bool()>& stop);
    ServedFolder(std::chrono::milliseconds settle) : m_settle(settle) {}
    bool IsSetAside(const wxString& path) const;
    void SetAside(const wxString& path);

    HotFolder m_folder;
    JobPlaces m_places;
    std::unique_ptr<FilterSession> m_session;
    FolderJournal m_journal;
    RunStatistics m_statistics;
    std::unique_ptr<ServiceJobs> m_jobs;
    SettleTracker m_settle;
    std::set<wxString> m_offered;
    // Refused files and stuck originals, by their size and time when seen,
    // so they are looked at again only once they change.
    std::map<wxString, std::pair<long long, long long>> m_setAside;
};
