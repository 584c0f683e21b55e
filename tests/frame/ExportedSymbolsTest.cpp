// The module's dynamic symbol table holds its C entry points and nothing
// else: no C++ symbol, no wx template instance, no runtime weak symbol.
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <set>
#include <sstream>
#include <string>

#include <gtest/gtest.h>

extern char** environ;

namespace
{
std::string RunAndCapture(std::vector<std::string> argv)
{
    int fds[2];
    if (pipe(fds) != 0)
        return {};
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, fds[1], STDOUT_FILENO);
    posix_spawn_file_actions_addclose(&actions, fds[0]);
    std::vector<char*> args;
    for (auto& a : argv)
        args.push_back(a.data());
    args.push_back(nullptr);
    pid_t pid = 0;
    const int rc = posix_spawnp(&pid, args[0], &actions, nullptr, args.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    close(fds[1]);
    std::string out;
    std::array<char, 4096> buf;
    ssize_t n;
    while (rc == 0 && (n = read(fds[0], buf.data(), buf.size())) > 0)
        out.append(buf.data(), static_cast<size_t>(n));
    close(fds[0]);
    int status = 0;
    if (rc == 0)
        waitpid(pid, &status, 0);
    return out;
}
} // namespace

TEST(ExportedSymbols, ExactlyTheEntryPoints)
{
    const std::string table = RunAndCapture({"nm", "-D", "--defined-only", HF_MODULE_PATH});
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
