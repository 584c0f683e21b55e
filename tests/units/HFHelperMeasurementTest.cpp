// The system's measurement system comes from the environment's locale
// (LC_ALL here), whatever the process's C locale is: "0" metric, "1" US
// customary. `locale -k LC_MEASUREMENT` (1 metric, 2 US) says the same.
#include <gtest/gtest.h>

#include "ClientEnvironment.h"
#include "utils/HFHelper.h"

TEST(SystemMeasurementUnit, FromTheEnvironmentsLocale)
{
    SKIP_WITHOUT_LOCALE("de_DE.UTF-8");
    SKIP_WITHOUT_LOCALE("en_US.UTF-8");
    SKIP_WITHOUT_LOCALE("en_GB.UTF-8");
    const char* saved = std::getenv("LC_ALL");
    const std::string old = saved ? saved : "";
    // A locale the machine does not have counts as C, which is metric.
    const std::pair<const char*, const char*> cases[] = {{"de_DE.UTF-8", "0"},
                                                         {"en_US.UTF-8", "1"},
                                                         {"en_GB.UTF-8", "0"},
                                                         {"C", "0"},
                                                         {"xx_YY.UTF-8", "0"}};
    for (const auto& [locale, unit] : cases)
    {
        setenv("LC_ALL", locale, 1);
        EXPECT_EQ(unit, HFHelper::GetSystemMeasurementUnit()) << locale;
        if (!testkit::ProgramAvailable("locale"))
            continue;
        EXPECT_NE(testkit::RunProgram({"locale", "-k", "LC_MEASUREMENT"})
                      .out.find(std::string("measurement=") + (*unit == '0' ? "1" : "2")),
                  std::string::npos)
            << locale;
    }
    saved ? setenv("LC_ALL", old.c_str(), 1) : unsetenv("LC_ALL");
}
