#pragma once
// Shared by the configuration store tests: scratch directories, whole-file
// I/O and spawning helper programs with an argument vector.
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include <ftw.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <wx/string.h>

extern char** environ;

namespace storetest
{
class TempDir
{
public:
    TempDir()
    {
        char pattern[] = "/tmp/hf-store-XXXXXX";
        if (mkdtemp(pattern))
            m_path = pattern;
    }
    ~TempDir()
    {
        if (!m_path.empty())
            nftw(m_path.c_str(), &RemoveEntry, 16, FTW_DEPTH | FTW_PHYS);
    }
    TempDir(const TempDir&) = delete;
    TempDir& operator=(const TempDir&) = delete;

    const std::string& path() const { return m_path; }
    std::string operator/(const std::string& name) const { return m_path + "/" + name; }
    wxString wx(const std::string& name = "") const
    {
        return wxString::FromUTF8(name.empty() ? m_path : m_path + "/" + name);
    }

private:
    static int RemoveEntry(const char* path, const struct stat*, int, struct FTW*)
    {
        ::chmod(path, 0700); // entries a test made unreadable
        return ::remove(path);
    }
    std::string m_path;
};

inline std::string ReadFile(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    std::stringstream buffer;
    buffer << in.rdbuf();
    return buffer.str();
}

inline void WriteFile(const std::string& path, const std::string& content)
{
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out << content;
}

// Exit status of the program, -1 when it could not run.
inline int Run(const std::vector<std::string>& argv, std::string* output = nullptr)
{
    std::vector<char*> args;
    for (const std::string& arg : argv)
        args.push_back(const_cast<char*>(arg.c_str()));
    args.push_back(nullptr);
    int pipeFds[2];
    if (pipe(pipeFds) != 0)
        return -1;
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, pipeFds[1], 1);
    posix_spawn_file_actions_adddup2(&actions, pipeFds[1], 2);
    posix_spawn_file_actions_addclose(&actions, pipeFds[0]);
    pid_t pid = 0;
    const int spawned = posix_spawnp(&pid, args[0], &actions, nullptr, args.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    close(pipeFds[1]);
    std::string text;
    char buffer[4096];
    ssize_t n;
    while ((n = read(pipeFds[0], buffer, sizeof buffer)) > 0)
        text.append(buffer, static_cast<size_t>(n));
    close(pipeFds[0]);
    if (output)
        *output = text;
    if (spawned != 0)
        return -1;
    int status = 0;
    if (waitpid(pid, &status, 0) != pid || !WIFEXITED(status))
        return -1;
    return WEXITSTATUS(status);
}

inline bool HaveProgram(const char* name)
{
    return Run({name, "--version"}) != -1;
}
} // namespace storetest
