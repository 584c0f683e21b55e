#include "cli/ServerBinding.h"

#include <fstream>
#include <sstream>
#include <unistd.h>

#include <wx/filename.h>

#include "ServerFromPpd.h"
#include "cli/ConsoleText.h"
#include "cli/QueueBinding.h"
#include "db/PathResolver.h"
#include "folder/HotFolder.h"
#include "folder/ServerDescription.h"

bool LoadPpdServer(const std::string& ppd, ServerDescription& server, std::string& bytes,
                   wxString& error)
{
    wxString xml;
    std::string reason;
    if (!printing::ServerDescriptionFromPpd(ppd, xml, reason))
    {
        error = FromUtf8(reason);
        return false;
    }
    std::ifstream in(ppd, std::ios::binary);
    std::ostringstream content;
    if (!in || !(content << in.rdbuf()))
    {
        error = "cannot read " + FromUtf8(ppd);
        return false;
    }
    bytes = content.str();
    return server.LoadText(xml, FromUtf8(ppd), error);
}

bool StoreServerBeside(const wxString& folder, const ServerDescription& server,
                       const std::string& ppdBytes)
{
    wxString error;
    if (StoreServerBeside(folder, server, ppdBytes, error))
        return true;
    PrintError(error);
    return false;
}

bool StoreServerBeside(const wxString& folder, const ServerDescription& server,
                       const std::string& ppdBytes, wxString& error)
{
    if (!StoreBeside(folder, HotFolder::kServerDescriptionName, ToUtf8(server.GetText()),
                     "server description", error))
        return false;
    if (!ppdBytes.empty())
        return StoreBeside(folder, HotFolder::kServerPpdName, ppdBytes, "printer description",
                           error);
    // A PPD from an earlier binding no longer describes the server.
    const wxString stale =
        wxFileName(db::PathResolver::GetContainerFolderPath(folder), HotFolder::kServerPpdName)
            .GetFullPath();
    unlink(ToUtf8(stale).c_str());
    return true;
}
