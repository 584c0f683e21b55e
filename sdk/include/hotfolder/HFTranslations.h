#pragma once
#include <memory>

#include <wx/arrstr.h>
#include <wx/string.h>
#include "hotfolder/Export.h"

// The host's translation service, backed by the gettext catalogues of the
// "hotfolder" domain. English source texts in, the selected language out.
class HF_SDK_API HFTranslations
{
public:
    static HFTranslations* GetInstance();

    // Every language's text for an English word: English first, then each
    // catalogue that translates it, in the order of AvailableLanguages().
    wxArrayString GetTranslations(const wxString& english) const;

    // The text in the selected language, or the text itself.
    wxString Translate(const wxString& english) const;

    // Selects the user-interface language ("de", "fr", ...; "" or "en" for
    // English) and installs its catalogue for wxGetTranslation as well.
    // False when no catalogue exists for it (English is then selected).
    bool SelectLanguage(const wxString& language);
    wxString GetSelectedLanguage() const;

    // Languages with a catalogue, sorted.
    wxArrayString AvailableLanguages() const;

    // Where the catalogues are read from.
    wxString CatalogDirectory() const;

    HFTranslations(const HFTranslations&) = delete;
    HFTranslations& operator=(const HFTranslations&) = delete;
    ~HFTranslations();

private:
    HFTranslations();
    struct Impl;
    std::unique_ptr<Impl> m_pImpl;
};
