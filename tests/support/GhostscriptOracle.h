#pragma once
// Runs Ghostscript as a test oracle: where a PostScript file marks the page,
// how large the page is, and whether the interpreter hit an error. Programs
// are started with an argument vector, never through a shell.
#include <fcntl.h>
#include <spawn.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

extern char** environ;

namespace hf_test
{
struct ProcessResult
{
    int exitCode = -1; // -1 when the program could not be started or was killed
    std::string out;
    std::string err;
};

inline std::string ReadWholeFile(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

// Runs argv[0] (looked up in PATH) and collects its output and exit code.
inline ProcessResult RunProgram(const std::vector<std::string>& args)
{
    ProcessResult result;
    char outName[] = "/tmp/hf-oracle-out-XXXXXX";
    char errName[] = "/tmp/hf-oracle-err-XXXXXX";
    const int outFd = mkstemp(outName);
    const int errFd = mkstemp(errName);
    if (outFd < 0 || errFd < 0)
        return result;

    std::vector<char*> argv;
    for (const std::string& arg : args)
        argv.push_back(const_cast<char*>(arg.c_str()));
    argv.push_back(nullptr);

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, 0, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_adddup2(&actions, outFd, 1);
    posix_spawn_file_actions_adddup2(&actions, errFd, 2);
    pid_t pid = 0;
    const int spawnError = posix_spawnp(&pid, argv[0], &actions, nullptr, argv.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    close(outFd);
    close(errFd);
    if (spawnError == 0)
    {
        int status = 0;
        while (waitpid(pid, &status, 0) < 0)
        {
        }
        if (WIFEXITED(status))
            result.exitCode = WEXITSTATUS(status);
    }
    result.out = ReadWholeFile(outName);
    result.err = ReadWholeFile(errName);
    unlink(outName);
    unlink(errName);
    return result;
}

// Path of the executable name in the PATH folders, then in the extra ones
// (colon-separated); "" when absent.
inline std::string FindProgram(const std::string& name, const std::string& extra = "")
{
    const char* path = std::getenv("PATH");
    std::istringstream folders(std::string(path ? path : extra.empty() ? "/usr/bin:/bin" : "") +
                               ":" + extra);
    for (std::string folder; std::getline(folders, folder, ':');)
        if (!folder.empty() && access((folder + "/" + name).c_str(), X_OK) == 0)
            return folder + "/" + name;
    return std::string();
}

inline bool ProgramAvailable(const std::string& name)
{
    return !FindProgram(name).empty();
}

struct Box
{
    double llx = 0, lly = 0, urx = 0, ury = 0;
};

struct GhostscriptReport
{
    ProcessResult process;
    bool postscriptError = false; // the interpreter reported an error
    bool marked = false;          // a %%HiResBoundingBox line was printed
    Box marks;                    // union of all marks on the (last) page
    bool pageSeen = false;
    double pageWidth = 0, pageHeight = 0; // page size at showpage
    int pages = 0;
};

// Page size at each showpage, printed by the oracle's own prologue. The job
// may redefine showpage inside a save; restore brings this one back.
inline const char* PageSizeProbe()
{
    return "/showpage { currentpagedevice /PageSize get aload pop exch "
           "(HFPAGESIZE ) print =only ( ) print = flush systemdict /showpage get exec } bind def";
}

// Runs the file through the bbox device.
inline GhostscriptReport RunGhostscriptBBox(const std::string& psFile)
{
    GhostscriptReport report;
    report.process = RunProgram({"gs", "-q", "-dNOPAUSE", "-dBATCH", "-dSAFER", "-sDEVICE=bbox",
                                 "-c", PageSizeProbe(), "-f", psFile});
    const std::string& err = report.process.err;
    report.postscriptError = report.process.exitCode != 0 ||
                             err.find("Error:") != std::string::npos ||
                             err.find("Unrecoverable error") != std::string::npos;

    std::istringstream errLines(err);
    for (std::string line; std::getline(errLines, line);)
    {
        Box box;
        if (std::sscanf(line.c_str(), "%%%%HiResBoundingBox: %lf %lf %lf %lf", &box.llx, &box.lly,
                        &box.urx, &box.ury) == 4)
        {
            report.marked = true;
            report.marks = box;
        }
    }
    std::istringstream outLines(report.process.out);
    for (std::string line; std::getline(outLines, line);)
    {
        double w = 0, h = 0;
        if (std::sscanf(line.c_str(), "HFPAGESIZE %lf %lf", &w, &h) == 2)
        {
            report.pageSeen = true;
            report.pageWidth = w;
            report.pageHeight = h;
            ++report.pages;
        }
    }
    return report;
}

// Renders to a grey-scale raster at the given resolution; "" on failure.
inline std::string RenderToPgm(const std::string& psFile, int dpi)
{
    char outName[] = "/tmp/hf-oracle-pgm-XXXXXX";
    const int fd = mkstemp(outName);
    if (fd < 0)
        return std::string();
    close(fd);
    const ProcessResult run =
        RunProgram({"gs", "-q", "-dNOPAUSE", "-dBATCH", "-dSAFER", "-sDEVICE=pgmraw",
                    "-r" + std::to_string(dpi), "-sOutputFile=" + std::string(outName), psFile});
    std::string raster = run.exitCode == 0 ? ReadWholeFile(outName) : std::string();
    unlink(outName);
    return raster;
}
} // namespace hf_test
