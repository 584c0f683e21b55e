// hotfolder-manager: the desktop window over the machine's hot folders.
#include <clocale>
#include <cstdio>
#include <cstring>

#include <wx/app.h>
#include <wx/cmdline.h>
#include <wx/intl.h>

#include <hotfolder/HFTranslations.h>

#include "module/ModuleLocator.h"
#include "ui/ManagerFrame.h"

namespace
{
// The user's language as the locale names it ("de" of de_DE.UTF-8), or "".
wxString UserLanguage()
{
    const int language = wxLocale::GetSystemLanguage();
    if (language == wxLANGUAGE_UNKNOWN || language == wxLANGUAGE_DEFAULT)
        return wxString();
    return wxLocale::GetLanguageCanonicalName(language).BeforeFirst('_');
}
} // namespace

class ManagerApp : public wxApp
{
public:
    void OnInitCmdLine(wxCmdLineParser& parser) override
    {
        wxApp::OnInitCmdLine(parser);
        parser.AddOption("", "module",
                         "the filter module (default: $HOTFOLDER_MODULE, else the "
                         "one installed beside this program)");
    }

    bool OnCmdLineParsed(wxCmdLineParser& parser) override
    {
        parser.Found("module", &m_module);
        return wxApp::OnCmdLineParsed(parser);
    }

    bool OnInit() override
    {
        if (!wxApp::OnInit())
            return false;
        // The toolkit keeps the C locale; the messages category alone follows
        // the desktop, so that the toolkit's own buttons (Cancel, the file
        // choosers) speak its language while numbers keep their ".".
        std::setlocale(LC_MESSAGES, "");
        HFTranslations::GetInstance()->SelectLanguage(UserLanguage());
        SetAppDisplayName(_("Hot folders"));
        auto* frame = new ManagerFrame(LocateFilterModule(m_module));
        frame->Show();
        return true;
    }

private:
    wxString m_module;
};

wxIMPLEMENT_APP_NO_MAIN(ManagerApp);

// The toolkit needs a display before it reads the command line; the usage
// is told without one.
int main(int argc, char** argv)
{
    for (int i = 1; i < argc; ++i)
        if (std::strcmp(argv[i], "--help") == 0 || std::strcmp(argv[i], "-h") == 0)
        {
            std::puts("usage: hotfolder-manager [--module PATH]\n"
                      "\n"
                      "The window over this machine's hot folders: their printers, jobs and\n"
                      "the pages their outputs make. --module names the filter module\n"
                      "(default: $HOTFOLDER_MODULE, else the one installed beside this program).");
            return 0;
        }
    return wxEntry(argc, argv);
}
