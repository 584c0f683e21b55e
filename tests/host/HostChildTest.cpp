// Other programs run as limited children: the table of ends and limits, and
// the identity the child takes when the service runs as root for a folder's
// owner.
#include <fcntl.h>
#include <linux/capability.h>
#include <signal.h>
#include <sys/fsuid.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <map>
#include <thread>

#include "HostTestSupport.h"
#include "posix/LimitedChild.h"

using namespace host_test;
using End = posix::ChildRun::End;

namespace
{
std::string Expanded(std::string text)
{
    for (size_t at = text.find("\\n"); at != std::string::npos; at = text.find("\\n", at + 1))
        text.replace(at, 2, "\n");
    return text;
}

// "exited 1", "signalled XCPU", "not-started ENOENT", "timed-out".
std::string Described(const posix::ChildRun& run)
{
    const std::map<int, std::string> signals = {{SIGXCPU, "XCPU"}, {SIGKILL, "KILL"}};
    const std::map<int, std::string> errors = {
        {ENOENT, "ENOENT"}, {EACCES, "EACCES"}, {EPERM, "EPERM"}};
    const auto name = [](const std::map<int, std::string>& names, int code)
    { return names.count(code) ? names.at(code) : std::to_string(code); };
    switch (run.end)
    {
    case End::Exited:
        return "exited " + std::to_string(run.code);
    case End::Signalled:
        return "signalled " + name(signals, run.code);
    case End::TimedOut:
        return "timed-out";
    case End::NotStarted:
        return "not-started " + name(errors, run.code);
    case End::IdentityRefused:
        return "identity-refused " + name(errors, run.code);
    }
    return "?";
}

posix::ChildRun RunWords(const std::string& command, const posix::ChildLimits& limits)
{
    const std::vector<std::string> args = testkit::Split(command, " ");
    return posix::RunLimitedChild(args[0], args, {"HF_CHILD=1"}, limits);
}

posix::ChildLimits Limits(const std::string& text)
{
    posix::ChildLimits limits;
    unsigned long long megabytes = 0;
    size_t kept = 0;
    EXPECT_EQ(std::sscanf(text.c_str(), "%d %ld %llu %zu", &limits.wallSeconds, &limits.cpuSeconds,
                          &megabytes, &kept),
              4);
    limits.memoryBytes = megabytes << 20;
    limits.outputBytes = kept;
    return limits;
}

// The calling thread (only) works for another user, as the service's
// threads do for folder owners: groups, then file-access ids. Raw calls,
// as the C library would change every thread.
void ActForNobody(bool dropRights)
{
    const gid_t nobody[] = {65534};
    ASSERT_EQ(syscall(SYS_setgroups, 1, nobody), 0);
    setfsgid(65534);
    setfsuid(65534);
    if (!dropRights)
        return;
    // Without CAP_SETUID and CAP_SETGID the child cannot give up root.
    __user_cap_header_struct header = {_LINUX_CAPABILITY_VERSION_3, 0};
    __user_cap_data_struct data[2] = {};
    ASSERT_EQ(syscall(SYS_capget, &header, data), 0);
    data[0].effective &= ~((1u << CAP_SETUID) | (1u << CAP_SETGID));
    ASSERT_EQ(syscall(SYS_capset, &header, data), 0);
}
} // namespace

TEST(HostChild, EndsLimitsAndWhatTheProgramSees)
{
    // A descriptor another thread could have opened without close-on-exec.
    const int leaky = open("/dev/null", O_RDONLY);
    for (const testkit::CaseFields& c : testkit::Cases("host/child-runs.txt", 5, 10))
    {
        SCOPED_TRACE(c[0] + " | " + c[4]);
        const posix::ChildRun run = RunWords(c[0], Limits(c[1]));
        EXPECT_EQ(Described(run), c[2]) << run.err;
        const std::string& check = c[3];
        const std::string& text = check.compare(0, 3, "err") == 0 ? run.err : run.out;
        if (check.compare(3, 5, " size") == 0)
            EXPECT_EQ(std::to_string(text.size()), check.substr(9));
        else if (check[3] == '=')
            EXPECT_EQ(text, Expanded(check.substr(4)));
        else if (check[3] == '~')
            EXPECT_NE(text.find(Expanded(check.substr(4))), std::string::npos) << text;
        else
            ADD_FAILURE() << "unknown check " << check;
    }
    close(leaky);
}

TEST(HostChild, TheFileAccessIdentityBecomesTheChildsWholeIdentity)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "only root can act for another user";
    const posix::ChildLimits limits;
    // As root for a folder of root's, the child stays root.
    EXPECT_EQ(RunWords("/usr/bin/id -u", limits).out, "0\n");
    std::string uid, gid, groups;
    std::thread worker(
        [&]
        {
            ActForNobody(false);
            uid = RunWords("/usr/bin/id -u", limits).out;
            gid = RunWords("/usr/bin/id -g", limits).out;
            groups = RunWords("/usr/bin/id -G", limits).out;
        });
    worker.join();
    EXPECT_EQ(uid, "65534\n");
    EXPECT_EQ(gid, "65534\n");
    EXPECT_EQ(groups, "65534\n");
    EXPECT_EQ(geteuid(), 0u) << "the other threads keep their identity";
}

TEST(HostChild, AChildThatCannotGiveUpRootNeverRuns)
{
    if (geteuid() != 0)
        GTEST_SKIP() << "only root can act for another user";
    posix::ChildRun run;
    std::thread worker(
        [&]
        {
            ActForNobody(true);
            run = RunWords("/usr/bin/id -u", posix::ChildLimits());
        });
    worker.join();
    EXPECT_EQ(Described(run), "identity-refused EPERM");
    EXPECT_EQ(run.out, "");
}
