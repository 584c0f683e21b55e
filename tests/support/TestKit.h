#pragma once
// The test kit every test and benchmark shares: scratch folders that are
// always removed, whole-file reading and writing, programs run from an
// argument vector (never a shell), waiting for a condition, standard-error
// capture, a scoped locale that tells why it is missing, and work done as
// an unprivileged user.
#include <dirent.h>
#include <fcntl.h>
#include <ftw.h>
#include <grp.h>
#include <spawn.h>
#include <sys/stat.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <clocale>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "CaseTable.h"

extern char** environ;

namespace testkit
{
// A folder under $TMPDIR (or /tmp) removed with everything in it when the
// object goes, also when the test fails half-way. Entries a test made
// read-only or unreadable are opened up first.
class ScratchDir
{
public:
    explicit ScratchDir(const std::string& prefix = "hf-test")
    {
        const char* tmp = std::getenv("TMPDIR");
        std::string pattern = std::string(tmp && *tmp ? tmp : "/tmp") + "/" + prefix + "-XXXXXX";
        if (mkdtemp(pattern.data()))
            m_path = pattern;
    }
    ~ScratchDir()
    {
        if (!m_path.empty())
            nftw(m_path.c_str(), RemoveEntry, 16, FTW_DEPTH | FTW_PHYS);
    }
    ScratchDir(const ScratchDir&) = delete;
    ScratchDir& operator=(const ScratchDir&) = delete;

    const std::string& Path() const { return m_path; }
    std::string File(const std::string& name) const { return m_path + "/" + name; }
    // A folder inside, made with its parents.
    std::string Sub(const std::string& name) const
    {
        const std::string path = File(name);
        for (size_t slash = m_path.size() + 1; slash != std::string::npos;)
        {
            slash = path.find('/', slash + 1);
            mkdir(path.substr(0, slash).c_str(), 0755);
        }
        return path;
    }

private:
    static int RemoveEntry(const char* path, const struct stat*, int type, struct FTW*)
    {
        const bool opened = type != FTW_SL && type != FTW_SLN && chmod(path, 0700) == 0;
        // A folder the walk could not read is read now that it is open.
        if (type == FTW_DNR && opened && access(path, R_OK | X_OK) == 0)
            nftw(path, RemoveEntry, 16, FTW_DEPTH | FTW_PHYS);
        else if (type == FTW_DP)
            rmdir(path);
        else
            unlink(path);
        return 0;
    }
    std::string m_path;
};

inline std::string ReadFile(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

inline bool WriteFile(const std::string& path, const std::string& bytes)
{
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    return static_cast<bool>(out.flush());
}

inline bool Exists(const std::string& path)
{
    struct stat info;
    return lstat(path.c_str(), &info) == 0;
}

// Names in a folder, sorted, hidden ones left out.
inline std::vector<std::string> ListDirectory(const std::string& directory)
{
    std::vector<std::string> names;
    if (DIR* dir = opendir(directory.c_str()))
    {
        while (dirent* entry = readdir(dir))
            if (entry->d_name[0] != '.')
                names.push_back(entry->d_name);
        closedir(dir);
    }
    std::sort(names.begin(), names.end());
    return names;
}

// Polls every 20 ms; true as soon as the condition holds.
inline bool WaitFor(const std::function<bool()>& condition, int timeoutMs)
{
    const auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeoutMs);
    while (!condition())
    {
        if (std::chrono::steady_clock::now() > end)
            return condition();
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
    }
    return true;
}

// Starts args[0] (looked up in PATH) without waiting, standard input from
// /dev/null, standard output and error into the files named ("" leaves
// them as they are). Extra environment entries ("NAME=value") are added.
// The process id, or -1 when it could not start.
inline pid_t StartProgram(const std::vector<std::string>& args, const std::string& outPath,
                          const std::string& errPath,
                          const std::vector<std::string>& environment = {})
{
    std::vector<char*> argv;
    for (const std::string& arg : args)
        argv.push_back(const_cast<char*>(arg.c_str()));
    argv.push_back(nullptr);
    std::vector<char*> env;
    for (char** entry = environ; *entry; ++entry)
        env.push_back(*entry);
    for (const std::string& entry : environment)
        env.push_back(const_cast<char*>(entry.c_str()));
    env.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, 0, "/dev/null", O_RDONLY, 0);
    if (!outPath.empty())
        posix_spawn_file_actions_addopen(&actions, 1, outPath.c_str(), O_WRONLY | O_CREAT | O_TRUNC,
                                         0644);
    if (!errPath.empty())
        posix_spawn_file_actions_addopen(&actions, 2, errPath.c_str(), O_WRONLY | O_CREAT | O_TRUNC,
                                         0644);
    pid_t pid = -1;
    if (posix_spawnp(&pid, argv[0], &actions, nullptr, argv.data(), env.data()) != 0)
        pid = -1;
    posix_spawn_file_actions_destroy(&actions);
    return pid;
}

// The exit code of a started program; -1 when it was killed or is unknown.
inline int WaitProgram(pid_t pid)
{
    int status = 0;
    if (pid <= 0)
        return -1;
    while (waitpid(pid, &status, 0) < 0)
        if (errno != EINTR)
            return -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

// A program started in the background (pid from StartProgram), ended with
// SIGTERM and waited for when the object goes, also when its owner gives up
// half-way; a pid set back to -1 is left alone.
struct BackgroundProgram
{
    pid_t pid = -1;
    BackgroundProgram() = default;
    BackgroundProgram(const BackgroundProgram&) = delete;
    BackgroundProgram& operator=(const BackgroundProgram&) = delete;
    ~BackgroundProgram()
    {
        if (pid > 0)
        {
            kill(pid, SIGTERM);
            WaitProgram(pid);
        }
    }
};

struct ProcessResult
{
    int exitCode = -1; // -1 when the program could not start or was killed
    std::string out;
    std::string err;
};

// Runs args[0] to its end and collects its output.
inline ProcessResult RunProgram(const std::vector<std::string>& args,
                                const std::vector<std::string>& environment = {})
{
    ScratchDir capture("hf-run");
    ProcessResult result;
    result.exitCode =
        WaitProgram(StartProgram(args, capture.File("out"), capture.File("err"), environment));
    result.out = ReadFile(capture.File("out"));
    result.err = ReadFile(capture.File("err"));
    return result;
}

// Path of an executable in PATH, then in the extra colon-separated folders;
// "" when absent.
inline std::string FindProgram(const std::string& name, const std::string& extra = "")
{
    const char* path = std::getenv("PATH");
    std::istringstream folders(std::string(path ? path : "/usr/bin:/bin") + ":" + extra);
    for (std::string folder; std::getline(folders, folder, ':');)
        if (!folder.empty() && access((folder + "/" + name).c_str(), X_OK) == 0)
            return folder + "/" + name;
    return std::string();
}

inline bool ProgramAvailable(const std::string& name)
{
    return !FindProgram(name).empty();
}

// Collects what is written to file descriptor 2 while it lives.
class StderrCapture
{
public:
    StderrCapture() : m_scratch("hf-stderr")
    {
        std::fflush(stderr);
        m_fd = open(m_scratch.File("err").c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0600);
        m_saved = dup(2);
        dup2(m_fd, 2);
    }
    ~StderrCapture() { Restore(); }
    StderrCapture(const StderrCapture&) = delete;
    StderrCapture& operator=(const StderrCapture&) = delete;

    // Stops capturing and returns everything captured.
    std::string Text()
    {
        Restore();
        return m_text;
    }

private:
    void Restore()
    {
        if (m_saved < 0)
            return;
        std::fflush(stderr);
        dup2(m_saved, 2);
        close(m_saved);
        close(m_fd);
        m_saved = -1;
        m_text = ReadFile(m_scratch.File("err"));
    }
    ScratchDir m_scratch;
    int m_fd = -1;
    int m_saved = -1;
    std::string m_text;
};

// Tests run as root read every file, so a file made unreadable (mode 000)
// is read as this user instead (nobody); run as anyone else, the test
// itself is already refused.
inline constexpr uid_t kUnprivilegedId = 65534;

inline bool RunsAsRoot()
{
    return geteuid() == 0;
}

// Runs work in a child process, as kUnprivilegedId when the test runs as
// root, and returns the text work returned; "(no result)" when the child
// could not drop its rights or did not end normally.
inline std::string AsUnprivileged(const std::function<std::string()>& work)
{
    int channel[2];
    if (pipe(channel) != 0)
        return "(no result)";
    const pid_t pid = fork();
    if (pid == 0)
    {
        close(channel[0]);
        if (RunsAsRoot() && (setgroups(0, nullptr) != 0 || setgid(kUnprivilegedId) != 0 ||
                             setuid(kUnprivilegedId) != 0))
            _exit(1);
        const std::string text = work();
        const bool written =
            write(channel[1], text.data(), text.size()) == static_cast<ssize_t>(text.size());
        _exit(written ? 0 : 1);
    }
    close(channel[1]);
    std::string text;
    char buffer[4096];
    for (ssize_t got; (got = read(channel[0], buffer, sizeof buffer)) > 0;)
        text.append(buffer, static_cast<size_t>(got));
    close(channel[0]);
    return WaitProgram(pid) == 0 ? text : "(no result)";
}

// The argument vector that runs args as kUnprivilegedId when the test runs
// as root (through setpriv), else args as they are.
inline std::vector<std::string> Unprivileged(const std::vector<std::string>& args)
{
    if (!RunsAsRoot())
        return args;
    std::vector<std::string> all = {"setpriv", "--reuid=" + std::to_string(kUnprivilegedId),
                                    "--regid=" + std::to_string(kUnprivilegedId), "--clear-groups",
                                    "--"};
    all.insert(all.end(), args.begin(), args.end());
    return all;
}

// Gives path and everything below it to kUnprivilegedId when the test runs
// as root, so that Unprivileged programs can work there; false on failure.
inline bool HandOver(const std::string& path)
{
    if (!RunsAsRoot())
        return true;
    static bool failed;
    failed = false;
    const auto give = [](const char* entry, const struct stat*, int, struct FTW*)
    {
        failed = failed || lchown(entry, kUnprivilegedId, kUnprivilegedId) != 0;
        return 0;
    };
    return nftw(path.c_str(), give, 16, FTW_PHYS) == 0 && !failed;
}

// Switches the process locale (all categories) and switches back at the
// end. A machine without the locale cannot run the test: use
// TESTKIT_USE_LOCALE, which skips with the reason.
class ScopedLocale
{
public:
    explicit ScopedLocale(const char* name)
    {
        const char* previous = std::setlocale(LC_ALL, nullptr);
        m_previous = previous ? previous : "C";
        m_ok = std::setlocale(LC_ALL, name) != nullptr;
        if (!m_ok)
            m_reason = std::string("locale ") + name + " is not generated on this machine";
    }
    ~ScopedLocale() { std::setlocale(LC_ALL, m_previous.c_str()); }
    ScopedLocale(const ScopedLocale&) = delete;
    ScopedLocale& operator=(const ScopedLocale&) = delete;

    explicit operator bool() const { return m_ok; }
    const std::string& Reason() const { return m_reason; }

private:
    std::string m_previous;
    std::string m_reason;
    bool m_ok = false;
};
} // namespace testkit

// Declares a ScopedLocale named `var` and skips the test where the locale
// is missing.
#define TESTKIT_USE_LOCALE(var, name)                                                              \
    testkit::ScopedLocale var(name);                                                               \
    if (!var)                                                                                      \
    GTEST_SKIP() << var.Reason()
