// hotfolder retry: puts failed originals back into their hot folder.
#include <cstdint>
#include <set>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "folder/HotFolder.h"
#include "service/FailedOriginals.h"
#include "service/ServiceCommands.h"

static const char kRetryUsage[] =
    "usage: hotfolder retry FOLDER [NAME...]\n"
    "\n"
    "Moves failed originals back into the hot folder, so that they are taken\n"
    "again: the files the filter refused (in the failed folder) and the kept\n"
    "originals of jobs the printer aborted or cancelled. Without NAMEs, all of\n"
    "them. The failure log says which were retried.\n"
    "\n"
    "Exit status 1 when a NAME is not a failed original or cannot be moved.\n";

int RunRetryCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args, {}, kRetryUsage, 1, SIZE_MAX, parsed, status))
        return status;
    HotFolder folder;
    wxString error;
    if (!folder.Open(FromUtf8(parsed.positionals[0]), error))
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    std::set<wxString> asked;
    for (size_t i = 1; i < parsed.positionals.size(); ++i)
        asked.insert(FromUtf8(parsed.positionals[i]));

    int retried = 0;
    for (const FailedOriginal& original : ListFailedOriginals(folder))
    {
        if (!asked.empty() && asked.erase(original.name) == 0)
            continue;
        wxString movedTo;
        if (!RetryFailedOriginal(folder, original, movedTo, error))
        {
            PrintError(error);
            status = kExitJobsFailed;
            continue;
        }
        if (!error.empty())
            PrintError(error);
        PrintLine(original.name + ": back in the hot folder as " + movedTo);
        ++retried;
    }
    for (const wxString& name : asked)
    {
        PrintError(name + " is not a failed original of " + folder.GetFolder());
        status = kExitJobsFailed;
    }
    PrintLine(wxString::Format("%d retried", retried));
    return status;
}
