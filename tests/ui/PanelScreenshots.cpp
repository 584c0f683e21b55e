// Renders the EPS settings panel and the custom page size dialog to PNG
// files, for the documentation (scripts/screenshots.sh).
// Usage: ui_panel_screenshots <dir> <en|de>
#include <wx/app.h>
#include <wx/dcmemory.h>
#include <wx/dcscreen.h>
#include <wx/frame.h>
#include <wx/image.h>
#include <wx/sizer.h>
#include <wx/timer.h>

#include <hotfolder/HFTranslations.h>

#include "CustomPageSizeDlg.h"
#include "GermanClient.h"
#include "ImageSizePanelWithoutMerge.h"
#include "PanelFactories.h"

namespace
{
class ScreenshotApp : public wxApp
{
public:
    bool OnInit() override
    {
        if (argc < 3)
            return false;
        const wxString prefix = argv[1] + "/", suffix = "-" + argv[2] + ".png";
        wxInitAllImageHandlers();
        HFTranslations::GetInstance()->SelectLanguage(argv[2]);

        auto* frame = new wxFrame(nullptr, wxID_ANY, "EPS", wxPoint(0, 0));
        const wxString xml =
            wxString::FromUTF8(testkit::ReadFile(HF_TEST_DATA_DIR "/ui/server-ui.xml"));
        auto* panel = wxDynamicCast(ImageSizePanelWithoutMerge_Factory::CreateInstance(
                                        frame, xml, "EPS", ".eps", true, true),
                                    ImageSizePanelWithoutMerge);
        MapPropToValue settings;
        settings["OUTPUTFILETYPEEPS"] = "0";
        settings["ORIGINALSIZE"] = "0";
        settings["CUSTOMSIZE"] = "1";
        settings["ORIGINALWIDTH"] = "4.5";
        panel->LoadUISettings(settings);
        auto* sizer = new wxBoxSizer(wxVERTICAL);
        sizer->Add(panel, 1, wxEXPAND);
        frame->SetSizerAndFit(sizer);
        frame->Show();

        bool heightIsLength = false;
        auto* dialog = new CustomPageSizeDlg(
            nullptr, wxID_ANY, HFTranslations::GetInstance()->Translate("Custom page size"), 1,
            13.89, 1, 19.44, 8.5, 11, UNIT_INCH, heightIsLength);
        // Beside the frame: without a window manager nothing stacks them.
        dialog->Move(frame->GetSize().x + 20, 0);
        // A dialog is drawn for sure only inside its own modal loop. The
        // screen is read back in one snapshot: the screen device keeps the
        // first picture it took.
        wxTimer timer;
        timer.Bind(wxEVT_TIMER,
                   [&](wxTimerEvent&)
                   {
                       for (int i = 0; i < 50; ++i, wxMilliSleep(10))
                           wxYield();
                       wxScreenDC screen;
                       wxBitmap whole(screen.GetSize());
                       wxMemoryDC memory(whole);
                       memory.Blit(wxPoint(0, 0), screen.GetSize(), &screen, wxPoint(0, 0));
                       memory.SelectObject(wxNullBitmap);
                       m_ok =
                           whole.GetSubBitmap(panel->GetScreenRect())
                               .SaveFile(prefix + "settings-panel" + suffix, wxBITMAP_TYPE_PNG) &&
                           whole.GetSubBitmap(dialog->GetScreenRect())
                               .SaveFile(prefix + "custom-page-size" + suffix, wxBITMAP_TYPE_PNG);
                       dialog->EndModal(wxID_OK);
                   });
        timer.StartOnce(500);
        dialog->ShowModal();
        dialog->Destroy();
        frame->Destroy();
        return true;
    }
    int OnRun() override { return m_ok ? 0 : 1; }

private:
    bool m_ok = false;
};
} // namespace

wxIMPLEMENT_APP_NO_MAIN(ScreenshotApp);

int main(int argc, char** argv)
{
    // The German pictures show what a German user sees: the application
    // language, and with it the panel's decimal separator, come from the
    // client configuration, not only the catalogue.
    if (argc >= 3 && std::string(argv[2]) == "de")
        UseGermanClientConfiguration();
    return wxEntry(argc, argv);
}
