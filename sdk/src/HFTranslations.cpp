#include "hotfolder/HFTranslations.h"

#include <dlfcn.h>

#include <map>
#include <memory>

#include <wx/dir.h>
#include <wx/filename.h>
#include <wx/translation.h>
#include <wx/utils.h>

namespace
{
const char* const kDomain = "hotfolder";

// The catalogues sit at ../share/hotfolder/locale relative to this library,
// in the build tree as in an installed prefix.
wxString FindCatalogDirectory()
{
    wxString fromEnv;
    if (wxGetEnv("HOTFOLDER_LOCALE_DIR", &fromEnv) && !fromEnv.empty())
        return fromEnv;
    Dl_info info;
    if (dladdr(reinterpret_cast<void*>(&FindCatalogDirectory), &info) && info.dli_fname)
    {
        wxFileName lib(wxString::FromUTF8(info.dli_fname));
        lib.MakeAbsolute();
        wxFileName dir(lib.GetPath(), "");
        dir.RemoveLastDir();
        dir.AppendDir("share");
        dir.AppendDir("hotfolder");
        dir.AppendDir("locale");
        if (dir.DirExists())
            return dir.GetPath();
    }
    return HF_DEFAULT_LOCALE_DIR;
}
} // namespace

struct HFTranslations::Impl
{
    wxString directory;
    std::map<wxString, std::unique_ptr<wxMsgCatalog>> catalogs; // language -> catalogue
    wxString selected;
};

HFTranslations::HFTranslations() : m_pImpl(new Impl)
{
    m_pImpl->directory = FindCatalogDirectory();
    wxDir dir;
    if (!wxDir::Exists(m_pImpl->directory) || !dir.Open(m_pImpl->directory))
        return;
    wxString language;
    for (bool more = dir.GetFirst(&language, "", wxDIR_DIRS); more; more = dir.GetNext(&language))
    {
        wxFileName mo(m_pImpl->directory, wxString(kDomain) + ".mo");
        mo.AppendDir(language);
        mo.AppendDir("LC_MESSAGES");
        if (!mo.FileExists())
            continue;
        wxMsgCatalog* catalog = wxMsgCatalog::CreateFromFile(mo.GetFullPath(), kDomain);
        if (catalog)
            m_pImpl->catalogs[language].reset(catalog);
    }
}

HFTranslations* HFTranslations::GetInstance()
{
    static HFTranslations instance;
    return &instance;
}

wxArrayString HFTranslations::GetTranslations(const wxString& english) const
{
    wxArrayString all;
    all.Add(english);
    for (const auto& entry : m_pImpl->catalogs)
    {
        const wxString* text = entry.second->GetString(english);
        if (text && !text->empty() && all.Index(*text) == wxNOT_FOUND)
            all.Add(*text);
    }
    return all;
}

wxString HFTranslations::Translate(const wxString& english) const
{
    auto found = m_pImpl->catalogs.find(m_pImpl->selected);
    if (found == m_pImpl->catalogs.end())
        return english;
    const wxString* text = found->second->GetString(english);
    return text && !text->empty() ? *text : english;
}

bool HFTranslations::SelectLanguage(const wxString& language)
{
    wxString lang = language;
    if (lang == "en")
        lang.clear();
    const bool known = lang.empty() || m_pImpl->catalogs.count(lang) > 0;
    m_pImpl->selected = known ? lang : wxString();

    // Make wxGetTranslation answer in the same language.
    auto* translations = new wxTranslations;
    wxFileTranslationsLoader::AddCatalogLookupPathPrefix(m_pImpl->directory);
    translations->SetLanguage(m_pImpl->selected.empty() ? wxString("en") : m_pImpl->selected);
    wxTranslations::Set(translations);
    if (!m_pImpl->selected.empty())
        translations->AddCatalog(kDomain);
    return known;
}

wxString HFTranslations::GetSelectedLanguage() const { return m_pImpl->selected; }

wxArrayString HFTranslations::AvailableLanguages() const
{
    wxArrayString languages;
    for (const auto& entry : m_pImpl->catalogs)
        languages.Add(entry.first);
    return languages;
}

wxString HFTranslations::CatalogDirectory() const { return m_pImpl->directory; }
