// hotfolder settings: show or change a hot folder's filter settings, from
// the command line or in the filter's own settings panel.
#include <memory>

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
#include "module/FilterSession.h"
#include "module/FilterSettings.h"
#include "folder/HotFolder.h"
#include "module/ModuleLocator.h"
#include "folder/ServerDescription.h"
#include "folder/ServerPapers.h"

static const char kSettingsUsage[] =
    "usage: hotfolder settings FOLDER [--show | --set KEY=VALUE ... | --accept]\n"
    "                          [--printer QUEUE|none] [--preflight on|off]\n"
    "                          [--module PATH]\n"
    "\n"
    "Without options, opens the filter's settings panel in a window; OK stores\n"
    "the settings in the folder's Folder.cfg, Cancel leaves them alone.\n"
    "\n"
    "  --show     print the stored settings, one KEY=VALUE a line\n"
    "  --set      change settings without a window; unknown keys and malformed\n"
    "             values are refused and nothing is changed. DEFAULTPAGESIZE\n"
    "             names one of the server's papers and also sets its page size,\n"
    "             imageable area and page command. Flags take 1 or 0.\n"
    "  --accept   open the window and close it with OK at once (scripts, tests)\n"
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
    "      ORIGINALWIDTH ORIGINALHEIGHT ORIGINALWIDTHUNIT ORIGINALHEIGHTUNIT\n"
    "      ORIGINALWIDTHOPTION ORIGINALHEIGHTOPTION FORCEAUTOSCALE FITTOPAGE\n"
    "      SHRINKTOFIT SCALETOPRINT\n";

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

int ShowSettings(const HotFolder& folder, const wxString& identifier)
{
    wxXmlNode filter = StoredFilter(folder, identifier);
    for (const auto& setting : ReadFilterSettings(&filter))
        PrintLine(setting.first + "=" + setting.second);
    return kExitSuccess;
}

int SetSettings(HotFolder& folder, const wxString& identifier, const ServerDescription& server,
                const std::vector<std::string>& assignments)
{
    ServerPapers papers;
    papers.Load(server.GetText());
    wxXmlNode filter = StoredFilter(folder, identifier);
    wxString error;
    if (!ApplySettingAssignments(&filter, assignments, papers.sheets, error))
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
    return kExitSuccess;
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
                           {"--printer", true, false, ""},
                           {"--preflight", true, false, ""}},
                          kSettingsUsage, 1, 1, parsed, status))
        return status;
    const std::string preflight = parsed.Get("--preflight");
    if (parsed.Has("--preflight") && preflight != "on" && preflight != "off")
    {
        PrintError("--preflight takes on or off");
        return kExitUsage;
    }
    const bool windowed = !parsed.Has("--show") && !parsed.Has("--set") &&
                          !parsed.Has("--printer") && !parsed.Has("--preflight");
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
    if (parsed.Has("--preflight"))
    {
        if (!SavePreflightSwitch(folder, preflight == "on"))
            return kExitSetupFailed;
        if (!parsed.Has("--set") && !parsed.Has("--show"))
            return kExitSuccess;
    }
    const wxString modulePath = LocateFilterModule(FromUtf8(parsed.Get("--module")));
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
    return ShowSettings(folder, identifier);
}
