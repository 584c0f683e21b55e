#include "core/FolderSetup.h"

#include <cerrno>
#include <cstring>
#include <unistd.h>
#include <vector>

#include <wx/filename.h>
#include <wx/intl.h>

#include "cli/ConsoleText.h"
#include "cli/FolderCreation.h"
#include "cli/QueueBinding.h"
#include "cli/ServerBinding.h"
#include "db/HFDatabase.h"
#include "db/PathResolver.h"
#include "folder/HotFolder.h"
#include "folder/ServerDescription.h"
#include "posix/NativePath.h"
#include "service/HotFolderListEntries.h"

namespace
{
wxString AbsoluteFolder(const wxString& folder)
{
    wxFileName name = wxFileName::DirName(folder);
    name.MakeAbsolute();
    return name.GetPath();
}

wxString StoredPpdPath(const wxString& folder)
{
    return wxFileName(db::PathResolver::GetContainerFolderPath(folder), HotFolder::kServerPpdName)
        .GetFullPath();
}

// As "settings --ppd": the PPD's description and a copy beside Folder.cfg; a
// queue binding goes, since the queue's description is not the folder's now.
bool BindFolderToPpd(const wxString& folder, const std::string& ppd, wxString& error)
{
    ServerDescription server;
    std::string ppdBytes;
    return LoadPpdServer(ppd, server, ppdBytes, error) &&
           StoreServerBeside(folder, server, ppdBytes, error) && UnbindFolder(folder, error);
}

bool SameChoice(const PrinterChoice& a, const PrinterChoice& b)
{
    return a.kind == b.kind && (a.kind == PrinterChoice::Kind::None || a.value == b.value);
}
} // namespace

bool LoadPrinterServer(const PrinterChoice& choice, wxString& serverXml, wxString& error)
{
    serverXml.clear();
    ServerDescription server;
    std::string bytes;
    wxString origin;
    switch (choice.kind)
    {
    case PrinterChoice::Kind::None:
        return true;
    case PrinterChoice::Kind::Queue:
        if (!LoadQueueServer(choice.value, server, bytes, origin, error))
            return false;
        break;
    case PrinterChoice::Kind::PpdFile:
        if (!LoadPpdServer(choice.value, server, bytes, error))
            return false;
        break;
    }
    serverXml = server.GetText();
    return true;
}

bool CreateHotFolder(const wxString& folder, const wxString& name, const PrinterChoice& choice,
                     const wxString& modulePath, wxString& warnings, wxString& error)
{
    FolderCreationRequest request;
    request.folder = AbsoluteFolder(folder);
    request.name = name;
    request.modulePath = modulePath;
    if (choice.kind == PrinterChoice::Kind::Queue)
        request.queue = choice.value;
    else if (choice.kind == PrinterChoice::Kind::PpdFile)
        request.ppdFile = choice.value;
    if (choice.kind != PrinterChoice::Kind::None && choice.value.empty())
    {
        error = _("No printer was chosen.");
        return false;
    }
    FolderCreationPlan plan;
    std::vector<wxString> lines;
    const bool created = PlanFolderCreation(request, plan, error) &&
                         CreatePlannedFolder(request, plan, lines, error);
    warnings = wxJoin(wxArrayString(lines.size(), lines.data()), '\n', 0);
    return created;
}

namespace
{
// As "settings --printer none", and the PPD kept from an earlier queue or
// file goes too: the folder prints nowhere and says so. Its server
// description stays, with the papers the settings name.
bool UnbindFolderFully(const wxString& folder, wxString& error)
{
    if (!UnbindFolder(folder, error))
        return false;
    const wxString ppd = StoredPpdPath(folder);
    if (unlink(posix::NativePath(ppd).c_str()) == 0 || errno == ENOENT)
        return true;
    error = wxString::Format(_("Cannot remove %s: %s"), posix::ShownLine(ppd),
                             wxString::FromUTF8(std::strerror(errno)));
    return false;
}

bool Rebind(const wxString& folder, const PrinterChoice& choice, wxString& error)
{
    if (SameChoice(choice, CurrentPrinterChoice(folder)))
        return true;
    switch (choice.kind)
    {
    case PrinterChoice::Kind::None:
        return UnbindFolderFully(folder, error);
    case PrinterChoice::Kind::Queue:
        return BindFolderToQueue(folder, choice.value, error);
    case PrinterChoice::Kind::PpdFile:
        return BindFolderToPpd(folder, choice.value, error);
    }
    return true;
}
} // namespace

bool ChangeFolderSetup(const wxString& folder, const wxString& name, const PrinterChoice& choice,
                       wxString& error)
{
    HotFolder hotFolder;
    if (!hotFolder.Open(folder, error))
        return false;
    // The printer first: a queue or file that cannot be had changes nothing.
    return Rebind(hotFolder.GetFolder(), choice, error) &&
           (name == hotFolder.GetName() || hotFolder.SaveName(name, error));
}

PrinterChoice CurrentPrinterChoice(const wxString& folder)
{
    PrinterChoice choice;
    choice.value = HotFolder::BoundQueueOf(folder);
    if (!choice.value.empty())
        choice.kind = PrinterChoice::Kind::Queue;
    else if (wxFileName::FileExists(StoredPpdPath(folder)))
    {
        choice.kind = PrinterChoice::Kind::PpdFile;
        choice.value = ToUtf8(StoredPpdPath(folder));
    }
    return choice;
}

bool RemoveFolderFromList(const wxString& folder, wxString& error)
{
    const wxString entry = FindHotFolderListEntry(folder);
    if (entry.empty())
    {
        error = wxString::Format(_("%s is not in the hot-folder list."), folder);
        return false;
    }
    if (!db::HFDatabase::DeleteFromHotfolderList(entry))
    {
        error = wxString::Format(_("Cannot change the hot-folder list %s."), HotFolderListFile());
        return false;
    }
    return true;
}
