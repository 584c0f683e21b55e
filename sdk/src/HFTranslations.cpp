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

namespace
{
// Reads <directory>/<language>/LC_MESSAGES/<domain>.mo. The stock file
// loader also searches the application's data folders, which needs a wxApp
// that a host may not have.
class DirectoryLoader : public wxTranslationsLoader
{
public:
    explicit DirectoryLoader(const wxString& directory) : m_directory(directory) {}

    wxMsgCatalog* LoadCatalog(const wxString& domain, const wxString& language) override
    {
        wxFileName mo(m_directory, domain + ".mo");
        mo.AppendDir(language);
        mo.AppendDir("LC_MESSAGES");
        return mo.FileExists() ? wxMsgCatalog::CreateFromFile(mo.GetFullPath(), domain) : nullptr;
    }

    wxArrayString GetAvailableTranslations(const wxString& domain) const override
    {
        wxArrayString languages;
        wxDir dir;
        if (!wxDir::Exists(m_directory) || !dir.Open(m_directory))
            return languages;
        wxString language;
        for (bool more = dir.GetFirst(&language, "", wxDIR_DIRS); more;
             more = dir.GetNext(&language))
        {
            wxFileName mo(m_directory, domain + ".mo");
            mo.AppendDir(language);
            mo.AppendDir("LC_MESSAGES");
            if (mo.FileExists())
                languages.Add(language);
        }
        return languages;
    }

private:
    wxString m_directory;
};

wxTranslations* MakeTranslations(const wxString& directory, const wxString& language)
{
    auto* translations = new wxTranslations;
    translations->SetLoader(new DirectoryLoader(directory));
    translations->SetLanguage(language);
    return translations;
}
} // namespace

struct HFTranslations::Impl
{
    wxString directory;
    // One translations object per language, each holding that language's
    // catalogue of the domain.
    std::map<wxString, std::unique_ptr<wxTranslations>> catalogs;
    wxString selected;
};

namespace
{
const wxString* Lookup(const wxTranslations& translations, const wxString& english)
{
    const wxString* text = translations.GetTranslatedString(english, kDomain);
    return text && !text->empty() ? text : nullptr;
}
} // namespace

HFTranslations::HFTranslations() : m_pImpl(std::make_unique<Impl>())
{
    m_pImpl->directory = FindCatalogDirectory();
    const DirectoryLoader loader(m_pImpl->directory);
    for (const wxString& language : loader.GetAvailableTranslations(kDomain))
    {
        std::unique_ptr<wxTranslations> translations(
            MakeTranslations(m_pImpl->directory, language));
        if (translations->AddCatalog(kDomain))
            m_pImpl->catalogs[language] = std::move(translations);
    }
}

HFTranslations::~HFTranslations() = default;

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
        const wxString* text = Lookup(*entry.second, english);
        if (text && all.Index(*text) == wxNOT_FOUND)
            all.Add(*text);
    }
    return all;
}

wxString HFTranslations::Translate(const wxString& english) const
{
    auto found = m_pImpl->catalogs.find(m_pImpl->selected);
    if (found == m_pImpl->catalogs.end())
        return english;
    const wxString* text = Lookup(*found->second, english);
    return text ? *text : english;
}

bool HFTranslations::SelectLanguage(const wxString& language)
{
    wxString lang = language;
    if (lang == "en")
        lang.clear();
    const bool known = lang.empty() || m_pImpl->catalogs.count(lang) > 0;
    m_pImpl->selected = known ? lang : wxString();

    // Make wxGetTranslation answer in the same language.
    wxTranslations* translations = MakeTranslations(
        m_pImpl->directory, m_pImpl->selected.empty() ? wxString("en") : m_pImpl->selected);
    wxTranslations::Set(translations);
    if (!m_pImpl->selected.empty())
        translations->AddCatalog(kDomain);
    return known;
}

wxString HFTranslations::GetSelectedLanguage() const
{
    return m_pImpl->selected;
}

wxArrayString HFTranslations::AvailableLanguages() const
{
    wxArrayString languages;
    for (const auto& entry : m_pImpl->catalogs)
        languages.Add(entry.first);
    return languages;
}

wxString HFTranslations::CatalogDirectory() const
{
    return m_pImpl->directory;
}
