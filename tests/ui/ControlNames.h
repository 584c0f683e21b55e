#pragma once
// The settings views' controls by the short names the case tables use, from
// tests/data/ui/control-ids.txt (which also pins their fixed numbers).
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "CaseTable.h"

namespace ui_test
{
inline const std::vector<std::pair<std::string, int>>& ControlNames()
{
    static const auto names = []
    {
        std::vector<std::pair<std::string, int>> read;
        for (const auto& fields : testkit::ReadCaseTable("ui/control-ids.txt"))
            read.emplace_back(fields[0], std::stoi(fields[1]));
        return read;
    }();
    return names;
}

inline int ControlId(const std::string& name)
{
    for (const auto& [known, id] : ControlNames())
        if (known == name)
            return id;
    ADD_FAILURE() << "no control named " << name;
    return -1;
}
} // namespace ui_test
