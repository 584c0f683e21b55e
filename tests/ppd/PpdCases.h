#pragma once
// Printer descriptions named in the PPD tables: a file of tests/data/ppd, an
// absolute path, or a description of Debian's HP archive ("postscript-hp:..."),
// unpacked into a scratch folder.
#include <string>

#include "TestKit.h"

namespace ppd_cases
{
inline std::string Data(const std::string& name)
{
    return std::string(HF_TEST_DATA_DIR) + "/ppd/" + name;
}

inline std::string TestPpd()
{
    return Data("test-postscript.ppd");
}

// The description's path; "" when its package is not installed.
inline std::string Resolve(const std::string& name, const std::string& scratch)
{
    if (name.rfind("postscript-hp:", 0) == 0)
    {
        const auto got = testkit::RunProgram({"/usr/lib/cups/driver/postscript-hp", "cat", name});
        const std::string path = scratch + "/" + name.substr(name.rfind('/') + 1);
        return got.exitCode == 0 && testkit::WriteFile(path, got.out) ? path : "";
    }
    const std::string path = name[0] == '/' ? name : Data(name);
    return testkit::Exists(path) ? path : "";
}
} // namespace ppd_cases
