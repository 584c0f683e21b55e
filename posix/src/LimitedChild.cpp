#include "posix/LimitedChild.h"

#include <fcntl.h>
#include <linux/close_range.h>
#include <poll.h>
#include <signal.h>
#include <sys/prctl.h>
#include <sys/resource.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>

#include "posix/ChildIdentity.h"
#include "posix/UniqueFd.h"

namespace posix
{
namespace
{
// What a child that did not reach its program tells the parent, through a
// pipe that closes by itself when exec succeeds.
struct StartFailure
{
    int identity; // 1: giving up root failed; 0: exec failed
    int error;
};

// Everything the child uses, made before fork: it may not allocate.
struct ChildPlan
{
    const char* program;
    char* const* argv;
    char* const* envp;
    int input, output, error, report;
    int descriptorLimit; // where the loop that marks descriptors close-on-exec stops
    FileAccessIdentity identity;
    ChildLimits limits;
};

void SetLimit(int resource, rlim_t soft, rlim_t hard)
{
    const struct rlimit limit = {soft, hard};
    setrlimit(resource, &limit);
}

[[noreturn]] void Fail(int report, bool identity, int status)
{
    const StartFailure failure = {identity ? 1 : 0, errno};
    [[maybe_unused]] ssize_t ignored = write(report, &failure, sizeof failure);
    _exit(status);
}

// Between fork and exec: async-signal-safe calls only.
[[noreturn]] void StartChild(const ChildPlan& plan)
{
    setpgid(0, 0); // the time limit kills the whole group
    sigset_t none;
    sigemptyset(&none);
    sigprocmask(SIG_SETMASK, &none, nullptr);
    struct sigaction standard = {};
    standard.sa_handler = SIG_DFL;
    for (int number : {SIGPIPE, SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGXCPU})
        sigaction(number, &standard, nullptr); // an ignored signal stays ignored across exec
    if (dup2(plan.input, 0) < 0 || dup2(plan.output, 1) < 0 || dup2(plan.error, 2) < 0)
        Fail(plan.report, false, kChildExecStatus);
    // Descriptors another thread opened without close-on-exec do not leak.
    if (syscall(SYS_close_range, 3u, ~0u, CLOSE_RANGE_CLOEXEC) != 0)
        for (int fd = 3; fd < plan.descriptorLimit; ++fd)
            fcntl(fd, F_SETFD, FD_CLOEXEC);
    if (plan.limits.cpuSeconds > 0) // SIGXCPU at the soft limit, SIGKILL a second later
        SetLimit(RLIMIT_CPU, static_cast<rlim_t>(plan.limits.cpuSeconds),
                 static_cast<rlim_t>(plan.limits.cpuSeconds + 1));
    if (plan.limits.memoryBytes > 0)
        SetLimit(RLIMIT_AS, plan.limits.memoryBytes, plan.limits.memoryBytes);
    SetLimit(RLIMIT_CORE, 0, 0); // no core file where the service happens to be
    if (!AssumeFileAccessIdentity(plan.identity))
        Fail(plan.report, true, kChildIdentityStatus);
    prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0); // and no set-user-id program gives rights back
    execve(plan.program, plan.argv, plan.envp);
    Fail(plan.report, false, kChildExecStatus);
}

// A descriptor above the standard ones, so that the child's dup2 calls
// cannot overwrite it (the service may run with one of 0-2 closed).
UniqueFd AboveStandard(int fd)
{
    UniqueFd owned(fd);
    if (fd >= 0 && fd <= 2)
        owned.Reset(fcntl(fd, F_DUPFD_CLOEXEC, 3));
    return owned;
}

bool MakePipe(UniqueFd& readEnd, UniqueFd& writeEnd)
{
    int ends[2];
    if (pipe2(ends, O_CLOEXEC) != 0)
        return false;
    readEnd = AboveStandard(ends[0]);
    writeEnd = AboveStandard(ends[1]);
    return readEnd && writeEnd;
}

std::vector<char*> Pointers(const std::vector<std::string>& strings)
{
    std::vector<char*> pointers;
    for (const std::string& text : strings)
        pointers.push_back(const_cast<char*>(text.c_str()));
    pointers.push_back(nullptr);
    return pointers;
}

// One of the child's streams, read until it closes.
struct Stream
{
    UniqueFd fd;
    std::string* text;
    std::size_t bound;
};

void ReadSome(Stream& stream)
{
    char buffer[8192];
    const ssize_t got = read(stream.fd.Get(), buffer, sizeof buffer);
    if (got < 0 && errno == EINTR)
        return;
    if (got <= 0)
    {
        stream.fd.Reset();
        return;
    }
    const std::size_t room =
        stream.text->size() < stream.bound ? stream.bound - stream.text->size() : 0;
    stream.text->append(buffer, std::min(room, static_cast<std::size_t>(got)));
}

void WaitBlocking(pid_t pid, int& status)
{
    while (waitpid(pid, &status, 0) < 0 && errno == EINTR)
    {
    }
}
// Reads the child's streams until it has ended and they are closed, or
// until the wall-clock limit or the stop descriptor kills what is left.
// False when it had to be killed still running; status is its wait status
// once it has ended.
bool Follow(pid_t pid, Stream (&streams)[3], int wallSeconds, int stopFd, int& status,
            bool& stopped)
{
    UniqueFd exitSignal(static_cast<int>(syscall(SYS_pidfd_open, pid, 0)));
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(wallSeconds);
    bool exited = false;
    for (;;)
    {
        if (!exited)
        {
            // ECHILD: SIGCHLD ignored reaps it unseen; its output still tells.
            const pid_t waited = waitpid(pid, &status, WNOHANG);
            exited = waited == pid || (waited < 0 && errno == ECHILD);
        }
        pollfd wanted[5];
        nfds_t count = 0;
        for (Stream& stream : streams)
            if (stream.fd)
                wanted[count++] = {stream.fd.Get(), POLLIN, 0};
        if (exited && count == 0)
            return true;
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
                              deadline - std::chrono::steady_clock::now())
                              .count();
        int timeout = static_cast<int>(std::max<long long>(left, 0));
        if (!exited && exitSignal)
            wanted[count++] = {exitSignal.Get(), POLLIN, 0};
        else if (!exited && count == 0)
            timeout = std::min(timeout, 10); // no process descriptor: look again soon
        const nfds_t stopAt = count;
        if (stopFd >= 0)
            wanted[count++] = {stopFd, POLLIN, 0};
        const bool failed = left <= 0 || (poll(wanted, count, timeout) < 0 && errno != EINTR);
        stopped = !failed && stopFd >= 0 && wanted[stopAt].revents != 0;
        if (failed || stopped)
        {
            // Whatever still runs in the group goes; a child that ended but
            // left its streams to another process keeps its own end.
            kill(-pid, SIGKILL);
            if (!exited)
            {
                kill(pid, SIGKILL);
                WaitBlocking(pid, status);
            }
            return exited;
        }
        for (Stream& stream : streams)
            for (nfds_t i = 0; i < count; ++i)
                if (stream.fd && wanted[i].fd == stream.fd.Get() && wanted[i].revents)
                    ReadSome(stream);
    }
}

void Conclude(const std::string& report, bool ended, int status, ChildRun& run)
{
    StartFailure failure = {};
    if (report.size() == sizeof failure)
    {
        std::copy(report.begin(), report.end(), reinterpret_cast<char*>(&failure));
        run.end = failure.identity ? ChildRun::End::IdentityRefused : ChildRun::End::NotStarted;
        run.code = failure.error;
    }
    else if (!ended)
        run.end = ChildRun::End::TimedOut;
    else if (WIFEXITED(status))
    {
        run.end = ChildRun::End::Exited;
        run.code = WEXITSTATUS(status);
    }
    else
    {
        run.end = ChildRun::End::Signalled;
        run.code = WIFSIGNALED(status) ? WTERMSIG(status) : 0;
    }
}
} // namespace

ChildRun RunLimitedChild(const std::string& program, const std::vector<std::string>& args,
                         const std::vector<std::string>& environment, const ChildLimits& limits)
{
    ChildRun run;
    std::vector<char*> argv = Pointers(args), envp = Pointers(environment);
    UniqueFd input = AboveStandard(open("/dev/null", O_RDONLY | O_CLOEXEC));
    UniqueFd outRead, outWrite, errRead, errWrite, reportRead, reportWrite;
    if (!input || !MakePipe(outRead, outWrite) || !MakePipe(errRead, errWrite) ||
        !MakePipe(reportRead, reportWrite))
    {
        run.code = errno;
        return run;
    }
    struct rlimit files = {};
    getrlimit(RLIMIT_NOFILE, &files);
    const ChildPlan plan = {program.c_str(),
                            argv.data(),
                            envp.data(),
                            input.Get(),
                            outWrite.Get(),
                            errWrite.Get(),
                            reportWrite.Get(),
                            static_cast<int>(std::min<rlim_t>(files.rlim_cur, 65536)),
                            CurrentFileAccessIdentity(),
                            limits};
    const pid_t pid = fork();
    if (pid < 0)
    {
        run.code = errno;
        return run;
    }
    if (pid == 0)
        StartChild(plan);
    setpgid(pid, pid); // also here: a kill right away must reach the group
    outWrite.Reset();
    errWrite.Reset();
    reportWrite.Reset();
    std::string report;
    Stream streams[] = {{std::move(outRead), &run.out, limits.outputBytes},
                        {std::move(errRead), &run.err, limits.outputBytes},
                        {std::move(reportRead), &report, sizeof(StartFailure)}};
    int status = 0;
    const bool ended = Follow(pid, streams, limits.wallSeconds, limits.stopFd, status, run.stopped);
    Conclude(report, ended, status, run);
    return run;
}
} // namespace posix
