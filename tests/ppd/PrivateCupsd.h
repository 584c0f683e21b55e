#pragma once
// A CUPS scheduler of the test's own: its configuration, spool, state and
// logs under a scratch directory, listening on a free loopback port, ended
// when the object goes.
#include <arpa/inet.h>
#include <netinet/in.h>
#include <signal.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <memory>
#include <string>
#include <thread>

#include "TestKit.h"

namespace cups_test
{
class PrivateCupsd
{
public:
    static constexpr const char* kMissing =
        "cupsd, lpadmin or the pstops filter missing (cups-daemon, cups-client, "
        "cups-core-drivers)";
    // root: an existing directory the scheduler may use as it likes.
    explicit PrivateCupsd(const std::string& root) : m_root(root) {}
    ~PrivateCupsd() { Stop(); }
    PrivateCupsd(const PrivateCupsd&) = delete;
    PrivateCupsd& operator=(const PrivateCupsd&) = delete;

    static std::string Find(const std::string& name)
    {
        return testkit::FindProgram(name, "/usr/sbin:/usr/bin:/sbin:/bin");
    }
    static bool Installed()
    {
        return !Find("cupsd").empty() && !Find("lpadmin").empty() &&
               access("/usr/lib/cups/filter/pstops", X_OK) == 0;
    }

    bool Start(std::string& problem)
    {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t size = sizeof address;
        // Started again after a stop, it listens where its clients look.
        address.sin_port = htons(static_cast<uint16_t>(m_port));
        const int probe = m_port ? -1 : socket(AF_INET, SOCK_STREAM, 0);
        if (probe >= 0 && bind(probe, reinterpret_cast<sockaddr*>(&address), size) == 0 &&
            getsockname(probe, reinterpret_cast<sockaddr*>(&address), &size) == 0)
            m_port = ntohs(address.sin_port);
        if (probe >= 0)
            close(probe);
        // Filters run as the unprivileged print user and must reach the spool.
        chmod(m_root.c_str(), 0755);
        for (const char* dir : {"/spool", "/spool/tmp", "/cache", "/state", "/log", "/conf"})
            mkdir((m_root + dir).c_str(), 0755);
        testkit::WriteFile(
            m_root + "/cupsd.conf",
            "Listen 127.0.0.1:" + std::to_string(m_port) +
                "\nLogLevel debug\nDefaultAuthType None\nWebInterface No\nMaxJobs 0\n"
                "Browsing Off\n<Location />\n  Order allow,deny\n  Allow all\n"
                "</Location>\n<Location /admin>\n  Order allow,deny\n  Allow all\n"
                "</Location>\n<Policy default>\n  <Limit All>\n    Order deny,allow"
                "\n  </Limit>\n</Policy>\n");
        std::string files = "FileDevice Yes\nPrintcap\n";
        for (const char* line : {"ServerRoot /conf", "RequestRoot /spool", "TempDir /spool/tmp",
                                 "CacheDir /cache", "StateDir /state", "ErrorLog /log/error_log",
                                 "AccessLog /log/access_log", "PageLog /log/page_log"})
            files += std::string(line).insert(std::string(line).find('/'), m_root) + "\n";
        testkit::WriteFile(m_root + "/cups-files.conf", files);

        const std::string cupsd = Find("cupsd"), conf = m_root + "/cupsd.conf",
                          filesConf = m_root + "/cups-files.conf";
        m_pid = testkit::StartProgram({cupsd, "-f", "-c", conf, "-s", filesConf}, "", "");
        if (m_pid <= 0)
        {
            m_pid = 0;
            problem = "cannot start " + cupsd;
            return false;
        }
        const bool up = testkit::WaitFor(
            [&]
            {
                const int fd = socket(AF_INET, SOCK_STREAM, 0);
                const bool ok =
                    connect(fd, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0;
                close(fd);
                return ok || waitpid(m_pid, nullptr, WNOHANG) == m_pid;
            },
            10000);
        if (up && kill(m_pid, 0) == 0)
            return true;
        m_pid = up ? 0 : m_pid; // reaped when it ended at start
        problem = "cupsd did not come up on port " + std::to_string(m_port) + ": " + Log();
        return false;
    }

    void Stop()
    {
        if (m_pid <= 0)
            return;
        kill(m_pid, SIGTERM);
        waitpid(m_pid, nullptr, 0);
        m_pid = 0;
    }

    // A queue printing to a file through the given PPD's filters (none: raw).
    bool AddFileQueue(const std::string& name, const std::string& ppd, const std::string& file,
                      std::string& problem)
    {
        const auto run = testkit::RunProgram({Find("lpadmin"), "-h", Server(), "-p", name, "-v",
                                              "file://" + file, ppd.empty() ? "-m" : "-P",
                                              ppd.empty() ? "raw" : ppd, "-E"});
        problem = run.err;
        return run.exitCode == 0;
    }

    // A scheduler under scratch/cups (scratch opened to its filters, which
    // run as its own user), named in CUPS_SERVER for this process and what
    // it starts, with one queue printing into device through ppd (none:
    // raw). Null, and problem says why, when it cannot be had.
    static std::unique_ptr<PrivateCupsd>
    StartWithQueue(const std::string& scratch, const std::string& queue, const std::string& ppd,
                   const std::string& device, std::string& problem)
    {
        if (!Installed())
        {
            problem = kMissing;
            return nullptr;
        }
        chmod(scratch.c_str(), 0755);
        mkdir((scratch + "/cups").c_str(), 0755);
        auto cups = std::make_unique<PrivateCupsd>(scratch + "/cups");
        if (!cups->Start(problem))
            return nullptr;
        setenv("CUPS_SERVER", cups->Server().c_str(), 1);
        if (!cups->AddFileQueue(queue, ppd, device, problem))
            return nullptr;
        return cups;
    }

    std::string Server() const { return "127.0.0.1:" + std::to_string(m_port); }
    std::string Log() const { return testkit::ReadFile(m_root + "/log/error_log"); }

private:
    std::string m_root;
    int m_port = 0;
    pid_t m_pid = 0;
};
} // namespace cups_test
