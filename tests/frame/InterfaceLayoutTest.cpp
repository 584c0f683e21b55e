// Hosts and modules are built apart: interface slots and record order stay
// where hosts expect them. And the default host services (catalogues, theme).
#include <cstring>
#include <iterator>

#include <gtest/gtest.h>
#include <hotfolder/HFPlugin.h>
#include <hotfolder/HFTranslations.h>
#include <hotfolder/Themer.h>
#include <wx/translation.h>

// Under the Itanium C++ ABI a pointer to a virtual member function starts
// with 1 + the byte offset of its slot in the vtable.
template <typename F> static long SlotOf(F function)
{
    uintptr_t first;
    std::memcpy(&first, &function, sizeof first);
    return static_cast<long>((first - 1) / sizeof(void*));
}

TEST(InterfaceLayout, SlotsInHostOrder)
{
    using Sniff = long (HFPlugin::*)(const wxString&, wxArrayString&, JobInfoCollection&);
    using SniffWithContent =
        long (HFPlugin::*)(const wxString&, wxArrayString&, JobInfoCollection&, FolderContent*&);
    const long withContent = SlotOf(static_cast<SniffWithContent>(&HFPlugin::SniffFolder));
    const long withoutContent = SlotOf(static_cast<Sniff>(&HFPlugin::SniffFolder));
    // Slots 0 and 1 hold the destructors; the functions follow in this order.
#define SLOT(function) SlotOf(&HFPlugin::function)
    const long slots[] = {SLOT(Initialize),     SLOT(InitilaizeFromPreference),
                          SLOT(GetVersion),     SLOT(GetDisplayName),
                          SLOT(GetShortName),   SLOT(GetSupportedFileExtensions),
                          SLOT(GetGroupType),   SLOT(ShowPluginUI),
                          SLOT(GetErrorString), SLOT(SniffFiles),
                          withContent,          withoutContent,
                          SLOT(Process),        SLOT(SavePreference),
                          SLOT(LoadPreference), SLOT(IsInitialized),
                          SLOT(DeInitialize),   SLOT(GetServerKeys),
                          SLOT(IsMergeEnabled), SLOT(EnableMerge)};
#undef SLOT
    for (long i = 0; i < static_cast<long>(std::size(slots)); ++i)
        EXPECT_EQ(slots[i], i + 2) << "function number " << i + 1;
    EXPECT_EQ(SlotOf(&IProgressTracker::ReportProgress), 0);
}

TEST(InterfaceLayout, DescriptionRecordOrder)
{
    // Offsets measured on an object: the record holds toolkit members, so it
    // is not standard layout and offsetof is not portable on it.
    const PluginInfo info;
#define AT(member)                                                                                 \
    (reinterpret_cast<const char*>(&info.member) - reinterpret_cast<const char*>(&info))
    EXPECT_EQ(AT(m_llKind), 0);
    EXPECT_LT(AT(m_strVersion), AT(m_strIdentifier));
    EXPECT_LT(AT(m_strIdentifier), AT(m_strDisplayName));
    EXPECT_LT(AT(m_strDisplayName), AT(m_arrExtensions));
    EXPECT_LT(AT(m_arrExtensions), AT(m_strHostReserved));
    EXPECT_EQ(AT(m_arrRequiredServerFeatures) - AT(m_strHostReserved), ptrdiff_t(sizeof(wxString)));
#undef AT
}

TEST(JobCollection, HoldsCopies)
{
    ReadyToProcessJobInfo job;
    EXPECT_EQ(job.auxValue, 0u); // a new job carries no value
    job.filterId = "Orv.EPS.1", job.jobName = "a.eps", job.auxText = "aux", job.auxValue = 7;
    job.files.Add("/in/a.eps");
    JobInfoCollection jobs;
    jobs.Add(job);
    EXPECT_EQ(jobs[0].filterId + jobs[0].jobName + jobs[0].files[0] + jobs[0].auxText,
              "Orv.EPS.1a.eps/in/a.epsaux");
    EXPECT_EQ(jobs[0].auxValue, 7u);
}

TEST(HostServices, CataloguesBesideTheLibraryAndTheHeaderTheme)
{
    HFTranslations* service = HFTranslations::GetInstance();
    ASSERT_EQ(service, HFTranslations::GetInstance());
    const wxArrayString languages = service->AvailableLanguages();
    EXPECT_TRUE(languages.Index("de") >= 0 && languages.Index("fr") >= 0)
        << service->CatalogDirectory();
    // Every language's word, English first; a word no catalogue knows is only itself.
    const wxArrayString inch = service->GetTranslations("inch");
    EXPECT_TRUE(inch[0] == "inch" && inch.Index("Zoll") > 0 && inch.Index("pouce") > 0);
    EXPECT_EQ(service->GetTranslations("no such word"), wxArrayString(1, "no such word"));
    // The selected language reaches the toolkit's own lookups.
    ASSERT_TRUE(service->SelectLanguage("de"));
    EXPECT_EQ(service->Translate("Top Left") + "|" + wxGetTranslation("Invalid input file") + "|" +
                  service->Translate("not in the catalogue"),
              wxString::FromUTF8("Oben links|Ungültige Eingabedatei|not in the catalogue"));
    EXPECT_FALSE(service->SelectLanguage("xx"));
    EXPECT_EQ(service->GetSelectedLanguage() + "|" + service->Translate("Top Left") + "|" +
                  wxGetTranslation("Invalid input file"),
              "|Top Left|Invalid input file");
    EXPECT_TRUE(service->SelectLanguage("en"));
    // The header strip above filter panels: dark, with bold white text.
    const stTheme header = Themer::GetThemeService()->GetTheme("HeaderView");
    EXPECT_EQ(header.m_background, wxColour(0x3b, 0x4a, 0x5a));
    EXPECT_TRUE(header.m_foreground == *wxWHITE && header.m_font.GetPointSize() == 11 &&
                header.m_font.GetWeight() == wxFONTWEIGHT_BOLD);
}
