// hotfolder settings: show or change a hot folder's filter settings, from
// the command line or in the filter's own settings panel.
#include <algorithm>
#include <cstdio>
#include <memory>
#include <set>

#include <wx/app.h>
#include <wx/button.h>
#include <wx/dialog.h>
#include <wx/filename.h>
#include <wx/init.h>
#include <wx/msgdlg.h>
#include <wx/sizer.h>
#include <wx/xml/xml.h>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "cli/QueueBinding.h"
#include "cli/ServerBinding.h"
#include "module/FilterSession.h"
#include "module/FilterSettings.h"
#include "module/SettingDefaults.h"
#include "module/SettingWarnings.h"
#include "folder/HotFolder.h"
#include "module/ModuleLocator.h"
#include "folder/ServerDescription.h"
#include "folder/ServerPapers.h"
#include "PageSizeKeys.h"
#include "SettingsKeys.h"
#include "posix/NativePath.h"

static const char kSettingsUsage[] =
    "usage: hotfolder settings FOLDER [--show | --set KEY=VALUE ... | --accept]\n"
    "                          [--server FILE | --ppd FILE.ppd | --printer QUEUE|none]\n"
    "                          [--preflight on|off]\n"
    "                          [--module PATH]\n"
    "\n"
    "Without options, opens the filter's settings panel in a window; OK stores\n"
    "the settings in the folder's Folder.cfg, Cancel leaves them alone.\n"
    "\n"
    "  --show     print every setting in the filter's order, one KEY=VALUE a\n"
    "             line, with what the settings window takes when it is not set\n"
    "  --set      change settings without a window; unknown keys and malformed\n"
    "             or out-of-range values are refused and nothing is changed.\n"
    "             DEFAULTPAGESIZE names one of the server's papers and also sets\n"
    "             its page size, imageable area and page command. Flags take 1\n"
    "             or 0. A value that is stored but will not do what it suggests\n"
    "             (PostScript chosen while EPS passes through, fitting without\n"
    "             auto-scale, a paper without a server, ...) gets a warning\n"
    "  --accept   open the window and close it with OK at once (scripts, tests)\n"
    "  --server FILE, --ppd FILE.ppd\n"
    "             bind the folder to another server description, or to one made\n"
    "             from a printer's PPD (kept beside it), as init does; a folder\n"
    "             bound to a CUPS queue no longer prints there\n"
    "  --printer  bind the folder to the CUPS queue QUEUE: its papers become the\n"
    "             folder's server description and the service prints every\n"
    "             output there; 'none' prints nowhere, outputs stay in Output\n"
    "  --preflight on|off\n"
    "             on: every output goes through Ghostscript before delivery; an\n"
    "             output it cannot run to the end, or with a page without marks,\n"
    "             fails its job. off: outputs are delivered as made\n"
    "\n"
    "Keys: OUTPUTFILETYPEEPS OUTPUTFILETYPEPS DEFAULTPAGESIZE CUSTOMPAGESIZE\n"
    "      IMAGEPOSITION (Top Left, Top Right, Center, Bottom Left, Bottom Right)\n"
    "      AUTOROTATE ORIENTATIONPOTRAIT ORIENTATIONLANDSCAPE FORCEPAGESIZEX/Y\n"
    "      IMAGEEABLESIZELLX/LLY/URX/URY CUSTOMPAGEWIDTH/HEIGHT CUSTOMPAGETUNIT\n"
    "      PAGESIZE_COMMAND ORIGINALSIZE CUSTOMSIZE CONTRAINPROPORTION\n"
    "      ORIGINALWIDTH ORIGINALHEIGHT (in the settings window's range for the unit)\n"
    "      ORIGINALWIDTHUNIT ORIGINALHEIGHTUNIT ORIGINALWIDTHOPTION\n"
    "      ORIGINALHEIGHTOPTION FORCEAUTOSCALE FITTOPAGE SHRINKTOFIT SCALETOPRINT\n";

namespace
{
// The filter's "Filter" element as stored, or a new empty one.
wxXmlNode StoredFilter(const HotFolder& folder, const wxString& identifier)
{
    if (const wxXmlNode* stored = folder.FindFilter(identifier))
        return *stored;
    wxXmlNode filter(wxXML_ELEMENT_NODE, "Filter");
    filter.AddAttribute("name", identifier);
    return filter;
}

wxString Identifier(const wxString& modulePath, wxString& error)
{
    std::unique_ptr<FilterModule> module = FilterModule::Open(modulePath, error);
    if (!module)
        return wxString();
    PluginInfo info;
    module->Describe(info);
    return info.m_strIdentifier;
}

// Every key in catalogue order, then whatever else is stored. Values are
// shown on one line each (a page command holds line breaks).
int ShowSettings(const HotFolder& folder, const wxString& identifier,
                 const ServerDescription& server)
{
    ServerPapers papers;
    if (!server.IsEmpty())
        papers.Load(server.GetText());
    wxXmlNode filter = StoredFilter(folder, identifier);
    SettingList stored = ReadFilterSettings(&filter);
    auto line = [](const wxString& key, const wxString& value, const wxString& note)
    { PrintLine(key + "=" + posix::ShownLine(value) + "  # " + note); };
    for (const wxString& key : KnownSettingKeys())
    {
        auto found = std::find_if(stored.begin(), stored.end(),
                                  [&](const auto& setting) { return setting.first == key; });
        const wxString value = found == stored.end() ? wxString() : found->second;
        if (found != stored.end())
            stored.erase(found);
        line(key, value,
             (value.empty() ? "not set; default: " : "default: ") +
                 DescribeSettingDefault(key, papers.sheets));
    }
    for (const auto& setting : stored)
        line(setting.first, setting.second, "not a setting of this filter");
    return kExitSuccess;
}

int SetSettings(HotFolder& folder, const wxString& identifier, const ServerDescription& server,
                const std::vector<std::string>& assignments)
{
    ServerPapers papers;
    papers.Load(server.GetText());
    wxXmlNode filter = StoredFilter(folder, identifier);
    wxString error;
    std::set<wxString> changed;
    if (!ApplySettingAssignments(&filter, assignments, papers.sheets, error, &changed))
    {
        PrintError(error);
        return kExitUsage;
    }
    if (!folder.SaveFilter(filter, error))
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    PrintLine("Settings of " + folder.GetFolder() + " updated.");
    for (const wxString& warning :
         SettingWarnings(ReadFilterSettings(&filter), changed, !server.IsEmpty()))
        PrintError("warning: " + warning);
    return kExitSuccess;
}

// Binds the folder to the server of --server or --ppd, as init stores one.
// A queue binding goes: the queue's description is not the folder's now.
bool RebindServer(HotFolder& folder, const std::string& serverFile, const std::string& ppdFile)
{
    ServerDescription server;
    std::string ppdBytes;
    wxString error;
    const wxString origin = FromUtf8(serverFile.empty() ? ppdFile : serverFile);
    if (!(serverFile.empty() ? LoadPpdServer(ppdFile, server, ppdBytes, error)
                             : server.Load(origin, error)))
    {
        PrintError(error);
        return false;
    }
    const std::string queue = folder.GetBoundQueue();
    if (!StoreServerBeside(folder.GetFolder(), server, ppdBytes) ||
        (!queue.empty() && !UnbindFolder(folder.GetFolder())))
        return false;
    PrintLine(folder.GetFolder() + " now submits to the server of " + origin +
              (queue.empty() ? wxString()
                             : "; it no longer prints on " + FromUtf8(queue) +
                                   ", outputs stay in " + folder.GetDefaultOutputFolder()));
    return true;
}

// A stored paper the new server does not offer would leave the page to the
// old server's values.
void WarnAboutStoredPaper(const HotFolder& folder, const wxString& identifier,
                          const ServerDescription& server)
{
    wxXmlNode filter = StoredFilter(folder, identifier);
    for (const auto& setting : ReadFilterSettings(&filter))
        if (setting.first == SettingsKeys::DEFAULTPAGESIZE && !setting.second.empty())
        {
            ServerPapers papers;
            papers.Load(server.GetText());
            if (!FindSheetByPaperName(papers.sheets, setting.second))
                PrintError("warning: the server offers no paper " + setting.second +
                           " (DEFAULTPAGESIZE); the page keeps the old paper's size until "
                           "--set DEFAULTPAGESIZE names one of its papers");
        }
}

// The "Status" entry of the folder's PreflightSettings; the other entries stay.
bool SavePreflightSwitch(HotFolder& folder, bool on)
{
    db::PreflightConfiguration preflight = folder.GetPreflight();
    preflight.SetPreflightEnabled(on);
    wxString error;
    if (!folder.SavePreflight(preflight, error))
    {
        PrintError(error);
        return false;
    }
    PrintLine(folder.GetFolder() + (on ? ": preflight on; every output goes through Ghostscript "
                                         "before it is delivered"
                                       : ": preflight off"));
    return true;
}

class HostApp : public wxApp
{
public:
    bool OnInit() override { return true; }
};

// The dialog around the filter's panel. OK asks the filter to save; a panel
// that refuses its values keeps the dialog open.
int EditInWindow(HotFolder& folder, const wxString& modulePath, const ServerDescription& server,
                 bool acceptAtOnce)
{
    wxString error;
    std::unique_ptr<FilterSession> session =
        FilterSession::Start(modulePath, server.GetText(), &folder.GetFilterSetting(), error);
    if (!session)
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    const wxString identifier = session->Info().m_strIdentifier;
    int result = kExitSuccess;
    {
        wxDialog dialog(nullptr, wxID_ANY,
                        session->Info().m_strDisplayName + " settings - " +
                            wxFileName::DirName(folder.GetFolder()).GetDirs().Last(),
                        wxDefaultPosition, wxDefaultSize, wxDEFAULT_DIALOG_STYLE | wxRESIZE_BORDER);
        wxWindow* panel = session->Filter().ShowPluginUI(&dialog);
        if (!panel)
        {
            PrintError("the filter offers no settings panel");
            return kExitSetupFailed;
        }
        auto* sizer = new wxBoxSizer(wxVERTICAL);
        sizer->Add(panel, 1, wxEXPAND | wxALL, 8);
        sizer->Add(dialog.CreateStdDialogButtonSizer(wxOK | wxCANCEL), 0, wxEXPAND | wxALL, 8);
        dialog.SetSizerAndFit(sizer);
        dialog.Centre();
        if (acceptAtOnce)
            dialog.CallAfter([&dialog] { dialog.EndModal(wxID_OK); });

        for (;;)
        {
            if (dialog.ShowModal() != wxID_OK)
            {
                PrintLine("Cancelled; the settings are unchanged.");
                break;
            }
            wxXmlNode filter(wxXML_ELEMENT_NODE, "Filter");
            filter.AddAttribute("name", identifier);
            if (session->Filter().SavePreference(&filter) != 0)
            {
                if (acceptAtOnce)
                {
                    PrintError("the settings panel refused its values");
                    result = kExitUsage;
                    break;
                }
                wxMessageBox("Please correct the highlighted values.", dialog.GetTitle(),
                             wxOK | wxICON_WARNING, &dialog);
                continue;
            }
            if (!folder.SaveFilter(filter, error))
            {
                PrintError(error);
                result = kExitSetupFailed;
            }
            else
                PrintLine("Settings of " + folder.GetFolder() + " saved.");
            break;
        }
    }
    return result;
}
} // namespace

int RunSettingsCommand(int argc, char** argv, const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args,
                          {{"--show", false, false, ""},
                           {"--set", false, true, ""},
                           {"--accept", false, false, ""},
                           {"--server", true, false, ""},
                           {"--ppd", true, false, ""},
                           {"--printer", true, false, ""},
                           {"--preflight", true, false, ""}},
                          kSettingsUsage, 1, 1, parsed, status))
        return status;
    const bool rebinds = parsed.Has("--server") || parsed.Has("--ppd");
    if (parsed.Has("--server") + parsed.Has("--ppd") + parsed.Has("--printer") > 1)
    {
        PrintError("only one of --server, --ppd and --printer can be given");
        std::fputs(kSettingsUsage, stderr);
        return kExitUsage;
    }
    const std::string preflight = parsed.Get("--preflight");
    if (parsed.Has("--preflight") && preflight != "on" && preflight != "off")
    {
        PrintError("--preflight takes on or off");
        return kExitUsage;
    }
    const bool windowed = !parsed.Has("--show") && !parsed.Has("--set") &&
                          !parsed.Has("--printer") && !parsed.Has("--preflight") && !rebinds;
    std::unique_ptr<wxInitializer> initializer;
    if (!windowed)
    {
        initializer = std::make_unique<wxInitializer>(argc, argv);
        if (!initializer->IsOk())
        {
            PrintError("cannot initialise wxWidgets");
            return kExitSetupFailed;
        }
    }
    // Toolkit set-up comes first: every wx object below needs it.
    if (windowed)
    {
        wxApp::SetInstance(new HostApp);
        int toolkitArgc = 1;
        char* toolkitArgv[] = {argv[0], nullptr};
        if (!wxEntryStart(toolkitArgc, toolkitArgv))
        {
            PrintError("cannot open a window (is there a display?); use --show or --set");
            return kExitSetupFailed;
        }
        wxTheApp->CallOnInit();
    }
    struct ToolkitCleanup
    {
        bool active;
        ~ToolkitCleanup()
        {
            if (active)
                wxEntryCleanup();
        }
    } cleanup{windowed};

    wxString error;
    HotFolder folder;
    ServerDescription server;
    if (!OpenFolderAndServer(parsed.positionals[0], folder, server))
        return kExitSetupFailed;
    if (parsed.Has("--printer"))
    {
        const std::string queue = parsed.Get("--printer");
        if (queue == "none" ? !UnbindFolder(folder.GetFolder())
                            : !BindFolderToQueue(folder.GetFolder(), queue))
            return kExitSetupFailed;
        PrintLine(queue == "none" ? folder.GetFolder() + " prints nowhere; outputs stay in " +
                                        folder.GetDefaultOutputFolder()
                                  : folder.GetFolder() + " prints on " + FromUtf8(queue));
        if (!parsed.Has("--set") && !parsed.Has("--show") && !parsed.Has("--preflight"))
            return kExitSuccess;
        if (!OpenFolderAndServer(parsed.positionals[0], folder, server))
            return kExitSetupFailed;
    }
    const wxString modulePath = LocateFilterModule(FromUtf8(parsed.Get("--module")));
    if (rebinds)
    {
        if (!RebindServer(folder, parsed.Get("--server"), parsed.Get("--ppd")) ||
            !OpenFolderAndServer(parsed.positionals[0], folder, server))
            return kExitSetupFailed;
        const wxString identifier = Identifier(modulePath, error);
        if (!identifier.empty())
            WarnAboutStoredPaper(folder, identifier, server);
        if (!parsed.Has("--set") && !parsed.Has("--show") && !parsed.Has("--preflight"))
            return kExitSuccess;
    }
    if (parsed.Has("--preflight"))
    {
        if (!SavePreflightSwitch(folder, preflight == "on"))
            return kExitSetupFailed;
        if (!parsed.Has("--set") && !parsed.Has("--show"))
            return kExitSuccess;
    }
    if (windowed)
        return EditInWindow(folder, modulePath, server, parsed.Has("--accept"));

    const wxString identifier = Identifier(modulePath, error);
    if (identifier.empty())
    {
        PrintError(error);
        return kExitSetupFailed;
    }
    if (parsed.Has("--set"))
        return SetSettings(folder, identifier, server, parsed.All("--set"));
    return ShowSettings(folder, identifier, server);
}
