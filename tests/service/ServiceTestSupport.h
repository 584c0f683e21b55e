#pragma once
// Scratch hot folders served by the built hotfolder.
#include <memory>
#include <set>

#include "HostTestSupport.h"

namespace service_test
{
using namespace host_test;

inline const std::string kTrailer = "%%Trailer\r\n%%EOF\r\n";

inline bool EndsWith(const std::string& text, const std::string& tail)
{
    return text.size() >= tail.size() &&
           text.compare(text.size() - tail.size(), tail.size(), tail) == 0;
}

// Lines of a data file, without comments and blank lines.
inline std::vector<std::string> DataLines(const std::string& name)
{
    std::ifstream file(std::string(HF_TEST_DATA_DIR) + "/service/" + name);
    std::vector<std::string> lines;
    for (std::string line; std::getline(file, line);)
        if (!line.empty() && line[0] != '#')
            lines.push_back(line);
    return lines;
}

class ServiceTest : public HostTest
{
protected:
    // A hot folder converting to PostScript on paper.
    std::string MakeFolder(const std::string& name, const std::string& paper = "A4")
    {
        const std::string folder = scratch + "/" + name;
        EXPECT_EQ(Host({"init", folder, "--server", kServer}).exitCode, 0);
        EXPECT_EQ(Host({"settings", folder, "--set", "OUTPUTFILETYPEEPS=0", "OUTPUTFILETYPEPS=1",
                        "DEFAULTPAGESIZE=" + paper})
                      .exitCode,
                  0);
        return folder;
    }

    // A service on the scratch warehouse, once it serves count folders.
    std::unique_ptr<BackgroundHost> Serve(size_t count, const std::string& settleMs = "200")
    {
        auto host = std::make_unique<BackgroundHost>(
            std::vector<std::string>{"serve", "--settle", settleMs}, scratch);
        EXPECT_TRUE(WaitFor([&] { return Count(host->Err(), "<6>serving ") >= count; }, 10000))
            << host->Err();
        return host;
    }

    static size_t Count(const std::string& text, const std::string& part)
    {
        size_t count = 0;
        for (size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1))
            ++count;
        return count;
    }

    std::string Work(const std::string& folder) { return Container(folder) + "/[WorkFolder]"; }

    // Every entry of the output folder, hidden ones too.
    static std::vector<std::string> AllEntries(const std::string& directory)
    {
        std::vector<std::string> names;
        if (DIR* dir = opendir(directory.c_str()))
        {
            while (dirent* entry = readdir(dir))
                if (std::string(entry->d_name) != "." && std::string(entry->d_name) != "..")
                    names.push_back(entry->d_name);
            closedir(dir);
        }
        std::sort(names.begin(), names.end());
        return names;
    }

    const std::string label = ReadFile(kExamples + "/eps/label.eps");
};
} // namespace service_test
