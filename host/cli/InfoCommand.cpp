// hotfolder info: what the module says about itself.
#include <memory>

#include <hotfolder/StatusCodes.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "module/FilterSession.h"
#include "module/ModuleLocator.h"

static const char kInfoUsage[] =
    "usage: hotfolder info [--module PATH]\n"
    "\n"
    "Loads the filter module and prints its description (kind, version,\n"
    "identifier, display name, extensions, required server features), what a\n"
    "filter object reports through its interface, and the text of every status\n"
    "code.\n";

static wxString Joined(const wxArrayString& items)
{
    return items.empty() ? wxString("(none)") : wxJoin(items, ' ', '\0');
}

int RunInfoCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args, {}, kInfoUsage, 0, 0, parsed, status))
        return status;

    wxString error;
    const wxString modulePath = LocateFilterModule(FromUtf8(parsed.Get("--module")));
    std::unique_ptr<FilterSession> session =
        FilterSession::Start(modulePath, wxString(), nullptr, error);
    if (!session)
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    const PluginInfo& info = session->Info();
    HFPlugin& filter = session->Filter();

    PrintLine("Module:                    " + modulePath);
    PrintLine(
        wxString::Format("Kind:                      %lld", static_cast<long long>(info.m_llKind)));
    PrintLine("Version:                   " + info.m_strVersion);
    PrintLine("Identifier:                " + info.m_strIdentifier);
    PrintLine("Display name:              " + info.m_strDisplayName);
    PrintLine("Extensions:                " + Joined(info.m_arrExtensions));
    PrintLine("Required server features:  " + Joined(info.m_arrRequiredServerFeatures));

    wxString version, displayName, shortName;
    wxArrayString extensions, second, serverKeys;
    filter.GetVersion(version);
    filter.GetDisplayName(displayName);
    filter.GetShortName(shortName);
    filter.GetSupportedFileExtensions(extensions, second);
    filter.GetServerKeys(serverKeys);
    PrintLine("Filter object:");
    PrintLine("  Version:                 " + version);
    PrintLine("  Display name:            " + displayName);
    PrintLine("  Short name:              " + shortName);
    PrintLine("  File extensions:         " + Joined(extensions));
    PrintLine(wxString::Format("  Group type:              %d", filter.GetGroupType()));
    PrintLine("  Server keys:             " + Joined(serverKeys));
    PrintLine(
        wxString::Format("  Initialised:             %s", filter.IsInitialized() ? "yes" : "no"));
    PrintLine(
        wxString::Format("  Merge enabled:           %s", filter.IsMergeEnabled() ? "yes" : "no"));
    PrintLine("Status codes:");
    for (const HFStatusText& entry : kHFStatusTexts)
    {
        wxString text;
        filter.GetErrorString(entry.code, text);
        PrintLine(wxString::Format("  %6ld  %s", entry.code, text));
    }
    return kExitSuccess;
}
