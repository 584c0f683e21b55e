#include "cli/ConsoleText.h"

#include <cstdio>
#include <unistd.h>

#include "posix/NativePath.h"

std::string ToUtf8(const wxString& text)
{
    const wxScopedCharBuffer buffer = text.utf8_str();
    return std::string(buffer.data(), buffer.length());
}

wxString FromUtf8(const std::string& text)
{
    return wxString::FromUTF8(text.data(), text.size());
}

void PrintError(const wxString& message)
{
    std::fflush(stdout);
    // One line whatever names the message quotes.
    std::fprintf(stderr, "hotfolder: %s\n", ToUtf8(posix::ShownLine(message)).c_str());
    std::fflush(stderr);
}

void PrintLine(const wxString& text)
{
    std::fputs(ToUtf8(text).c_str(), stdout);
    std::fputc('\n', stdout);
}

bool StdoutIsTerminal()
{
    return isatty(STDOUT_FILENO) == 1;
}
