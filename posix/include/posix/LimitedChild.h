#pragma once
// Runs another program as a child with limits: its own wall-clock time
// (then it and its process group are killed), processor time and address
// space, standard input from /dev/null, standard output and error captured
// up to a bound, no descriptor of the parent but those, and the identity
// the calling thread uses for file access (ChildIdentity.h). Started from an
// argument vector, never through a shell.
#include <cstddef>
#include <string>
#include <vector>

namespace posix
{
struct ChildLimits
{
    int wallSeconds = 60;
    long cpuSeconds = 60;                // RLIMIT_CPU; 0: no limit
    unsigned long long memoryBytes = 0;  // RLIMIT_AS; 0: no limit
    std::size_t outputBytes = 64 * 1024; // kept of each stream; the rest is read and dropped
    // A descriptor another thread makes readable (or closes the other end
    // of) to end the run early: the child and its group are killed then, as
    // at the time limit, and the run says stopped. -1: none.
    int stopFd = -1;
};

struct ChildRun
{
    enum class End
    {
        Exited,         // code: its exit status
        Signalled,      // code: the signal
        TimedOut,       // killed at the wall-clock limit
        NotStarted,     // code: errno of fork, of the pipes or of exec
        IdentityRefused // code: errno of giving up root for the file-access identity
    };
    End end = End::NotStarted;
    int code = 0;
    bool stopped = false; // ended through stopFd, not by the time limit
    std::string out, err;
};

// The exit status of a child that could not take the file-access identity,
// and of one whose exec failed; the run reports them as the ends above.
const int kChildIdentityStatus = 125;
const int kChildExecStatus = 127;

// Runs program (a path; no lookup in PATH) with args (args[0] is the name it
// sees) and exactly the environment given ("NAME=value" entries).
ChildRun RunLimitedChild(const std::string& program, const std::vector<std::string>& args,
                         const std::vector<std::string>& environment, const ChildLimits& limits);
} // namespace posix
