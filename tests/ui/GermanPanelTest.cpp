// The panel under a German application language, over the scenarios of
// tests/data/ui/panel-german.txt.
#include <hotfolder/HFTranslations.h>

#include "GermanClient.h"
#include "PanelTestFixture.h"

void UiTestBeforeToolkit()
{
    UseGermanClientConfiguration();
}

using GermanPanel = ui_test::PanelTest;

TEST_F(GermanPanel, LabelsAreGermanAndNumbersAreStoredWithAPoint)
{
    ASSERT_TRUE(HFTranslations::GetInstance()->SelectLanguage("de"));
    RunScenarios("ui/panel-german.txt");
    HFTranslations::GetInstance()->SelectLanguage("en");
}
