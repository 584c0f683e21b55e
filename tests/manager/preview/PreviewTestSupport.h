#pragma once
// Shared by the preview tests: scratch hot folders made by the built
// hotfolder program, a folder's whole listing with modification times, and
// where an image is dark.
#include <dirent.h>
#include <sys/stat.h>

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "CaseTable.h"
#include "TestKit.h"

namespace preview_test
{
// A hot folder at path, its server made from the printer description
// named (a path, or one under tests/data; "-": none), then the settings
// ("KEY=VALUE;KEY=VALUE", "-": none).
inline bool MakeHotFolder(const std::string& path, const std::string& ppd,
                          const std::string& settings)
{
    std::vector<std::string> init = {HF_HOTFOLDER_EXE, "init", path};
    if (ppd != "-")
        init.insert(init.end(),
                    {"--ppd", ppd[0] == '/' ? ppd : std::string(HF_TEST_DATA_DIR) + "/" + ppd});
    if (testkit::RunProgram(init).exitCode != 0)
        return false;
    std::vector<std::string> set = {HF_HOTFOLDER_EXE, "settings", path, "--set"};
    for (const std::string& assignment : testkit::Split(settings, ";"))
        set.push_back(assignment);
    return settings == "-" || testkit::RunProgram(set).exitCode == 0;
}

// Every entry below path, hidden ones too, with its size and time.
inline void AddListing(const std::string& path, std::vector<std::string>& lines)
{
    DIR* dir = opendir(path.c_str());
    if (!dir)
        return;
    std::vector<std::string> names;
    while (const dirent* entry = readdir(dir))
        if (std::string(entry->d_name) != "." && std::string(entry->d_name) != "..")
            names.push_back(entry->d_name);
    closedir(dir);
    std::sort(names.begin(), names.end());
    for (const std::string& name : names)
    {
        struct stat info;
        const std::string entry = path + "/" + name;
        lstat(entry.c_str(), &info);
        lines.push_back(entry + " " + std::to_string(info.st_size) + " " +
                        std::to_string(info.st_mtim.tv_sec) + "." +
                        std::to_string(info.st_mtim.tv_nsec));
        if (S_ISDIR(info.st_mode))
            AddListing(entry, lines);
    }
}

inline std::vector<std::string> Listing(const std::string& path)
{
    std::vector<std::string> lines;
    AddListing(path, lines);
    return lines;
}

// A stand-in Ghostscript that notes it started in marker, then sleeps.
inline std::string WriteSleeper(const std::string& folder)
{
    const std::string program = folder + "/slow-gs";
    testkit::WriteFile(program,
                       "#!/bin/sh\necho started > '" + folder + "/started'\nexec sleep 60\n");
    chmod(program.c_str(), 0755);
    return program;
}
} // namespace preview_test
