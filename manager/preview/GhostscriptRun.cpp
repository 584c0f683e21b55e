#include "preview/GhostscriptRun.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>
#include <sstream>

#include "jobs/Preflight.h"
#include "posix/NativePath.h"

extern char** environ;

namespace
{
bool IsProgram(const std::string& path)
{
    struct stat info;
    return stat(path.c_str(), &info) == 0 && S_ISREG(info.st_mode) &&
           access(path.c_str(), X_OK) == 0;
}

// This process's environment but GS_OPTIONS, which could switch SAFER off.
std::vector<std::string> GhostscriptEnvironment()
{
    std::vector<std::string> environment;
    for (char** entry = environ; *entry; ++entry)
        if (std::strncmp(*entry, "GS_OPTIONS=", 11) != 0)
            environment.push_back(*entry);
    return environment;
}
} // namespace

std::string LocateGhostscript(const wxString& requested, std::string& missing)
{
    std::string program = posix::NativePath(requested);
    const char* named = std::getenv("HOTFOLDER_GHOSTSCRIPT");
    if ((program.empty() || program == "gs") && named && *named)
        program = named;
    if (program.empty())
        program = "gs";
    if (program.find('/') != std::string::npos)
    {
        if (IsProgram(program))
            return program;
        missing = "no program " + posix::ShownText(program);
        return std::string();
    }
    const char* path = std::getenv("PATH");
    std::istringstream folders(path ? path : "/usr/local/bin:/usr/bin:/bin");
    for (std::string folder; std::getline(folders, folder, ':');)
        if (!folder.empty() && IsProgram(folder + "/" + program))
            return folder + "/" + program;
    missing = "no " + posix::ShownText(program) + " in PATH";
    return std::string();
}

posix::ChildLimits PreviewLimits(int timeoutSeconds, int stopFd)
{
    posix::ChildLimits limits = PreflightLimits();
    limits.wallSeconds = timeoutSeconds > 0 ? timeoutSeconds : 1;
    limits.cpuSeconds = limits.wallSeconds;
    limits.stopFd = stopFd;
    return limits;
}

posix::ChildRun RunGhostscript(const std::string& program, const std::vector<std::string>& options,
                               const std::string& file, const posix::ChildLimits& limits)
{
    // A page that sets no size is A4 on every device alike: the bbox device
    // would otherwise take a page far larger than the raster's.
    std::vector<std::string> args = {"gs",      "-dSAFER",       "-dBATCH",      "-dNOPAUSE",
                                     "-dQUIET", "-dFirstPage=1", "-dLastPage=1", "-sPAPERSIZE=a4"};
    args.insert(args.end(), options.begin(), options.end());
    // A name starting with "-" or "@" would be taken as an option.
    args.push_back("-f");
    args.push_back(file.compare(0, 1, "/") == 0 ? file : "./" + file);
    return posix::RunLimitedChild(program, args, GhostscriptEnvironment(), limits);
}

wxString GhostscriptFailure(const posix::ChildRun& run, const posix::ChildLimits& limits)
{
    if (run.stopped)
        return "stopped for a newer preview";
    if (run.end == posix::ChildRun::End::Exited && run.code == 0)
        return wxString();
    return wxString::FromUTF8(JudgeGhostscriptRun(run, limits));
}

std::string OutputFileArgument(const std::string& path)
{
    std::string escaped;
    for (char c : path)
        escaped += c == '%' ? std::string("%%") : std::string(1, c);
    return "-sOutputFile=" + escaped;
}
