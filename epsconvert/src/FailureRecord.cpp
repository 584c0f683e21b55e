// The engine's last failure on this thread: its kind and its reason.
#include "FailureRecord.h"

#include <cerrno>
#include <cstring>

#include "posix/ErrorText.h"
#include "posix/OutsideText.h"

namespace
{
struct Failure
{
    EPSFailureKind_t kind = EPS_FAILURE_NONE;
    std::string reason;
};

// Per thread: conversions on several threads each keep their own.
thread_local Failure t_last;
} // namespace

void ClearFailure()
{
    t_last.kind = EPS_FAILURE_NONE;
    t_last.reason.clear();
}

void RecordFailure(EPSFailureKind_t kind, const std::string& reason)
{
    t_last.kind = kind;
    t_last.reason = reason;
}

void RecordReadFailure(const char* path, int error)
{
    const bool missing = error == ENOENT || error == ENOTDIR;
    RecordFailure(missing ? EPS_FAILURE_MISSING : EPS_FAILURE_UNREADABLE,
                  "cannot read " + ShownFileName(path) + ": " + posix::ErrorText(error));
}

std::string ShownFileName(const char* path)
{
    if (!path)
        return "(no file)";
    const char* slash = std::strrchr(path, '/');
    return posix::ShownText(slash ? slash + 1 : path);
}

EPSFailureKind_t EPStoPSFailureKind()
{
    return t_last.kind;
}

const char* EPStoPSFailureReason()
{
    return t_last.reason.c_str();
}
