#pragma once
#include <wx/string.h>

// The service's messages: one line each on standard error. Off a terminal
// (journald, a log file) every line starts with the syslog severity in angle
// brackets, which journald turns into the entry's priority.
enum class Severity
{
    Error = 3,
    Warning = 4,
    Info = 6
};

void ServiceLog(Severity severity, const wxString& message);
