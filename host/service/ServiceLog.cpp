#include "service/ServiceLog.h"

#include <cstdio>
#include <unistd.h>

#include "cli/ConsoleText.h"

void ServiceLog(Severity severity, const wxString& message)
{
    static const bool terminal = isatty(STDERR_FILENO) == 1;
    wxString line = message;
    // A line break inside a message would become a second entry without a
    // severity.
    line.Replace("\n", " ");
    std::string text = ToUtf8(line);
    if (terminal)
        std::fprintf(stderr, "hotfolder: %s\n", text.c_str());
    else
        std::fprintf(stderr, "<%d>%s\n", static_cast<int>(severity), text.c_str());
    std::fflush(stderr);
}
