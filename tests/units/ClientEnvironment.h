#pragma once
#include <clocale>
#include <cstdlib>
#include <fstream>
#include <memory>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

#include <gtest/gtest.h>
#include <wx/init.h>

// Points the client at a Resources fixture and at a fresh home directory,
// so the configuration file and the workstation language file are the
// test's own.
class ClientEnvironment : public ::testing::Environment
{
public:
    explicit ClientEnvironment(std::string resources) : m_resources(std::move(resources)) {}

    void SetUp() override
    {
        setenv("HOTFOLDER_RESOURCES_DIR", ResourcesDir().c_str(), 1);
        char pattern[] = "/tmp/hf-language-XXXXXX";
        const char* home = mkdtemp(pattern);
        ASSERT_NE(nullptr, home);
        s_home = home;
        setenv("HOME", home, 1);
        // As in the host: the toolkit is initialised, so standard paths work.
        m_wx = std::make_unique<wxInitializer>();
        ASSERT_TRUE(m_wx->IsOk());
    }

    void TearDown() override
    {
        m_wx.reset();
        // The temporary home holds at most the language file's directory.
        RemoveLanguageFile();
        rmdir((s_home + "/Vomal QDK").c_str());
        rmdir(s_home.c_str());
    }

    std::string ResourcesDir() const
    {
        return std::string(HF_TEST_DATA_DIR) + "/server/" + m_resources;
    }

    // $HOME/Vomal QDK/current.lang with the given content.
    static void WriteLanguageFile(const std::string& content)
    {
        const std::string directory = s_home + "/Vomal QDK";
        mkdir(directory.c_str(), 0777);
        std::ofstream(directory + "/current.lang", std::ios::binary) << content;
    }

    static void RemoveLanguageFile() { std::remove((s_home + "/Vomal QDK/current.lang").c_str()); }

    static std::string Home() { return s_home; }

private:
    std::string m_resources;
    std::unique_ptr<wxInitializer> m_wx;
    static inline std::string s_home;
};

// The language routines switch the process-wide C locale on purpose; each
// test puts it back.
class RestoresCLocale : public ::testing::Test
{
protected:
    void SetUp() override { m_saved = setlocale(LC_ALL, nullptr); }
    void TearDown() override
    {
        setlocale(LC_ALL, m_saved.c_str());
        ClientEnvironment::RemoveLanguageFile();
    }

    static bool HasLocale(const char* name)
    {
        const std::string saved = setlocale(LC_ALL, nullptr);
        const bool found = setlocale(LC_ALL, name) != nullptr;
        setlocale(LC_ALL, saved.c_str());
        return found;
    }

private:
    std::string m_saved;
};
