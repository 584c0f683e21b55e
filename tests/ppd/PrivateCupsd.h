#pragma once
// A CUPS scheduler of the test's own: its configuration, spool, state and
// logs under a scratch directory, listening on a free loopback port, ended
// when the object goes.
#include <arpa/inet.h>
#include <netinet/in.h>
#include <signal.h>
#include <spawn.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <fstream>
#include <string>
#include <thread>
#include <vector>

#include "GhostscriptOracle.h"

namespace cups_test
{
// Absolute path of a program in PATH or the system folders; "" when absent.
inline std::string FindProgram(const std::string& name)
{
    return testkit::FindProgram(name, "/usr/sbin:/usr/bin:/sbin:/bin");
}

inline sockaddr_in Loopback(int port)
{
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    address.sin_port = htons(static_cast<uint16_t>(port));
    return address;
}

inline int FreeLoopbackPort()
{
    const int fd = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address = Loopback(0);
    socklen_t size = sizeof address;
    int port = 0;
    if (bind(fd, reinterpret_cast<sockaddr*>(&address), size) == 0 &&
        getsockname(fd, reinterpret_cast<sockaddr*>(&address), &size) == 0)
        port = ntohs(address.sin_port);
    close(fd);
    return port;
}

inline bool Accepts(int port)
{
    const int fd = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address = Loopback(port);
    const bool ok = connect(fd, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0;
    close(fd);
    return ok;
}

class PrivateCupsd
{
public:
    // root: an existing directory the scheduler may use as it likes.
    explicit PrivateCupsd(const std::string& root) : m_root(root) {}
    ~PrivateCupsd() { Stop(); }
    PrivateCupsd(const PrivateCupsd&) = delete;
    PrivateCupsd& operator=(const PrivateCupsd&) = delete;

    static bool Installed()
    {
        return !FindProgram("cupsd").empty() && !FindProgram("lpadmin").empty();
    }

    bool Start(std::string& problem)
    {
        const std::string cupsd = FindProgram("cupsd");
        m_port = FreeLoopbackPort();
        // Filters run as the unprivileged print user and must reach the spool.
        chmod(m_root.c_str(), 0755);
        for (const char* dir : {"/conf", "/spool", "/spool/tmp", "/cache", "/state", "/log"})
            mkdir((m_root + dir).c_str(), 0755);
        std::ofstream(m_root + "/cupsd.conf")
            << "Listen 127.0.0.1:" << m_port << "\n"
            << "LogLevel debug\nDefaultAuthType None\nWebInterface No\nBrowsing Off\n"
               "<Location />\n  Order allow,deny\n  Allow all\n</Location>\n"
               "<Location /admin>\n  Order allow,deny\n  Allow all\n</Location>\n"
               "<Policy default>\n  <Limit All>\n    Order deny,allow\n  </Limit>\n</Policy>\n";
        std::ofstream(m_root + "/cups-files.conf")
            << "ServerRoot " << m_root << "/conf\nRequestRoot " << m_root << "/spool\n"
            << "TempDir " << m_root << "/spool/tmp\nCacheDir " << m_root << "/cache\n"
            << "StateDir " << m_root << "/state\nErrorLog " << m_root << "/log/error_log\n"
            << "AccessLog " << m_root << "/log/access_log\nPageLog " << m_root
            << "/log/page_log\nFileDevice Yes\nPrintcap\n";

        const std::string conf = m_root + "/cupsd.conf";
        const std::string files = m_root + "/cups-files.conf";
        std::vector<std::string> args = {cupsd, "-f", "-c", conf, "-s", files};
        std::vector<char*> argv;
        for (std::string& arg : args)
            argv.push_back(arg.data());
        argv.push_back(nullptr);
        if (posix_spawn(&m_pid, cupsd.c_str(), nullptr, nullptr, argv.data(), environ) != 0)
        {
            m_pid = 0;
            problem = "cannot start " + cupsd;
            return false;
        }
        for (int i = 0; i < 200; ++i)
        {
            if (Accepts(m_port))
                return true;
            int status = 0;
            if (waitpid(m_pid, &status, WNOHANG) == m_pid)
            {
                m_pid = 0;
                problem = "cupsd ended at start: " + Log();
                return false;
            }
            std::this_thread::sleep_for(std::chrono::milliseconds(50));
        }
        problem = "cupsd does not answer on port " + std::to_string(m_port);
        return false;
    }

    void Stop()
    {
        if (m_pid <= 0)
            return;
        kill(m_pid, SIGTERM);
        int status = 0;
        waitpid(m_pid, &status, 0);
        m_pid = 0;
    }

    // A queue printing to a file through the given PPD's filters.
    bool AddFileQueue(const std::string& name, const std::string& ppd, const std::string& file,
                      std::string& problem)
    {
        const auto run = testkit::RunProgram({FindProgram("lpadmin"), "-h", Server(), "-p", name,
                                              "-v", "file://" + file, "-P", ppd, "-E"});
        problem = run.err;
        return run.exitCode == 0;
    }

    std::string Server() const { return "127.0.0.1:" + std::to_string(m_port); }
    std::string Log() const { return testkit::ReadFile(m_root + "/log/error_log"); }

private:
    std::string m_root;
    int m_port = 0;
    pid_t m_pid = 0;
};
} // namespace cups_test
