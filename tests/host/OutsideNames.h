#pragma once
// The names of tests/data/host/names.txt, and how a test reads them back
// from what the host wrote: log fields, JSON strings, lines of output.
#include <set>
#include <string>
#include <vector>

#include "CaseTable.h"
#include "HostTestSupport.h"
#include "posix/OutsideText.h"

namespace host_test
{
struct DroppedName
{
    std::string raw;  // the file's name, bytes
    std::string line; // what the case checks
};

inline std::vector<DroppedName> DroppedNames()
{
    std::vector<DroppedName> names;
    for (const testkit::CaseFields& row : testkit::Cases("host/names.txt", 3, 8))
    {
        std::string raw;
        EXPECT_TRUE(posix::ReadShownText(row[1], raw)) << row[2];
        names.push_back({raw, row[2]});
    }
    return names;
}

// Drops a copy of bytes under each name into folder.
inline void DropUnderEachName(const std::vector<DroppedName>& names, const std::string& folder,
                              const std::string& bytes)
{
    for (const DroppedName& name : names)
        EXPECT_TRUE(WriteFile(folder + "/" + name.raw, bytes)) << name.line;
}

// The lines of text that hold a control character other than their line end
// (and the tabs between fields, where they separate fields): a name got
// through unshown.
inline std::vector<std::string> LinesWithControls(const std::string& text, bool tabs = false)
{
    std::vector<std::string> spoilt;
    size_t start = 0;
    for (size_t end; (end = text.find('\n', start)) != std::string::npos; start = end + 1)
    {
        const std::string line = text.substr(start, end - start);
        for (unsigned char c : line)
            if ((c < 0x20 && !(tabs && c == '\t')) || c == 0x7f)
            {
                spoilt.push_back(line);
                break;
            }
    }
    if (start < text.size())
        spoilt.push_back("unended: " + text.substr(start));
    return spoilt;
}

// The names field `field` of each tab-separated line of a log reads back to.
inline std::set<std::string> LoggedNames(const std::string& log, size_t field)
{
    std::set<std::string> names;
    size_t start = 0;
    for (size_t end; (end = log.find('\n', start)) != std::string::npos; start = end + 1)
    {
        std::vector<std::string> fields;
        const std::string line = log.substr(start, end - start);
        for (size_t at = 0, tab = 0; tab != std::string::npos; at = tab + 1)
        {
            tab = line.find('\t', at);
            fields.push_back(line.substr(at, tab == std::string::npos ? tab : tab - at));
        }
        std::string raw;
        if (fields.size() > field && posix::ReadShownText(fields[field], raw))
            names.insert(raw);
        else
            names.insert("unreadable line: " + line);
    }
    return names;
}

// The value of the JSON string "key": "..." first found in json, decoded.
inline std::string JsonString(const std::string& json, const std::string& key)
{
    const std::string opening = "\"" + key + "\": \"";
    size_t at = json.find(opening);
    if (at == std::string::npos)
        return "no string " + key;
    std::string value;
    for (at += opening.size(); at < json.size() && json[at] != '"'; ++at)
    {
        if (json[at] != '\\')
            value += json[at];
        else if (json[++at] == 'u')
        {
            value += static_cast<char>(std::stoi(json.substr(at + 1, 4), nullptr, 16));
            at += 4;
        }
        else
            value += json[at];
    }
    return value;
}

inline std::set<std::string> RawNames(const std::vector<DroppedName>& names)
{
    std::set<std::string> raw;
    for (const DroppedName& name : names)
        raw.insert(name.raw);
    return raw;
}
} // namespace host_test
