#include "jobs/Preflight.h"

#include <signal.h>
#include <string.h> // strsignal
#include <sys/stat.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <sstream>
#include <vector>

#include "posix/ErrorText.h"
#include "posix/OutsideText.h"

extern char** environ;

namespace
{
bool IsProgram(const std::string& path)
{
    struct stat info;
    return stat(path.c_str(), &info) == 0 && S_ISREG(info.st_mode) &&
           access(path.c_str(), X_OK) == 0;
}

// The service's environment but GS_OPTIONS, which could switch SAFER off.
std::vector<std::string> GhostscriptEnvironment()
{
    std::vector<std::string> environment;
    for (char** entry = environ; *entry; ++entry)
        if (std::strncmp(*entry, "GS_OPTIONS=", 11) != 0)
            environment.push_back(*entry);
    return environment;
}

std::vector<std::string> Lines(const std::string& text)
{
    std::vector<std::string> lines;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);)
        lines.push_back(line);
    return lines;
}

// The last error Ghostscript reported ("Error: /undefined in foo"); it prints
// it on standard output, the stacks after it.
std::string ErrorLine(const posix::ChildRun& run)
{
    std::string found;
    for (const std::string* text : {&run.out, &run.err})
        for (const std::string& line : Lines(*text))
            if (line.compare(0, 7, "Error: ") == 0)
                found = line;
    return found;
}

std::string LastLine(const std::string& text)
{
    std::string last;
    for (const std::string& line : Lines(text))
        if (line.find_first_not_of(" \t\r") != std::string::npos)
            last = line;
    return last;
}

std::string Signalled(const posix::ChildRun& run, const posix::ChildLimits& limits)
{
    if (run.code == SIGXCPU)
        return "Ghostscript used more than " + std::to_string(limits.cpuSeconds) +
               " s of processor time";
    return "Ghostscript crashed (signal " + std::to_string(run.code) + ", " + strsignal(run.code) +
           ")";
}

// Every page the bbox device saw must have marks.
std::string JudgePages(const std::string& err)
{
    std::vector<bool> drawn;
    for (const std::string& line : Lines(err))
    {
        int llx = 0, lly = 0, urx = 0, ury = 0;
        if (std::sscanf(line.c_str(), "%%%%BoundingBox: %d %d %d %d", &llx, &lly, &urx, &ury) == 4)
            drawn.push_back(urx > llx && ury > lly);
    }
    if (drawn.empty())
        return "the output prints no page";
    for (size_t page = 0; page < drawn.size(); ++page)
        if (!drawn[page])
            return drawn.size() == 1 ? std::string("nothing is drawn on the page")
                                     : "nothing is drawn on page " + std::to_string(page + 1) +
                                           " of " + std::to_string(drawn.size());
    return std::string();
}
} // namespace

posix::ChildLimits PreflightLimits()
{
    posix::ChildLimits limits;
    limits.wallSeconds = 60;
    limits.cpuSeconds = 60;
    limits.memoryBytes = 1024ull * 1024 * 1024;
    limits.outputBytes = 1024 * 1024; // two lines a page on standard error
    return limits;
}

std::string FindGhostscript(std::string& missing)
{
    const char* named = std::getenv("HOTFOLDER_GHOSTSCRIPT");
    const std::string program = named && *named ? named : "gs";
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

std::string PreflightProblem(const std::string& output)
{
    std::string missing;
    const std::string gs = FindGhostscript(missing);
    if (gs.empty())
        return "preflight is on but Ghostscript is not installed (" + missing + ")";
    // A name starting with "-" or "@" would be taken as an option.
    const std::string file = output.compare(0, 1, "/") == 0 ? output : "./" + output;
    const posix::ChildLimits limits = PreflightLimits();
    return JudgeGhostscriptRun(posix::RunLimitedChild(gs,
                                                      {"gs", "-dSAFER", "-dBATCH", "-dNOPAUSE",
                                                       "-dQUIET", "-sDEVICE=bbox", file},
                                                      GhostscriptEnvironment(), limits),
                               limits);
}

std::string JudgeGhostscriptRun(const posix::ChildRun& run, const posix::ChildLimits& limits)
{
    using End = posix::ChildRun::End;
    switch (run.end)
    {
    case End::NotStarted:
        return "cannot start Ghostscript: " + posix::ErrorText(run.code);
    case End::IdentityRefused:
        return "cannot run Ghostscript as the folder's owner: " + posix::ErrorText(run.code);
    case End::TimedOut:
        return "Ghostscript took longer than " + std::to_string(limits.wallSeconds) + " s";
    case End::Signalled:
        return Signalled(run, limits);
    case End::Exited:
        break;
    }
    if (run.code != 0)
    {
        const std::string error = ErrorLine(run);
        if (!error.empty())
            return "Ghostscript: " + posix::ShownText(error);
        const std::string last = LastLine(run.err);
        return "Ghostscript ended with exit status " + std::to_string(run.code) +
               (last.empty() ? std::string() : ": " + posix::ShownText(last));
    }
    return JudgePages(run.err);
}
