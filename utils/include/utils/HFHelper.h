#pragma once
#include <wx/string.h>

// Client-wide helpers: measurement system, application language.
class HFHelper
{
public:
    // "0" when the C library's LC_MEASUREMENT says metric, else "1".
    static wxString GetSystemMeasurementUnit();

    // The application version from HFConfig ("APP_HF_VERSION"), or empty.
    // With initialize, the configuration file is (re)loaded first.
    static wxString getHFVersion(bool initialize);

    // The wxWidgets language of the user interface: only version 3.3
    // clients follow the workstation language (GetLanguageID); every other
    // version gets 0, the default language.
    static int GetLocale(bool initialize);

    // wxLocale::GetLanguageName of GetLocale(true); empty when none.
    static wxString GetLocaleName();

    // The language named in the workstation's "current.lang", else the
    // system language, as a wxWidgets language identifier.
    static int GetLanguageID();

    // The directory holding "current.lang" (created when missing).
    static wxString GetLanguageFileDirectory();

    // The decimal separator of the application language. Switches the
    // process-wide C locale to that language and leaves it switched.
    static wxString GetDecimalSeparatorFromAppLang();

    // The locale name historically handed to setlocale for a language name:
    // "English ..." -> "english-us", "Portuguese ..." ->
    // "portuguese-brazilian", "Chinese ..." -> "chinese-simplified", any
    // other name as it stands.
    static wxString GetLocaleNameForLanguage(const wxString& languageName);

    // The glibc locale ("de_DE.UTF-8") for such a name, or empty when the
    // name is not one of the client's languages.
    static wxString GetSystemLocaleForName(const wxString& localeName);
};
