#include "utils/HFHelper.h"

#include <clocale>

#include <wx/app.h>
#include <wx/ffile.h>
#include <wx/filename.h>
#include <wx/intl.h>
#include <wx/stdpaths.h>

#include "utils/Config.h"

namespace
{
struct LanguageCode
{
    const char* code;
    const char* name;
};

// Locale codes of the workstation language file and the wxWidgets
// language names they stand for.
const LanguageCode kLanguages[] = {
    {"en_US", "English (U.S.)"},
    {"es_ES", "Spanish"},
    {"it_IT", "Italian"},
    {"fr_FR", "French"},
    {"zh_CN", "Chinese (Simplified)"},
    {"de_DE", "German"},
    {"ja_JP", "Japanese"},
    {"pt_BR", "Portuguese (Brazilian)"},
    {"nl_NL", "Dutch"},
    {"cs_CZ", "Czech"},
    {"ru_RU", "Russian"},
    {"pl_PL", "Polish"},
    {"tr_TR", "Turkish"},
    {"zh_TW", "Chinese (Traditional)"},
    {"ko_KR", "Korean"},
};

// Locale names of the form other platforms accept, for glibc.
const LanguageCode kLocaleAliases[] = {
    {"en_US", "english-us"},
    {"pt_BR", "portuguese-brazilian"},
    {"zh_CN", "chinese-simplified"},
};

wxString FirstLineOf(const wxString& path)
{
    wxFFile file(path, "rb");
    wxString content;
    if (!file.IsOpened() || !file.ReadAll(&content, wxConvUTF8))
        return wxString();
    return content.BeforeFirst('\n').Trim(true).Trim(false);
}
} // namespace

wxString HFHelper::getHFVersion(bool initialize)
{
    if (initialize)
        utils::Config::GetInstance().Initialize();
    wxString version;
    utils::Config::ReadString("APP_HF_VERSION", version);
    return version;
}

int HFHelper::GetLocale(bool initialize)
{
    if (getHFVersion(initialize).CmpNoCase("3.3") == 0)
        return GetLanguageID();
    return wxLANGUAGE_DEFAULT;
}

wxString HFHelper::GetLocaleName()
{
    return wxLocale::GetLanguageName(GetLocale(true));
}

wxString HFHelper::GetLanguageFileDirectory()
{
    // The workstation software keeps its files beside the applications' own
    // data directories. On Linux wxStandardPaths::GetUserDataDir() is
    // $HOME/.<app>, so the directory ends up as $HOME/Vomal QDK.
    // Without an application object there are no standard paths; the
    // parent of the user data directory is then the home directory.
    const wxString base =
        wxAppConsole::GetInstance()
            ? wxStandardPaths::Get().GetUserDataDir().BeforeLast(wxFileName::GetPathSeparator())
            : wxFileName::GetHomeDir();
    const wxString directory = base + wxFileName::GetPathSeparator() + "Vomal QDK";
    if (!wxFileName::DirExists(directory))
        wxFileName::Mkdir(directory, wxS_DIR_DEFAULT, wxPATH_MKDIR_FULL);
    return directory;
}

int HFHelper::GetLanguageID()
{
    const wxFileName languageFile(GetLanguageFileDirectory(), "current.lang");
    if (languageFile.FileExists())
    {
        wxString name = FirstLineOf(languageFile.GetFullPath());
        wxString code;
        for (const LanguageCode& language : kLanguages)
        {
            if (name.CmpNoCase(language.code) == 0)
            {
                code = language.code;
                name = language.name;
                break;
            }
        }
        // wxWidgets 3.2 renamed some languages ("English (United States)",
        // "Portuguese (Brazil)"); their code still finds them.
        const wxLanguageInfo* info = wxLocale::FindLanguageInfo(name);
        if (!info && !code.empty())
            info = wxLocale::FindLanguageInfo(code);
        if (info)
            return info->Language;
    }
    return wxLocale::GetSystemLanguage();
}

wxString HFHelper::GetLocaleNameForLanguage(const wxString& languageName)
{
    if (languageName.Contains("English"))
        return "english-us";
    if (languageName.Contains("Portuguese"))
        return "portuguese-brazilian";
    if (languageName.Contains("Chinese"))
        return "chinese-simplified";
    return languageName;
}

wxString HFHelper::GetSystemLocaleForName(const wxString& localeName)
{
    if (localeName.empty())
        return wxString();
    wxString code;
    for (const LanguageCode& alias : kLocaleAliases)
        if (code.empty() && localeName.CmpNoCase(alias.name) == 0)
            code = alias.code;
    for (const LanguageCode& language : kLanguages)
        if (code.empty() && localeName.CmpNoCase(language.name) == 0)
            code = language.code;
    if (code.empty())
    {
        // Other languages (the system's, when no language file exists) by
        // the toolkit's name when that names a region: "de_CH".
        const wxLanguageInfo* info = wxLocale::FindLanguageInfo(localeName);
        if (info && info->CanonicalName.Contains("_") && !info->CanonicalName.Contains("@"))
            code = info->CanonicalName;
    }
    return code.empty() ? wxString() : code + ".UTF-8";
}

wxString HFHelper::GetDecimalSeparatorFromAppLang()
{
    const wxString localeName = GetLocaleNameForLanguage(GetLocaleName());
    // glibc knows neither the language names nor the older aliases, so try
    // its own name for the language first. An empty name selects the
    // environment's locale, as setlocale does.
    const wxString systemName = GetSystemLocaleForName(localeName);
    const bool switched = !systemName.empty() && setlocale(LC_ALL, systemName.mb_str()) != nullptr;
    if (!switched)
        setlocale(LC_ALL, localeName.mb_str());

    const struct lconv* conventions = localeconv();
    wxString separator;
    if (conventions && conventions->decimal_point)
        separator = wxString(conventions->decimal_point, wxConvLibc);
    if (separator.empty())
        separator = wxLocale::GetInfo(wxLOCALE_DECIMAL_POINT, wxLOCALE_CAT_NUMBER);
    return separator;
}
