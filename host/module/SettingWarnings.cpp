#include "module/SettingWarnings.h"

#include "SettingsKeys.h"

using namespace SettingsKeys;

namespace
{
class Combination
{
public:
    Combination(const SettingList& settings, const std::set<wxString>& changed)
        : m_settings(settings), m_changed(changed)
    {
    }

    wxString Value(const wxString& key) const
    {
        for (const auto& setting : m_settings)
            if (setting.first == key)
                return setting.second;
        return wxString();
    }
    // As the filter reads a flag: on only when stored as "1".
    bool On(const wxString& key) const { return IsSettingOn(Value(key)); }
    bool Changed(const wxString& key) const { return m_changed.count(key) > 0; }
    bool ChangedTo(const wxString& key, bool on) const { return Changed(key) && On(key) == on; }
    // The assigned keys among keys, blank-separated; empty when none.
    wxString ChangedAmong(std::initializer_list<const char*> keys) const
    {
        wxString names;
        for (const char* key : keys)
            if (Changed(key))
                names << (names.empty() ? "" : " ") << key;
        return names;
    }

    // "takes" after one key, "take" after several.
    static wxString Verb(const wxString& names, const wxString& plural)
    {
        return names.Contains(" ") ? plural : plural + "s";
    }

private:
    const SettingList& m_settings;
    const std::set<wxString>& m_changed;
};

const std::initializer_list<const char*> kPageAndImageKeys = {
    CUSTOMPAGESIZE,       DEFAULTPAGESIZE,   ORIENTATIONPOTRAIT, ORIENTATIONLANDSCAPE,
    AUTOROTATE,           IMAGEPOSITION,     FORCEPAGESIZEX,     FORCEPAGESIZEY,
    IMAGEEABLESIZELLX,    IMAGEEABLESIZELLY, IMAGEEABLESIZEURX,  IMAGEEABLESIZEURY,
    PAGESIZE_COMMAND,     CUSTOMPAGEWIDTH,   CUSTOMPAGEHEIGHT,   CUSTOMPAGETUNIT,
    ORIGINALSIZE,         CUSTOMSIZE,        CONTRAINPROPORTION, ORIGINALWIDTHOPTION,
    ORIGINALHEIGHTOPTION, ORIGINALWIDTH,     ORIGINALHEIGHT,     ORIGINALWIDTHUNIT,
    ORIGINALHEIGHTUNIT,   FORCEAUTOSCALE,    FITTOPAGE,          SHRINKTOFIT,
    SCALETOPRINT};

void OutputType(const Combination& c, std::vector<wxString>& warnings)
{
    if (c.On(OUTPUTFILETYPEEPS))
    {
        if (c.ChangedTo(OUTPUTFILETYPEPS, true))
            warnings.push_back("OUTPUTFILETYPEPS=1 has no effect while OUTPUTFILETYPEEPS is 1: "
                               "files still pass through as EPS; set OUTPUTFILETYPEEPS=0 to "
                               "convert them to PostScript");
        const wxString page = c.ChangedAmong(kPageAndImageKeys);
        if (!page.empty())
            warnings.push_back(page + " " + Combination::Verb(page, "take") +
                               " effect only once OUTPUTFILETYPEEPS is 0: files "
                               "pass through as EPS, without a page of their own");
    }
    else if (!c.On(OUTPUTFILETYPEPS) &&
             (c.Changed(OUTPUTFILETYPEEPS) || c.Changed(OUTPUTFILETYPEPS)))
        warnings.push_back(
            "OUTPUTFILETYPEPS is 0, but with OUTPUTFILETYPEEPS=" + c.Value(OUTPUTFILETYPEEPS) +
            " the files are converted to PostScript all the same");
}

// The filter takes the first size mode that is on: original, custom, auto-scale.
void SizeMode(const Combination& c, std::vector<wxString>& warnings)
{
    const bool original = c.On(ORIGINALSIZE), custom = !original && c.On(CUSTOMSIZE);
    const bool autoScale = !original && !custom && c.On(FORCEAUTOSCALE);
    if (c.ChangedTo(CUSTOMSIZE, true) && original)
        warnings.push_back("CUSTOMSIZE=1 has no effect while ORIGINALSIZE is 1 (the original "
                           "size wins); set ORIGINALSIZE=0");
    if (c.ChangedTo(FORCEAUTOSCALE, true) && (original || custom))
        warnings.push_back(wxString("FORCEAUTOSCALE=1 has no effect while ") +
                           (original ? ORIGINALSIZE : CUSTOMSIZE) + " is 1 (it wins); set it to 0");
    const wxString customKeys =
        c.ChangedAmong({ORIGINALWIDTH, ORIGINALHEIGHT, ORIGINALWIDTHUNIT, ORIGINALHEIGHTUNIT,
                        CONTRAINPROPORTION, ORIGINALWIDTHOPTION, ORIGINALHEIGHTOPTION});
    if (!customKeys.empty() && !custom)
        warnings.push_back(customKeys + " " + Combination::Verb(customKeys, "take") +
                           " effect only with CUSTOMSIZE=1 and ORIGINALSIZE=0");
    const wxString scaleKeys = c.ChangedAmong({FITTOPAGE, SHRINKTOFIT, SCALETOPRINT});
    if (!scaleKeys.empty() && !autoScale)
        warnings.push_back(scaleKeys + " " + Combination::Verb(scaleKeys, "take") +
                           " effect only with FORCEAUTOSCALE=1 (and ORIGINALSIZE "
                           "and CUSTOMSIZE 0)");
    if (c.Changed(SHRINKTOFIT) && c.On(SHRINKTOFIT) == c.On(FITTOPAGE))
        warnings.push_back("SHRINKTOFIT=" + c.Value(SHRINKTOFIT) +
                           " is not read: auto-scaling fits to the page when FITTOPAGE is 1 and "
                           "shrinks to fit otherwise (FITTOPAGE is " +
                           (c.Value(FITTOPAGE).empty() ? wxString("not set") : c.Value(FITTOPAGE)) +
                           ")");
    for (const auto& dimension : {std::make_pair(ORIGINALWIDTH, ORIGINALWIDTHUNIT),
                                  std::make_pair(ORIGINALHEIGHT, ORIGINALHEIGHTUNIT)})
        if (c.Changed(dimension.first) && c.Value(dimension.second).empty())
            warnings.push_back(wxString(dimension.first) + " is read in points while " +
                               dimension.second + " is not set (inch or mm)");
}

void Paper(const Combination& c, bool hasServer, std::vector<wxString>& warnings)
{
    const wxString noServer = " has no effect: the folder has no server description, so it "
                              "knows no paper (bind one with --server, --ppd or --printer)";
    if (!hasServer && c.Changed(DEFAULTPAGESIZE))
        warnings.push_back("DEFAULTPAGESIZE=" + c.Value(DEFAULTPAGESIZE) + noServer);
    if (!hasServer && c.ChangedTo(CUSTOMPAGESIZE, true))
        warnings.push_back("CUSTOMPAGESIZE=1" + noServer);
    else if (c.ChangedTo(CUSTOMPAGESIZE, true) || c.Changed(CUSTOMPAGEWIDTH) ||
             c.Changed(CUSTOMPAGEHEIGHT))
    {
        const wxString keys = c.ChangedAmong({CUSTOMPAGESIZE, CUSTOMPAGEWIDTH, CUSTOMPAGEHEIGHT});
        warnings.push_back(
            keys + " " + Combination::Verb(keys, "change") +
            " the page only when the settings window saves them; from the command line "
            "the page is FORCEPAGESIZEX/Y and IMAGEEABLESIZELLX/LLY/URX/URY");
    }
}
} // namespace

std::vector<wxString> SettingWarnings(const SettingList& settings,
                                      const std::set<wxString>& changed, bool hasServer)
{
    const Combination combination(settings, changed);
    std::vector<wxString> warnings;
    OutputType(combination, warnings);
    // Passed through, a file has no page: the line above says all there is.
    if (combination.On(OUTPUTFILETYPEEPS))
        return warnings;
    SizeMode(combination, warnings);
    Paper(combination, hasServer, warnings);
    return warnings;
}
