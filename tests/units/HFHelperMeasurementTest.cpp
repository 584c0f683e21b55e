#include <clocale>
#include <cstdlib>
#include <locale.h>
#include <string>

#include <gtest/gtest.h>

#include "utils/HFHelper.h"

namespace
{
// The measurement system comes from the environment, so each case sets
// LC_ALL and puts the previous value back.
class MeasurementEnvironment : public ::testing::Test
{
protected:
    void SetUp() override
    {
        const char* saved = std::getenv("LC_ALL");
        m_hadValue = saved != nullptr;
        if (saved)
            m_saved = saved;
    }
    void TearDown() override
    {
        if (m_hadValue)
            setenv("LC_ALL", m_saved.c_str(), 1);
        else
            unsetenv("LC_ALL");
    }

    static bool Installed(const char* name)
    {
        const locale_t probe = newlocale(LC_ALL_MASK, name, static_cast<locale_t>(0));
        if (probe == static_cast<locale_t>(0))
            return false;
        freelocale(probe);
        return true;
    }

private:
    bool m_hadValue = false;
    std::string m_saved;
};
} // namespace

TEST_F(MeasurementEnvironment, MetricLocaleGivesZeroUsGivesOne)
{
    setenv("LC_ALL", "de_DE.UTF-8", 1);
    const wxString german = HFHelper::GetSystemMeasurementUnit();
    setenv("LC_ALL", "en_US.UTF-8", 1);
    const wxString us = HFHelper::GetSystemMeasurementUnit();
    setenv("LC_ALL", "en_GB.UTF-8", 1);
    const wxString british = HFHelper::GetSystemMeasurementUnit();
    if (!Installed("de_DE.UTF-8") || !Installed("en_GB.UTF-8"))
        GTEST_SKIP() << "de_DE/en_GB locales are not installed (scripts/setup.sh)";
    EXPECT_EQ("0", german);
    EXPECT_EQ("1", us);
    EXPECT_EQ("0", british);
}
