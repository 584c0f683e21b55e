// The default host services: catalogues compiled from the repository's .po
// files and found beside the library, and the theme service.
#include <gtest/gtest.h>
#include <hotfolder/HFTranslations.h>
#include <wx/translation.h>

TEST(Translations, EveryLanguagesWordEnglishFirst)
{
    HFTranslations* service = HFTranslations::GetInstance();
    ASSERT_NE(service, nullptr);
    EXPECT_EQ(service, HFTranslations::GetInstance());
    const wxArrayString languages = service->AvailableLanguages();
    EXPECT_NE(languages.Index("de"), wxNOT_FOUND) << service->CatalogDirectory();
    EXPECT_NE(languages.Index("fr"), wxNOT_FOUND);

    const wxArrayString inch = service->GetTranslations("inch");
    ASSERT_GE(inch.size(), 3u);
    EXPECT_EQ(inch[0], "inch");
    EXPECT_NE(inch.Index("Zoll"), wxNOT_FOUND);
    EXPECT_NE(inch.Index("pouce"), wxNOT_FOUND);
    // A word no catalogue knows is only itself.
    const wxArrayString unknown = service->GetTranslations("no such word");
    ASSERT_EQ(unknown.size(), 1u);
    EXPECT_EQ(unknown[0], "no such word");
}

TEST(Translations, SelectedLanguageReachesWxLookups)
{
    HFTranslations* service = HFTranslations::GetInstance();
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
