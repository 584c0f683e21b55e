#include "cli/QueueBinding.h"

#include <cerrno>
#include <cstring>
#include <unistd.h>

#include <wx/filename.h>

#include "CupsQueues.h"
#include "cli/ConsoleText.h"
#include "db/AtomicFile.h"
#include "db/PathResolver.h"
#include "folder/HotFolder.h"
#include "folder/ServerDescription.h"

// The description of a CUPS queue, and its PPD's bytes when it has one.
bool LoadQueueServer(const std::string& queue, ServerDescription& server, std::string& bytes,
                     wxString& origin, wxString& error)
{
    const wxString scheduler = FromUtf8(printing::SchedulerName());
    const wxString named = "\"" + FromUtf8(queue) + "\"";
    wxString xml;
    std::string reason;
    switch (printing::QueueServerDescription(queue, xml, bytes, reason))
    {
    case printing::QueueLookup::Found:
        origin = "queue " + named + " of the CUPS scheduler at " + scheduler;
        return server.LoadText(xml, origin, error);
    case printing::QueueLookup::UnknownQueue:
        error = "the CUPS scheduler at " + scheduler + " has no queue " + named;
        return false;
    case printing::QueueLookup::Unreachable:
        error = "cannot reach the CUPS scheduler at " + scheduler + " for the queue " + named +
                ": " + FromUtf8(reason);
        return false;
    case printing::QueueLookup::Unusable:
        break;
    }
    error = "the queue " + named + " of the CUPS scheduler at " + scheduler +
            " cannot be described: " + FromUtf8(reason);
    return false;
}

bool StoreBeside(const wxString& folder, const char* name, const std::string& bytes,
                 const wxString& what, wxString& error)
{
    const wxString stored =
        wxFileName(db::PathResolver::GetContainerFolderPath(folder), name).GetFullPath();
    wxString reason;
    if (db::AtomicFile::Write(stored, bytes, &reason))
        return true;
    error = "cannot store the " + what + " in " + stored + ": " + reason;
    return false;
}

bool StoreBeside(const wxString& folder, const char* name, const std::string& bytes,
                 const wxString& what)
{
    wxString error;
    if (StoreBeside(folder, name, bytes, what, error))
        return true;
    PrintError(error);
    return false;
}

static wxString BesidePath(const wxString& folder, const char* name)
{
    return wxFileName(db::PathResolver::GetContainerFolderPath(folder), name).GetFullPath();
}

bool BindFolderToQueue(const wxString& folder, const std::string& queue, wxString& error)
{
    ServerDescription server;
    std::string ppdBytes;
    wxString origin;
    if (!LoadQueueServer(queue, server, ppdBytes, origin, error))
        return false;
    if (!StoreBeside(folder, HotFolder::kServerDescriptionName, ToUtf8(server.GetText()),
                     "server description", error))
        return false;
    // A queue without a PPD leaves no stale one from an earlier queue behind.
    if (ppdBytes.empty())
        unlink(ToUtf8(BesidePath(folder, HotFolder::kServerPpdName)).c_str());
    else if (!StoreBeside(folder, HotFolder::kServerPpdName, ppdBytes, "printer description",
                          error))
        return false;
    // The queue last: the service reads the folder again when it changes.
    return StoreBeside(folder, HotFolder::kPrinterQueueName, queue + "\n", "printer queue", error);
}

bool BindFolderToQueue(const wxString& folder, const std::string& queue)
{
    wxString error;
    if (BindFolderToQueue(folder, queue, error))
        return true;
    PrintError(error);
    return false;
}

bool UnbindFolder(const wxString& folder, wxString& error)
{
    const wxString record = BesidePath(folder, HotFolder::kPrinterQueueName);
    if (unlink(ToUtf8(record).c_str()) == 0 || errno == ENOENT)
        return true;
    error = "cannot remove " + record + ": " + FromUtf8(std::strerror(errno));
    return false;
}

bool UnbindFolder(const wxString& folder)
{
    wxString error;
    if (UnbindFolder(folder, error))
        return true;
    PrintError(error);
    return false;
}
