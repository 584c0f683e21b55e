#pragma once
#include <string>

#include <wx/string.h>

// Output helpers: the console speaks UTF-8 whatever the locale says.
std::string ToUtf8(const wxString& text);
wxString FromUtf8(const std::string& text);

// "hotfolder: <message>" on standard error.
void PrintError(const wxString& message);
// One line on standard output.
void PrintLine(const wxString& text);

// True when standard output is a terminal (progress bars, not lines).
bool StdoutIsTerminal();
