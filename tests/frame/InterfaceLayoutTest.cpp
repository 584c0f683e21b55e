// Hosts and modules are built apart: the slot of every virtual function of
// the interface must stay where hosts expect it. And the default host
// services: catalogues compiled from the repository's .po files and found
// beside the library, and the theme service.
#include <cstring>
#include <iterator>

#include <gtest/gtest.h>
#include <hotfolder/HFPlugin.h>
#include <hotfolder/HFTranslations.h>
#include <hotfolder/Themer.h>
#include <wx/translation.h>

namespace
{
// Under the Itanium C++ ABI a pointer to a virtual member function holds
// 1 + the byte offset of its slot in the vtable.
template <typename F> long SlotOf(F function)
{
    struct Representation
    {
        uintptr_t ptr;
        ptrdiff_t adj;
    } rep;
    static_assert(sizeof(F) == sizeof(Representation));
    std::memcpy(&rep, &function, sizeof rep);
    return static_cast<long>((rep.ptr - 1) / sizeof(void*));
}
} // namespace

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
    // Offsets measured on an object: the record holds wx members, so it is
    // not standard layout and offsetof is not portable on it.
    const PluginInfo info;
    auto at = [&info](const void* member)
    { return static_cast<const char*>(member) - reinterpret_cast<const char*>(&info); };
    EXPECT_EQ(at(&info.m_llKind), 0);
    EXPECT_LT(at(&info.m_strVersion), at(&info.m_strIdentifier));
    EXPECT_LT(at(&info.m_strIdentifier), at(&info.m_strDisplayName));
    EXPECT_LT(at(&info.m_strDisplayName), at(&info.m_arrExtensions));
    EXPECT_LT(at(&info.m_arrExtensions), at(&info.m_strHostReserved));
    EXPECT_EQ(at(&info.m_arrRequiredServerFeatures) - at(&info.m_strHostReserved),
              static_cast<ptrdiff_t>(sizeof(wxString)));
}

TEST(JobCollection, OwnsCopiesInOrder)
{
    ReadyToProcessJobInfo job;
    EXPECT_EQ(job.auxValue, 0u); // a new job carries no value
    job.jobName = "a.eps";
    job.files.Add("/in/a.eps");
    job.auxValue = 7;
    JobInfoCollection jobs;
    jobs.Add(job, 2);
    job.jobName = "b.eps";
    jobs.Add(job);
    ASSERT_EQ(jobs.GetCount(), 3u);
    EXPECT_EQ(jobs[0].jobName + jobs[1].jobName + jobs[2].jobName, "a.epsa.epsb.eps");
    EXPECT_NE(&jobs[0], &jobs[1]);
    EXPECT_EQ(jobs[1].files[0], "/in/a.eps");
    EXPECT_EQ(jobs[1].auxValue, 7u);
}

TEST(Translations, CataloguesBesideTheLibrary)
{
    HFTranslations* service = HFTranslations::GetInstance();
    ASSERT_EQ(service, HFTranslations::GetInstance());
    const wxArrayString languages = service->AvailableLanguages();
    EXPECT_NE(languages.Index("de"), wxNOT_FOUND) << service->CatalogDirectory();
    EXPECT_NE(languages.Index("fr"), wxNOT_FOUND);
    // Every language's word, English first; a word no catalogue knows is only itself.
    const wxArrayString inch = service->GetTranslations("inch");
    EXPECT_TRUE(inch[0] == "inch" && inch.Index("Zoll") > 0 && inch.Index("pouce") > 0);
    EXPECT_EQ(service->GetTranslations("no such word"), wxArrayString(1, "no such word"));

    // The selected language reaches the toolkit's own lookups.
    ASSERT_TRUE(service->SelectLanguage("de"));
    EXPECT_EQ(service->Translate("Top Left"), "Oben links");
    EXPECT_EQ(wxGetTranslation("Invalid input file"), wxString::FromUTF8("Ungültige Eingabedatei"));
    EXPECT_EQ(service->Translate("not in the catalogue"), "not in the catalogue");
    EXPECT_FALSE(service->SelectLanguage("xx"));
    EXPECT_EQ(service->GetSelectedLanguage(), "");
    EXPECT_EQ(service->Translate("Top Left"), "Top Left");
    EXPECT_EQ(wxGetTranslation("Invalid input file"), "Invalid input file");
    EXPECT_TRUE(service->SelectLanguage("en"));
}

TEST(Theme, HeaderStripIsDarkWithBoldWhiteText)
{
    const stTheme header = Themer::GetThemeService()->GetTheme("HeaderView");
    EXPECT_EQ(header.m_background, wxColour(0x3b, 0x4a, 0x5a));
    EXPECT_EQ(header.m_foreground, *wxWHITE);
    EXPECT_EQ(header.m_font.GetPointSize(), 11);
    EXPECT_EQ(header.m_font.GetWeight(), wxFONTWEIGHT_BOLD);
}
