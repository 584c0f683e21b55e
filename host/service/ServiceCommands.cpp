#include "service/ServiceCommands.h"

#include <chrono>
#include <cstdlib>
#include <thread>

#include <wx/filename.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "db/HFDatabase.h"
#include "db/PathResolver.h"
#include "module/ModuleLocator.h"
#include "posix/NativePath.h"
#include "service/FolderStatus.h"
#include "service/HotFolderListEntries.h"
#include "service/HotFolderService.h"
#include "service/ServiceLock.h"

static const char kServeUsage[] =
    "usage: hotfolder serve [--settle MS] [--stats] [--module PATH]\n"
    "\n"
    "Serves every folder of the machine-wide hot-folder list from one process,\n"
    "each with its own settings, and picks up folders added to or removed from\n"
    "the list while it runs. A file is taken as soon as its writer closes it or\n"
    "it is renamed in, unless a process still holds it open for writing; files\n"
    "changed without notice (network file systems) once unchanged for --settle\n"
    "MS (default 500). The StopHF marker pauses every folder. The service makes\n"
    "the RunService marker when it starts and ends after the job in hand when\n"
    "the marker is removed ('hotfolder stop') or on SIGTERM.\n"
    "\n"
    "  --stats  print the jobs done and where the time went when it ends\n";

static const char kStopUsage[] =
    "usage: hotfolder stop [--wait SECONDS]\n"
    "\n"
    "Asks the hot-folder service to end after the job in hand (removes the\n"
    "RunService marker) and waits up to SECONDS (default 30) for it to end.\n"
    "Exit status 1 when it still runs after that.\n";

static const char kStatusUsage[] =
    "usage: hotfolder status [--json]\n"
    "\n"
    "Tells whether the hot-folder service runs and, for every listed folder, its\n"
    "server, output type and page, whether its preflight is on, the files\n"
    "waiting, the jobs done and failed (today and in total) and the last\n"
    "failure; for a folder that prints, its queue with the state and reasons\n"
    "the scheduler reports, the jobs printing now, printed (today and in\n"
    "total), the printer failures today and the last one. --json prints one\n"
    "JSON object.\n";

static const char kRemoveUsage[] =
    "usage: hotfolder remove FOLDER\n"
    "\n"
    "Takes FOLDER off the machine-wide hot-folder list; the folder and its files\n"
    "stay as they are. A running service stops watching it.\n";

static long ParseCount(const std::string& text, long fallback)
{
    if (text.empty())
        return fallback;
    char* end = nullptr;
    const long value = std::strtol(text.c_str(), &end, 10);
    return (*end == '\0' && value >= 0) ? value : -1;
}

int RunServeCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args, {{"--settle", true, false, ""}, {"--stats", false, false, ""}},
                          kServeUsage, 0, 0, parsed, status))
        return status;
    const long settle = ParseCount(parsed.Get("--settle"), 500);
    if (settle < 0)
    {
        PrintError("--settle takes a number of milliseconds");
        return kExitUsage;
    }
    ServiceOptions options;
    options.folder.modulePath = LocateFilterModule(FromUtf8(parsed.Get("--module")));
    options.folder.settle = std::chrono::milliseconds(settle);
    options.stats = parsed.Has("--stats");
    return RunHotFolderService(options);
}

int RunStopCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args, {{"--wait", true, false, ""}}, kStopUsage, 0, 0, parsed, status))
        return status;
    const long wait = ParseCount(parsed.Get("--wait"), 30);
    if (wait < 0)
    {
        PrintError("--wait takes a number of seconds");
        return kExitUsage;
    }
    const bool running = ServiceIsRunning();
    db::PathResolver::DeleteRunServiceFile();
    if (!running)
    {
        PrintLine("no hot-folder service is running");
        return kExitSuccess;
    }
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(wait);
    while (ServiceIsRunning() && std::chrono::steady_clock::now() < deadline)
        std::this_thread::sleep_for(std::chrono::milliseconds(50));
    if (ServiceIsRunning())
    {
        PrintError("the hot-folder service still runs (it finishes the job in hand first)");
        return kExitJobsFailed;
    }
    PrintLine("the hot-folder service has ended");
    return kExitSuccess;
}

static wxString JsonText(const wxString& raw)
{
    // Shown text first: JSON needs UTF-8, and a reader gets a name back with
    // ReadShownText as from every log.
    const wxString text = posix::ShownLine(raw);
    wxString quoted = "\"";
    for (wxUniChar c : text)
    {
        if (c == '"' || c == '\\')
            quoted << '\\' << c;
        else if (c < 0x20)
            quoted << wxString::Format("\\u%04x", static_cast<int>(c.GetValue()));
        else
            quoted << c;
    }
    return quoted + "\"";
}

static wxString JsonTextOrNull(const wxString& text)
{
    return text.empty() ? wxString("null") : JsonText(text);
}

int RunStatusCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args, {{"--json", false, false, ""}}, kStatusUsage, 0, 0, parsed, status))
        return status;
    const bool running = ServiceIsRunning();
    const bool paused = db::PathResolver::GetStopAllHFFilePath().FileExists();
    std::vector<FolderStatus> folders;
    for (const wxString& path : ReadHotFolderListEntries())
        folders.push_back(ReadFolderStatus(path));

    if (parsed.Has("--json"))
    {
        wxString json = wxString::Format("{\"running\": %s, \"paused\": %s, \"folders\": [",
                                         running ? "true" : "false", paused ? "true" : "false");
        for (size_t i = 0; i < folders.size(); ++i)
        {
            const FolderStatus& folder = folders[i];
            json << (i ? ", " : "") << "{\"path\": " << JsonText(folder.path) << ", \"problem\": "
                 << JsonTextOrNull(folder.problem.empty() ? folder.printingHeld : folder.problem)
                 << ", \"server\": " << JsonTextOrNull(folder.server)
                 << ", \"output_type\": " << JsonTextOrNull(folder.outputType)
                 << ", \"page\": " << JsonTextOrNull(folder.page)
                 << wxString::Format(", \"waiting\": %zu, \"done_today\": %zu, \"done_total\": "
                                     "%zu, \"failed_today\": %zu, \"failed_total\": %zu",
                                     folder.waiting, folder.doneToday, folder.doneTotal,
                                     folder.failedToday, folder.failedTotal)
                 << ", \"last_failure\": " << JsonTextOrNull(folder.lastFailure)
                 << ", \"queue\": " << JsonTextOrNull(FromUtf8(folder.queue))
                 << ", \"queue_state\": " << JsonTextOrNull(FromUtf8(folder.queueState))
                 << ", \"queue_reasons\": [";
            for (size_t r = 0; r < folder.queueReasons.size(); ++r)
                json << (r ? ", " : "") << JsonText(FromUtf8(folder.queueReasons[r]));
            json << "], \"printing_held\": " << JsonTextOrNull(folder.printingHeld)
                 << wxString::Format(", \"printing\": %zu, \"printed_today\": %zu, "
                                     "\"printed_total\": %zu, \"print_failed_today\": %zu",
                                     folder.printing, folder.printedToday, folder.printedTotal,
                                     folder.printFailedToday)
                 << ", \"last_print_failure\": " << JsonTextOrNull(folder.lastPrintFailure)
                 << ", \"preflight\": " << (folder.preflight ? "true" : "false") << "}";
        }
        PrintLine(json + "]}");
        return kExitSuccess;
    }
    PrintLine(wxString("Service:       ") + (running ? "running" : "not running") +
              (paused ? " (paused: StopHF present)" : ""));
    // Paths, names and reasons are outside text: each line stays one line.
    const auto ShowLine = [](const wxString& line) { PrintLine(posix::ShownLine(line)); };
    if (folders.empty())
        ShowLine("No hot folders are listed.");
    for (const FolderStatus& folder : folders)
    {
        ShowLine("");
        ShowLine("Folder:        " + folder.path);
        if (!folder.problem.empty())
        {
            ShowLine("  Problem:     " + folder.problem);
            continue;
        }
        ShowLine("  Server:      " + (folder.server.empty() ? wxString("(none)") : folder.server));
        ShowLine("  Output:      " + folder.outputType +
                 (folder.page.empty() ? wxString() : ", page " + folder.page));
        if (folder.preflight)
            ShowLine("  Preflight:   on (Ghostscript checks every output)");
        ShowLine(wxString::Format("  Waiting:     %zu file(s)", folder.waiting));
        ShowLine(wxString::Format("  Done:        %zu today, %zu in total", folder.doneToday,
                                  folder.doneTotal));
        ShowLine(wxString::Format("  Failed:      %zu today, %zu in total", folder.failedToday,
                                  folder.failedTotal));
        ShowLine("  Last failure: " +
                 (folder.lastFailure.empty() ? wxString("(none)") : folder.lastFailure));
        if (folder.queue.empty() && !folder.printing)
            continue;
        wxString queue = FromUtf8(folder.queue.empty() ? "(none)" : folder.queue);
        if (!folder.queueState.empty())
            queue += ", " + FromUtf8(folder.queueState);
        for (const std::string& reason : folder.queueReasons)
            queue += ", " + FromUtf8(reason);
        ShowLine("  Printer:     " + queue);
        if (!folder.printingHeld.empty())
            ShowLine("  Problem:     " + folder.printingHeld);
        ShowLine(wxString::Format("  Printing:    %zu now, %zu printed today, %zu in total, %zu "
                                  "printer failure(s) today",
                                  folder.printing, folder.printedToday, folder.printedTotal,
                                  folder.printFailedToday));
        if (!folder.lastPrintFailure.empty())
            ShowLine("  Last printer failure: " + folder.lastPrintFailure);
    }
    return kExitSuccess;
}

int RunRemoveCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args, {}, kRemoveUsage, 1, 1, parsed, status))
        return status;
    const wxString folder = FromUtf8(parsed.positionals[0]);
    const wxString entry = FindHotFolderListEntry(folder);
    if (entry.empty())
    {
        PrintError(folder + " is not in the hot-folder list");
        return kExitSetupFailed;
    }
    if (!db::HFDatabase::DeleteFromHotfolderList(entry))
    {
        PrintError("cannot change the hot-folder list " + HotFolderListFile());
        return kExitSetupFailed;
    }
    PrintLine("Removed from the hot-folder list: " + entry + " (the folder stays)");
    return kExitSuccess;
}
