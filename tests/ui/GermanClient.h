#pragma once
// A German user's client setup: the workstation language file says de_DE and
// the client configuration is version 3.3, the first that follows it. Both go
// to a private home, to be set up before the toolkit and the client
// configuration are first used. Returns that home, for removal at the end.
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include <unistd.h>

inline std::filesystem::path UseGermanClientConfiguration(const std::string& purpose)
{
    namespace fs = std::filesystem;
    const fs::path home =
        fs::temp_directory_path() / ("hf-" + purpose + "-" + std::to_string(getpid()));
    fs::create_directories(home / "Vomal QDK");
    fs::create_directories(home / "Resources");
    std::ofstream(home / "Vomal QDK" / "current.lang") << "de_DE\n";
    std::ofstream(home / "Resources" / "HFConfig.cfg")
        << "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<HFConfig><Application>"
           "<HFConfiguration><Entry key=\"APP_HF_VERSION\" value=\"3.3\"/></HFConfiguration>"
           "</Application></HFConfig>\n";
    setenv("HOME", home.c_str(), 1);
    setenv("HOTFOLDER_RESOURCES_DIR", (home / "Resources").c_str(), 1);
    return home;
}
