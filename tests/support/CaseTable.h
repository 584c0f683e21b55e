#pragma once
// Test cases kept in a text file under tests/data, one case a line, its
// fields separated by " | ". Blank lines and lines starting with "#" (the
// table's heading and remarks) are skipped.
#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace testkit
{
using CaseFields = std::vector<std::string>;

// The parts of text between separators; text without one is one part.
inline std::vector<std::string> Split(const std::string& text, const std::string& separator)
{
    std::vector<std::string> parts;
    for (size_t start = 0;;)
    {
        const size_t at = text.find(separator, start);
        parts.push_back(text.substr(start, at - start));
        if (at == std::string::npos)
            return parts;
        start = at + separator.size();
    }
}

// The cases of HF_TEST_DATA_DIR/relativePath; empty when the file is missing,
// which the caller should treat as a failure.
inline std::vector<CaseFields> ReadCaseTable(const std::string& relativePath)
{
    std::vector<CaseFields> cases;
    std::ifstream in(std::string(HF_TEST_DATA_DIR) + "/" + relativePath);
    for (std::string line; std::getline(in, line);)
    {
        if (line.empty() || line[0] == '#')
            continue;
        cases.push_back(Split(line, " | "));
    }
    return cases;
}

// The cases of a table whose lines all have `fields` fields, for a driver
// that needs at least `minimum` of them. A line with another count, or a
// table with fewer cases, fails the test; such a line is left out.
inline std::vector<CaseFields> Cases(const std::string& relativePath, size_t fields,
                                     size_t minimum = 1)
{
    std::vector<CaseFields> cases;
    for (CaseFields& c : ReadCaseTable(relativePath))
        if (c.size() == fields)
            cases.push_back(std::move(c));
        else
            ADD_FAILURE() << relativePath << ": " << c.size() << " fields, not " << fields << ": "
                          << c[0];
    if (cases.size() < minimum)
        ADD_FAILURE() << relativePath << ": " << cases.size() << " cases, not at least " << minimum;
    return cases;
}
} // namespace testkit
