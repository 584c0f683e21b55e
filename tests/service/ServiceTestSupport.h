#pragma once
// Scratch hot folders served by the built hotfolder.
#include <dirent.h>

#include <set>
#include <thread>

#include "HostTestSupport.h"

namespace service_test
{
using namespace host_test;

inline bool EndsWith(const std::string& text, const std::string& tail)
{
    return text.size() >= tail.size() &&
           text.compare(text.size() - tail.size(), tail.size(), tail) == 0;
}

inline size_t Count(const std::string& text, const std::string& part)
{
    size_t count = 0;
    for (size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1))
        ++count;
    return count;
}

// Every entry of a folder, hidden ones too (staged leftovers are hidden).
inline std::vector<std::string> AllEntries(const std::string& directory)
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

class ServiceTest : public HostTest
{
protected:
    // A service on the scratch warehouse, once it serves count folders. Its
    // standard error is a file, not a terminal: every line starts with its
    // severity for the journal ("<3>" error, "<4>" warning, "<6>" info).
    std::unique_ptr<BackgroundHost> Serve(size_t count, const std::string& settleMs = "200")
    {
        auto host = std::make_unique<BackgroundHost>(
            std::vector<std::string>{"serve", "--settle", settleMs}, scratch);
        EXPECT_TRUE(WaitFor([&] { return Count(host->Err(), "<6>serving ") >= count; }, 10000))
            << host->Err();
        return host;
    }

    std::string Work(const std::string& folder) { return Container(folder) + "/[WorkFolder]"; }

    const std::string label = ReadFile(kExamples + "/eps/label.eps");
};
} // namespace service_test
