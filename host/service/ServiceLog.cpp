#include "service/ServiceLog.h"

#include <cstdio>
#include <unistd.h>

#include "cli/ConsoleText.h"
#include "posix/NativePath.h"

void ServiceLog(Severity severity, const wxString& message)
{
    static const bool terminal = isatty(STDERR_FILENO) == 1;
    // Names in a message are outside text: a line break in one would forge a
    // second entry.
    const std::string text = ToUtf8(posix::ShownLine(message));
    if (terminal)
        std::fprintf(stderr, "hotfolder: %s\n", text.c_str());
    else
        std::fprintf(stderr, "<%d>%s\n", static_cast<int>(severity), text.c_str());
    std::fflush(stderr);
}
