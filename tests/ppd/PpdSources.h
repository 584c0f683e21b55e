#pragma once
// Printer descriptions to test with: the one written for the tests, the
// generic PostScript printer that CUPS compiles from its sample driver, and
// a spread of HP PostScript printers from Debian's HP PPD archive.
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include <unistd.h>

#include "GhostscriptOracle.h"

namespace ppd_sources
{
inline const char* const kSampleDriver = "/usr/share/cups/drv/sample.drv";
inline const char* const kHpArchive = "/usr/lib/cups/driver/postscript-hp";

inline std::string TestPpd()
{
    return std::string(HF_TEST_DATA_DIR) + "/ppd/test-postscript.ppd";
}

struct TableCase
{
    std::string path;
    bool keepsCode = false; // the printer's page code is PostScript
    std::string what;
};

// tests/data/ppd/descriptions.txt: "FILE kept|standard what it checks";
// FILE is relative to that folder unless absolute.
inline std::vector<TableCase> DescriptionTable()
{
    const std::string dir = std::string(HF_TEST_DATA_DIR) + "/ppd/";
    std::istringstream lines(testkit::ReadFile(dir + "descriptions.txt"));
    std::vector<TableCase> cases;
    for (std::string line; std::getline(lines, line);)
    {
        std::istringstream words(line);
        TableCase row;
        std::string code;
        if (line.empty() || line[0] == '#' || !(words >> row.path >> code))
            continue;
        if (row.path[0] != '/')
            row.path = dir + row.path;
        row.keepsCode = code == "kept";
        std::getline(words >> std::ws, row.what);
        cases.push_back(row);
    }
    return cases;
}

// "" when CUPS's PPD compiler or its sample driver is not installed.
inline std::string GenericPostScriptPpd(const std::string& dir)
{
    if (!testkit::ProgramAvailable("ppdc") || access(kSampleDriver, R_OK) != 0)
        return std::string();
    const auto run = testkit::RunProgram({"ppdc", "-d", dir, kSampleDriver});
    const std::string path = dir + "/generic.ppd";
    return run.exitCode == 0 && access(path.c_str(), R_OK) == 0 ? path : std::string();
}

// Up to count HP descriptions spread over the archive's list; empty when
// the archive is not installed.
inline std::vector<std::string> HpPpds(const std::string& dir, size_t count)
{
    std::vector<std::string> paths;
    if (access(kHpArchive, X_OK) != 0)
        return paths;
    const auto list = testkit::RunProgram({kHpArchive, "list"});
    std::vector<std::string> uris;
    std::istringstream lines(list.out);
    for (std::string line; std::getline(lines, line);)
    {
        // "postscript-hp:0/ppd/hplip/HP/hp-....ppd" en "HP" ...
        if (line.rfind("\"postscript-hp:0/", 0) != 0)
            continue;
        uris.push_back(line.substr(1, line.find('"', 1) - 1));
    }
    for (size_t i = 0; i < count && !uris.empty(); ++i)
    {
        const std::string& uri = uris[i * uris.size() / count];
        const auto extracted = testkit::RunProgram({kHpArchive, "cat", uri});
        if (extracted.exitCode != 0 || extracted.out.empty())
            continue;
        const std::string path = dir + "/" + uri.substr(uri.find_last_of('/') + 1);
        std::ofstream(path, std::ios::binary) << extracted.out;
        paths.push_back(path);
    }
    return paths;
}
} // namespace ppd_sources
