// The module's dynamic symbol table holds its C entry points and nothing
// else: no C++ symbol, no wx template instance, no runtime weak symbol.
#include <algorithm>
#include <set>
#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "GhostscriptOracle.h"

TEST(ExportedSymbols, ExactlyTheEntryPoints)
{
    const std::string table =
        testkit::RunProgram({"nm", "-D", "--defined-only", HF_MODULE_PATH}).out;
    ASSERT_FALSE(table.empty()) << "nm printed nothing for " << HF_MODULE_PATH;
    std::set<std::string> exported;
    std::istringstream lines(table);
    std::string line;
    while (std::getline(lines, line))
    {
        std::istringstream fields(line);
        std::string address, type, name;
        fields >> address >> type >> name;
        if (!name.empty())
            exported.insert(name);
    }
    const std::set<std::string> expected = {"InitializePlugin",
                                            "UninitializePlugin",
                                            "GetPluginInfo",
                                            "GetPluginInstance",
                                            "ReleasePluginInstance",
                                            "InitLinkedList",
                                            "GetNumberOfItems",
                                            "AddToTail",
                                            "InsertList",
                                            "DestroyList",
                                            "InitIterator",
                                            "Next",
                                            "GetData"};
    EXPECT_EQ(exported, expected);
}
