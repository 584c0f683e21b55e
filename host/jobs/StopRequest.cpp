#include "jobs/StopRequest.h"

#include <csignal>
#include <fcntl.h>
#include <unistd.h>

namespace
{
volatile std::sig_atomic_t g_requested = 0;
int g_pipe[2] = {-1, -1};

void OnSignal(int)
{
    g_requested = 1;
    if (g_pipe[1] >= 0)
    {
        char byte = 1;
        [[maybe_unused]] ssize_t ignored = write(g_pipe[1], &byte, 1);
    }
}
} // namespace

void StopRequest::Install()
{
    if (g_pipe[0] < 0 && pipe2(g_pipe, O_CLOEXEC | O_NONBLOCK) != 0)
        g_pipe[0] = g_pipe[1] = -1;
    struct sigaction action = {};
    action.sa_handler = OnSignal;
    sigemptyset(&action.sa_mask);
    sigaction(SIGINT, &action, nullptr);
    sigaction(SIGTERM, &action, nullptr);
}

bool StopRequest::Requested()
{
    return g_requested != 0;
}

int StopRequest::WakeDescriptor()
{
    return g_pipe[0];
}
