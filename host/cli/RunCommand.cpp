// hotfolder run: the jobs waiting in a hot folder, once or while watching.
#include <chrono>
#include <map>
#include <memory>
#include <set>
#include <thread>

#include <wx/filename.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "printing/CupsForwarding.h"
#include "folder/FileMoves.h"
#include "module/FilterSession.h"
#include "folder/FolderWatcher.h"
#include "folder/HotFolder.h"
#include "jobs/JobRunner.h"
#include "module/ModuleLocator.h"
#include "cli/ProgressDisplay.h"
#include "jobs/RunStatistics.h"
#include "folder/ServerDescription.h"
#include "jobs/StopRequest.h"
#include "db/PathResolver.h"

static const char kRunUsage[] =
    "usage: hotfolder run FOLDER [--watch] [--out DIR] [--settle MS] [--stats]\n"
    "                     [--delay-jobs MS] [--submit cups:QUEUE] [--module PATH]\n"
    "\n"
    "Processes the files in the hot folder FOLDER with the filter and the\n"
    "settings stored in it. Outputs and their job tickets (<output>.Folder.cfg)\n"
    "go to DIR (default: FOLDER/Output), originals to the kept-originals folder,\n"
    "failed originals to the failed folder with a line in its failed-jobs.log.\n"
    "Files the filter refuses stay where they are.\n"
    "\n"
    "  --watch          keep running and take files as they arrive; a file is\n"
    "                   taken once its size has not changed for --settle MS\n"
    "                   (default 500). Stops on SIGINT, SIGTERM or the StopHF\n"
    "                   marker in the warehouse.\n"
    "  --stats          print where the time went (inside and outside the filter)\n"
    "  --delay-jobs MS  wait between finding the jobs and processing them\n"
    "  --submit cups:QUEUE\n"
    "                   print every delivered output on the CUPS queue QUEUE\n"
    "                   (of the scheduler CUPS_SERVER or client.conf names), with\n"
    "                   the job's overrides as options; a refused submission\n"
    "                   counts as a failed job, its output stays delivered\n"
    "                   (a folder bound by init --printer prints on its queue\n"
    "                   without --submit)\n"
    "\n"
    "Exit status: 0 when every job succeeded, 1 when a job failed, 2 for a bad\n"
    "command line, 3 when the folder, its configuration or the module is unusable.\n";

namespace
{
// One file as last seen, so a refused or stuck file is reported once and
// looked at again only when it changes.
struct Signature
{
    long long size = -1;
    long long mtimeNs = -1;
    bool operator==(const Signature& other) const
    {
        return size == other.size && mtimeNs == other.mtimeNs;
    }
};

Signature SignatureOf(const wxString& path)
{
    Signature signature;
    FileSignature(path, signature.size, signature.mtimeNs);
    return signature;
}

long ParseMilliseconds(const std::string& text, long fallback)
{
    if (text.empty())
        return fallback;
    char* end = nullptr;
    long value = std::strtol(text.c_str(), &end, 10);
    return (*end == '\0' && value >= 0) ? value : -1;
}

class FolderRun
{
public:
    FolderRun(FilterSession& session, const HotFolder& folder, const JobPlaces& places,
              ProgressDisplay& progress, RunStatistics& statistics, long delayJobsMs)
        : m_session(session), m_folder(folder), m_runner(session, places, progress, statistics),
          m_progress(progress), m_statistics(statistics), m_delayJobsMs(delayJobsMs)
    {
    }

    // Sniffs the given files and processes the jobs found. False when a stop
    // was asked for before every job was done.
    bool Pass(const std::vector<wxString>& candidates);

    // Files not to offer again until they change.
    bool IsSetAside(const wxString& path) const
    {
        auto it = m_setAside.find(path);
        return it != m_setAside.end() && it->second == SignatureOf(path);
    }

private:
    FilterSession& m_session;
    const HotFolder& m_folder;
    JobRunner m_runner;
    ProgressDisplay& m_progress;
    RunStatistics& m_statistics;
    long m_delayJobsMs;
    std::map<wxString, Signature> m_setAside;
};

bool FolderRun::Pass(const std::vector<wxString>& candidates)
{
    if (candidates.empty())
        return true;
    wxArrayString files;
    for (const wxString& path : candidates)
        files.Add(path);
    wxArrayString rejected;
    JobInfoCollection jobs;
    {
        ScopedSeconds timing(m_statistics.sniffSeconds);
        m_session.SniffListed(m_folder.GetFolder(), files, rejected, jobs);
    }
    // Refused: everything offered that no job took, whether the filter
    // listed it as rejected or silently passed it over.
    std::set<wxString> taken;
    for (size_t i = 0; i < jobs.size(); ++i)
        for (const wxString& file : jobs[i].files)
            taken.insert(file);
    for (const wxString& path : candidates)
        if (!taken.count(path))
        {
            ++m_statistics.refused;
            m_setAside[path] = SignatureOf(path);
            m_progress.Note("refused (left in place): " + path);
        }
    if (jobs.empty())
        return true;
    if (m_delayJobsMs > 0)
    {
        m_progress.Note(wxString::Format("found %zu job(s)", jobs.size()));
        std::this_thread::sleep_for(std::chrono::milliseconds(m_delayJobsMs));
    }
    for (size_t i = 0; i < jobs.size(); ++i)
    {
        if (StopRequest::Requested())
            return false;
        if (m_runner.Run(jobs[i], i, jobs.size()) == JobOutcome::OriginalStuck)
            for (const wxString& file : jobs[i].files)
                m_setAside[file] = SignatureOf(file);
    }
    return true;
}

bool StopMarkerPresent()
{
    return db::PathResolver::GetStopAllHFFilePath().FileExists();
}

// What the command line asks for.
struct RunRequest
{
    std::string folder;
    std::string outFolder; // "" for the folder's default
    std::string module;
    std::string cupsQueue; // --submit; otherwise the queue the folder is bound to
    long settleMs = 500;
    long delayJobsMs = 0;
    bool watch = false;
    bool stats = false;
};

// The opened folder, the places its jobs go and the running filter.
struct RunSetup
{
    HotFolder folder;
    ServerDescription server;
    JobPlaces places;
    std::unique_ptr<FilterSession> session;
};

bool ParseRunRequest(const Arguments& args, RunRequest& request, int& status)
{
    ParsedArgs parsed;
    if (!ParseCommandLine(args,
                          {{"--watch", false, false, ""},
                           {"--out", true, false, ""},
                           {"--settle", true, false, ""},
                           {"--delay-jobs", true, false, ""},
                           {"--stats", false, false, ""},
                           {"--submit", true, false, ""}},
                          kRunUsage, 1, 1, parsed, status))
        return false;
    request.settleMs = ParseMilliseconds(parsed.Get("--settle"), 500);
    request.delayJobsMs = ParseMilliseconds(parsed.Get("--delay-jobs"), 0);
    if (request.settleMs < 0 || request.delayJobsMs < 0)
    {
        PrintError("--settle and --delay-jobs take a number of milliseconds");
        status = kExitUsage;
        return false;
    }
    if (parsed.Has("--submit"))
    {
        wxString error;
        if (!ParseSubmitTarget(parsed.Get("--submit"), request.cupsQueue, error))
        {
            PrintError(error);
            status = kExitUsage;
            return false;
        }
    }
    request.folder = parsed.positionals[0];
    request.outFolder = parsed.Get("--out");
    request.module = parsed.Get("--module");
    request.watch = parsed.Has("--watch");
    request.stats = parsed.Has("--stats");
    return true;
}

// Where the jobs of the folder go. Returns the exit status.
int PreparePlaces(const RunRequest& request, RunSetup& setup)
{
    const HotFolder& folder = setup.folder;
    JobPlaces& places = setup.places;
    places.configFile = folder.GetConfigFile();
    places.workFolder = folder.GetWorkFolder();
    places.failedFolder = folder.GetFailedFolder();
    places.keptFolder = folder.GetKeptOriginalsFolder();
    places.cupsQueue = request.cupsQueue.empty() ? folder.GetBoundQueue() : request.cupsQueue;
    if (!request.outFolder.empty())
    {
        wxFileName out = wxFileName::DirName(FromUtf8(request.outFolder));
        out.MakeAbsolute();
        places.outputFolder = out.GetPath();
    }
    else
        places.outputFolder = folder.GetDefaultOutputFolder();
    if (wxFileName::DirName(places.outputFolder).SameAs(wxFileName::DirName(folder.GetFolder())))
    {
        // Outputs would be offered to the filter again as new arrivals.
        PrintError("the output directory cannot be the hot folder itself");
        return kExitUsage;
    }
    wxString error;
    if (!EnsureWritableDirectory(places.outputFolder, error))
    {
        PrintError("unusable output directory: " + error);
        return kExitSetupFailed;
    }
    for (const wxString& directory : {places.workFolder, places.failedFolder, places.keptFolder})
        if (!EnsureWritableDirectory(directory, error))
        {
            PrintError(error);
            return kExitSetupFailed;
        }
    return kExitSuccess;
}

// Opens the folder, makes its places and starts the filter. Returns the exit status.
int PrepareRun(const RunRequest& request, RunSetup& setup)
{
    if (!OpenFolderAndServer(request.folder, setup.folder, setup.server))
        return kExitSetupFailed;
    const int status = PreparePlaces(request, setup);
    if (status != kExitSuccess)
        return status;
    wxString error;
    const wxString modulePath = LocateFilterModule(FromUtf8(request.module));
    setup.session = FilterSession::Start(modulePath, setup.server.GetText(),
                                         &setup.folder.GetFilterSetting(), error);
    if (!setup.session)
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    wxArrayString missing =
        setup.server.MissingFeatures(setup.session->Info().m_arrRequiredServerFeatures);
    if (!missing.empty())
        PrintError("warning: the server description does not offer " + wxJoin(missing, ' ') +
                   ", which the filter needs");
    return kExitSuccess;
}

// Takes files as they arrive until a stop is asked for. Returns the exit
// status when the watch cannot start, otherwise kExitSuccess.
int WatchFolder(const RunRequest& request, const HotFolder& folder, FolderRun& run,
                ProgressDisplay& progress)
{
    FolderWatcher watcher;
    wxString error;
    if (!watcher.Watch(folder.GetFolder(), error))
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    progress.Note("watching " + folder.GetFolder() + " (Ctrl-C to stop)");
    SettleTracker settle{std::chrono::milliseconds(request.settleMs)};
    while (!StopRequest::Requested() && !StopMarkerPresent())
    {
        std::vector<wxString> candidates;
        for (const wxString& path : settle.Settled(ListFolderFiles(folder.GetFolder())))
            if (!run.IsSetAside(path))
                candidates.push_back(path);
        if (!run.Pass(candidates))
            break;
        // Short ticks while files settle; inotify wakes us early.
        watcher.Wait(std::max(50L, std::min(250L, request.settleMs / 2)));
    }
    progress.Note(StopRequest::Requested() ? "stop requested; stopped"
                                           : "the StopHF marker appeared; stopped");
    return kExitSuccess;
}

int ExecuteRun(const RunRequest& request, RunSetup& setup)
{
    StopRequest::Install();
    ProgressDisplay progress(StdoutIsTerminal());
    RunStatistics statistics;
    FolderRun run(*setup.session, setup.folder, setup.places, progress, statistics,
                  request.delayJobsMs);
    if (request.watch)
    {
        const int status = WatchFolder(request, setup.folder, run, progress);
        if (status != kExitSuccess)
            return status;
    }
    else if (StopMarkerPresent())
        progress.Note("the StopHF marker is present; nothing is processed");
    else
        run.Pass(ListFolderFiles(setup.folder.GetFolder()));

    statistics.PrintSummary();
    if (request.stats)
        statistics.PrintTiming();
    return statistics.failed == 0 ? kExitSuccess : kExitJobsFailed;
}
} // namespace

int RunRunCommand(const Arguments& args)
{
    RunRequest request;
    int status = kExitSuccess;
    if (!ParseRunRequest(args, request, status))
        return status;
    RunSetup setup;
    status = PrepareRun(request, setup);
    if (status != kExitSuccess)
        return status;
    return ExecuteRun(request, setup);
}
