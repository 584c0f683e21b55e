#pragma once
// Where the engine keeps the reason of its last failure on each thread, for
// EPStoPSFailureKind and EPStoPSFailureReason to answer.
#include <string>

#include "EPStoPS.h"

// A call starts with a clean record.
void ClearFailure();
void RecordFailure(EPSFailureKind_t kind, const std::string& reason);
// "cannot read NAME: <the system's text for error>"; a missing file or
// folder is EPS_FAILURE_MISSING, anything else EPS_FAILURE_UNREADABLE.
void RecordReadFailure(const char* path, int error);

// The last part of path, shown as outside text.
std::string ShownFileName(const char* path);
