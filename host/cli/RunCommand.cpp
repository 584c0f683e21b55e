// hotfolder run: the jobs waiting in a hot folder, once or while watching.
#include <chrono>
#include <memory>

#include <wx/filename.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "posix/ActingUser.h"
#include "cli/ProgressDisplay.h"
#include "db/PathResolver.h"
#include "folder/FileMoves.h"
#include "folder/HotFolder.h"
#include "folder/ServerDescription.h"
#include "jobs/JobReport.h"
#include "jobs/RunStatistics.h"
#include "jobs/StopRequest.h"
#include "module/ModuleLocator.h"
#include "printing/CupsForwarding.h"
#include "service/HotFolderService.h"
#include "service/ServedFolder.h"

static const char kRunUsage[] =
    "usage: hotfolder run FOLDER [--watch] [--out DIR] [--settle MS] [--stats]\n"
    "                     [--delay-jobs MS] [--submit cups:QUEUE] [--module PATH]\n"
    "\n"
    "Processes the files in the hot folder FOLDER with the filter and the\n"
    "settings stored in it, on the service's road: every file exactly once, even\n"
    "when the run is killed (the next run or the service finishes its jobs), and\n"
    "never a file some process still holds open for writing. Outputs and their\n"
    "job tickets (<output>.Folder.cfg) go to DIR (default: FOLDER/Output),\n"
    "originals to the kept-originals folder, failed originals to the failed\n"
    "folder with a line in its failed-jobs.log. Files the filter refuses stay\n"
    "where they are. A folder is worked by one process at a time: a folder the\n"
    "service serves, or another run works, is left alone (exit status 3).\n"
    "\n"
    "  --watch          keep running and take files as they arrive: as soon as\n"
    "                   their writer closes them, or once unchanged for --settle\n"
    "                   MS (default 500) when no event tells. Stops on SIGINT,\n"
    "                   SIGTERM or the StopHF marker in the warehouse.\n"
    "  --stats          print where the time went (inside and outside the filter)\n"
    "  --delay-jobs MS  wait between finding the jobs and processing them\n"
    "  --submit cups:QUEUE\n"
    "                   print every delivered output on the CUPS queue QUEUE\n"
    "                   (of the scheduler CUPS_SERVER or client.conf names), with\n"
    "                   the job's overrides as options; a queue that refuses the\n"
    "                   job makes it \"not printed\", its output stays delivered;\n"
    "                   a scheduler that cannot be reached holds the printing\n"
    "                   until the next run or the service (a folder bound by\n"
    "                   init --printer prints on its queue without --submit)\n"
    "\n"
    "Exit status: 0 when every job succeeded (and was sent to the printer, if\n"
    "any), 1 when a job failed or was not printed, 2 for a bad command line, 3\n"
    "when the folder, its configuration or the module is unusable, or another\n"
    "process works the folder.\n";

namespace
{
// Files taken before the printing gets its turn, as in the service.
const size_t kFilesPerTurn = 128;

long ParseMilliseconds(const std::string& text, long fallback)
{
    if (text.empty())
        return fallback;
    char* end = nullptr;
    long value = std::strtol(text.c_str(), &end, 10);
    return (*end == '\0' && value >= 0) ? value : -1;
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

// The opened folder and the places its jobs go.
struct RunSetup
{
    HotFolder folder;
    ServerDescription server;
    JobPlaces places;
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

// Opens the folder and makes its places. Returns the exit status.
int PrepareRun(const RunRequest& request, RunSetup& setup)
{
    // Run as root, what it makes in a user's folder it makes as the owner
    // would (a missing folder has no owner: opening it says so).
    posix::UserIdentity owner;
    std::string ignored;
    posix::OwnerOf(request.folder, owner, ignored);
    const posix::ActingAs acting(owner);
    if (!acting.Acting())
    {
        PrintError(FromUtf8(acting.Error()));
        return kExitSetupFailed;
    }
    if (!OpenFolderAndServer(request.folder, setup.folder, setup.server))
        return kExitSetupFailed;
    wxString moved, error;
    if (!setup.folder.FollowMove(moved, error))
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    if (!moved.empty())
        PrintError(moved);
    return PreparePlaces(request, setup);
}

// One pass over what waits in the folder: the service's road, once. False
// when something delivered waits for the printer.
int RunOnce(const FolderOptions& options, const wxString& path, JobReport& report,
            RunStatistics& statistics, bool& printed)
{
    wxString error;
    std::unique_ptr<ServedFolder> folder = ServedFolder::Open(path, options, report, error);
    if (!folder)
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    const auto stop = [] { return StopRequest::Requested(); };
    // A file some process holds open for writing is left for later.
    while (folder->HasOffers() && !stop())
        folder->TakeOffered(kFilesPerTurn, stop);
    folder->Print(stop);
    statistics.Add(folder->Statistics());
    const size_t waiting = folder->Printing().Outstanding();
    printed = folder->Printing().Held().empty();
    if (!printed)
        report.Warning(wxString::Format("%zu output(s) wait for the printer; the service or the "
                                        "next run sends them",
                                        waiting));
    return kExitSuccess;
}

int ExecuteRun(const RunRequest& request, RunSetup& setup)
{
    StopRequest::Install();
    ProgressDisplay progress(StdoutIsTerminal());
    ConsoleReport report(progress);
    RunStatistics statistics;
    FolderOptions options;
    options.modulePath = LocateFilterModule(FromUtf8(request.module));
    options.settle = std::chrono::milliseconds(request.settleMs);
    options.outputFolder = setup.places.outputFolder;
    options.queue = request.cupsQueue;
    options.delayJobsMs = request.delayJobsMs;
    options.holder = FolderLock::Holder::Run;
    bool printed = true;
    if (request.watch)
    {
        progress.Note("watching " + setup.folder.GetFolder() + " (Ctrl-C to stop)");
        ServiceOptions service;
        service.folder = options;
        service.onlyFolder = setup.folder.GetFolder();
        service.report = &report;
        service.totals = &statistics;
        const int status = RunHotFolderService(service);
        if (status != kExitSuccess)
            return status;
    }
    else if (StopMarkerPresent())
        progress.Note("the StopHF marker is present; nothing is processed");
    else
    {
        const int status = RunOnce(options, setup.folder.GetFolder(), report, statistics, printed);
        if (status != kExitSuccess)
            return status;
    }

    statistics.PrintSummary();
    if (request.stats)
        statistics.PrintTiming();
    return statistics.failed == 0 && statistics.notPrinted == 0 && printed ? kExitSuccess
                                                                           : kExitJobsFailed;
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
