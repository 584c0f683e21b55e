// hotfolder printers: the CUPS scheduler's queues and the folders bound to them.
#include <algorithm>
#include <map>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "db/HFDatabase.h"
#include "folder/HotFolder.h"
#include "CupsQueues.h"

static const char kPrintersUsage[] =
    "usage: hotfolder printers\n"
    "\n"
    "Lists the queues of the CUPS scheduler (the one CUPS_SERVER or client.conf\n"
    "names) with their make and model, and the hot folders bound to each\n"
    "('hotfolder init FOLDER --printer QUEUE').\n";

// Queue name → the listed hot folders bound to it.
static std::map<std::string, std::vector<wxString>> BoundFolders()
{
    std::map<std::string, std::vector<wxString>> bound;
    wxArrayString folders;
    db::HFDatabase::ReadFoldersList(folders);
    for (const wxString& folder : folders)
    {
        const std::string queue = HotFolder::BoundQueueOf(folder);
        if (!queue.empty())
            bound[queue].push_back(folder);
    }
    return bound;
}

int RunPrintersCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args, {}, kPrintersUsage, 0, 0, parsed, status))
        return status;
    std::vector<printing::QueueInfo> queues;
    std::string error;
    if (!printing::ListQueues(queues, error))
    {
        PrintError("cannot reach the CUPS scheduler at " + FromUtf8(printing::SchedulerName()) +
                   ": " + FromUtf8(error));
        return kExitSetupFailed;
    }
    if (queues.empty())
    {
        PrintLine("no queues on the CUPS scheduler at " + FromUtf8(printing::SchedulerName()));
        return kExitSuccess;
    }
    size_t nameWidth = 0, modelWidth = 0;
    for (const auto& queue : queues)
    {
        nameWidth = std::max(nameWidth, queue.name.size());
        modelWidth = std::max(modelWidth, queue.makeAndModel.size());
    }
    const auto bound = BoundFolders();
    for (const auto& queue : queues)
    {
        std::string line = queue.name;
        line.resize(nameWidth + 2, ' ');
        line += queue.makeAndModel.empty() ? "(no make and model)" : queue.makeAndModel;
        line.resize(nameWidth + 2 + std::max<size_t>(modelWidth, 19) + 2, ' ');
        wxString text = FromUtf8(line);
        auto it = bound.find(queue.name);
        if (it == bound.end())
            text += "no folder";
        else
            for (size_t i = 0; i < it->second.size(); ++i)
                text += (i ? ", " : "folder ") + it->second[i];
        PrintLine(text);
    }
    return kExitSuccess;
}
