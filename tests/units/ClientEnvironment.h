#pragma once
// Points the client at a Resources fixture and at a scratch home folder, so
// the configuration file and the workstation language file are the test's own.
#include <clocale>
#include <cstdlib>
#include <memory>
#include <string>

#include <gtest/gtest.h>
#include <wx/init.h>

#include "TestKit.h"

class ClientEnvironment : public ::testing::Environment
{
public:
    explicit ClientEnvironment(std::string resources) : m_resources(std::move(resources)) {}

    void SetUp() override
    {
        setenv("HOTFOLDER_RESOURCES_DIR", (HF_TEST_DATA_DIR "/server/" + m_resources).c_str(), 1);
        s_home = std::make_unique<testkit::ScratchDir>("hf-language");
        setenv("HOME", s_home->Path().c_str(), 1);
        // As in the host: the toolkit is initialised, so standard paths work.
        m_wx = std::make_unique<wxInitializer>();
        ASSERT_TRUE(m_wx->IsOk());
    }
    void TearDown() override
    {
        m_wx.reset();
        s_home.reset();
    }

    // $HOME/Vomal QDK/current.lang with the given content.
    static void WriteLanguageFile(const std::string& content)
    {
        testkit::WriteFile(s_home->Sub("Vomal QDK") + "/current.lang", content);
    }
    static void RemoveLanguageFile()
    {
        std::remove(s_home->File("Vomal QDK/current.lang").c_str());
    }
    static std::string Home() { return s_home->Path(); }

private:
    std::string m_resources;
    std::unique_ptr<wxInitializer> m_wx;
    static inline std::unique_ptr<testkit::ScratchDir> s_home;
};

// The language routines switch the process-wide C locale on purpose; each
// test puts it back and removes the language file.
class RestoresCLocale : public ::testing::Test
{
protected:
    void SetUp() override { m_saved = setlocale(LC_ALL, nullptr); }
    void TearDown() override
    {
        setlocale(LC_ALL, m_saved.c_str());
        ClientEnvironment::RemoveLanguageFile();
    }

private:
    std::string m_saved;
};

// Skips the test where the locale is not generated, leaving the process's
// locale as it was.
#define SKIP_WITHOUT_LOCALE(name)                                                                  \
    if (testkit::ScopedLocale probe(name); !probe)                                                 \
    GTEST_SKIP() << probe.Reason()
