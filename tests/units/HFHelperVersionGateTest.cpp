// This client ships version 3.4, which keeps the default language.
#include <gtest/gtest.h>
#include <wx/intl.h>

#include "ClientEnvironment.h"
#include "utils/HFHelper.h"

namespace
{
[[maybe_unused]] ::testing::Environment* const g_environment =
    ::testing::AddGlobalTestEnvironment(new ClientEnvironment("Resources-3.4"));

using OtherClientVersion = RestoresCLocale;
} // namespace

TEST_F(OtherClientVersion, IgnoresTheWorkstationLanguage)
{
    ClientEnvironment::WriteLanguageFile("de_DE\n");
    EXPECT_EQ("3.4", HFHelper::getHFVersion(true));
    EXPECT_EQ(0, HFHelper::GetLocale(true));
    EXPECT_EQ("", HFHelper::GetLocaleName());
    // The language file itself is still read by the detection.
    EXPECT_EQ(wxLANGUAGE_GERMAN, HFHelper::GetLanguageID());
}
