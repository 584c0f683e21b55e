#include "core/ServiceControl.h"

#include <cerrno>
#include <chrono>
#include <cstring>
#include <fcntl.h>
#include <poll.h>
#include <string>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>
#include <vector>

#include <wx/intl.h>

#include "db/PathResolver.h"
#include "posix/ExecutablePath.h"
#include "posix/LimitedChild.h"
#include "posix/NativePath.h"
#include "service/ServiceLock.h"

extern char** environ;

namespace
{
const char kUnit[] = "hotfolder.service";
const char kSystemctl[] = "/usr/bin/systemctl";
const auto kStartWait = std::chrono::seconds(5);

wxString Reason(int error)
{
    return wxString::FromUTF8(std::strerror(error));
}

bool IsExecutable(const std::string& path)
{
    struct stat info;
    return stat(path.c_str(), &info) == 0 && S_ISREG(info.st_mode) &&
           access(path.c_str(), X_OK) == 0;
}

// The hotfolder beside this program (the build tree and an installation alike
// keep them together), else the first one on PATH.
std::string HotfolderProgram()
{
    const std::string self = posix::ExecutablePath();
    const size_t slash = self.rfind('/');
    if (slash != std::string::npos && IsExecutable(self.substr(0, slash + 1) + "hotfolder"))
        return self.substr(0, slash + 1) + "hotfolder";
    const char* path = getenv("PATH");
    std::string directories = path ? path : "/usr/local/bin:/usr/bin:/bin";
    for (size_t start = 0, end = 0; end != std::string::npos; start = end + 1)
    {
        end = directories.find(':', start);
        const std::string directory = directories.substr(start, end - start);
        if (!directory.empty() && IsExecutable(directory + "/hotfolder"))
            return directory + "/hotfolder";
    }
    return std::string();
}

bool SystemdKnowsTheUnit(int stopFd, bool& stopped)
{
    struct stat info;
    if (stat("/run/systemd/system", &info) != 0 || !IsExecutable(kSystemctl))
        return false;
    posix::ChildLimits limits;
    limits.wallSeconds = 20;
    limits.stopFd = stopFd;
    const posix::ChildRun run =
        posix::RunLimitedChild(kSystemctl, {"systemctl", "cat", "--", kUnit}, {}, limits);
    stopped = run.stopped;
    return run.end == posix::ChildRun::End::Exited && run.code == 0;
}

bool StartThroughSystemd(wxString& error, int stopFd)
{
    posix::ChildLimits limits;
    limits.wallSeconds = 60;
    limits.stopFd = stopFd;
    const posix::ChildRun run =
        posix::RunLimitedChild(kSystemctl, {"systemctl", "start", kUnit}, {}, limits);
    if (run.end == posix::ChildRun::End::Exited && run.code == 0)
        return true;
    if (run.stopped)
        return false;
    const size_t end = run.err.find('\n');
    error = wxString::Format(_("systemctl could not start %s: %s"), kUnit,
                             posix::ShownLine(wxString::FromUTF8(run.err.substr(0, end))));
    return false;
}

// "hotfolder serve" in its own session, a grandchild of no process of ours:
// it outlives the window and leaves no zombie behind.
bool SpawnDetached(const std::string& program, wxString& error)
{
    // Everything allocated before fork: after it only async-signal-safe calls.
    std::vector<std::string> args{"hotfolder", "serve"};
    std::vector<char*> argv;
    for (std::string& arg : args)
        argv.push_back(&arg[0]);
    argv.push_back(nullptr);
    const pid_t child = fork();
    if (child < 0)
    {
        error = wxString::Format(_("Cannot start the service: %s"), Reason(errno));
        return false;
    }
    if (child == 0)
    {
        setsid();
        if (fork() != 0)
            _exit(0);
        const int null = open("/dev/null", O_RDWR | O_CLOEXEC);
        if (null >= 0)
            for (int fd = 0; fd <= 2; ++fd)
                dup2(null, fd);
        syscall(SYS_close_range, 3U, ~0U, 0U);
        execve(program.c_str(), argv.data(), environ);
        _exit(127);
    }
    int status = 0;
    while (waitpid(child, &status, 0) < 0 && errno == EINTR)
        ;
    return true;
}

// Sleeps for a while unless stopFd becomes readable first; false then.
bool PauseUnlessStopped(int stopFd, int milliseconds)
{
    if (stopFd < 0)
    {
        std::this_thread::sleep_for(std::chrono::milliseconds(milliseconds));
        return true;
    }
    pollfd wanted{stopFd, POLLIN, 0};
    const int ready = poll(&wanted, 1, milliseconds);
    return ready == 0 || (ready < 0 && errno == EINTR);
}
} // namespace

ServiceState ReadServiceState()
{
    // A marker left behind by a service that ended pauses nothing: the
    // service to resume is not there.
    if (!ServiceIsRunning())
        return ServiceState::Stopped;
    return db::PathResolver::GetStopAllHFFilePath().FileExists() ? ServiceState::Paused
                                                                 : ServiceState::Running;
}

bool StartService(wxString& error, int stopFd)
{
    // Started, the service is to convert: a marker left from a pause goes.
    if (!ResumeService(error))
        return false;
    if (ServiceIsRunning())
        return true;
    bool stopped = false;
    if (SystemdKnowsTheUnit(stopFd, stopped))
    {
        if (!StartThroughSystemd(error, stopFd))
            return false;
    }
    else if (stopped) // told to leave before anything was started
        return false;
    else
    {
        const std::string program = HotfolderProgram();
        if (program.empty())
        {
            error = _("Cannot start the service: the hotfolder program is neither beside this "
                      "one nor on PATH.");
            return false;
        }
        if (!SpawnDetached(program, error))
            return false;
    }
    // Wait for the condition, not for a time: a quick start returns at once.
    const auto deadline = std::chrono::steady_clock::now() + kStartWait;
    while (!ServiceIsRunning())
    {
        if (std::chrono::steady_clock::now() >= deadline)
        {
            error = _("The service did not come up; 'hotfolder serve' in a terminal tells why.");
            return false;
        }
        if (!PauseUnlessStopped(stopFd, 50))
            return false;
    }
    return true;
}

bool PauseService(wxString& error)
{
    const wxString marker = db::PathResolver::GetStopAllHFFilePath().GetFullPath();
    const int fd =
        open(posix::NativePath(marker).c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
    // Paused already: whoever made the marker, it stands.
    if (fd < 0 && errno != EEXIST)
    {
        error = wxString::Format(_("Cannot pause the hot folders: cannot make %s: %s"),
                                 posix::ShownLine(marker), Reason(errno));
        return false;
    }
    if (fd >= 0)
        close(fd);
    return true;
}

bool ResumeService(wxString& error)
{
    const wxString marker = db::PathResolver::GetStopAllHFFilePath().GetFullPath();
    if (unlink(posix::NativePath(marker).c_str()) == 0 || errno == ENOENT)
        return true;
    error = wxString::Format(_("Cannot resume the hot folders: cannot remove %s: %s"),
                             posix::ShownLine(marker), Reason(errno));
    return false;
}
