#pragma once
#include <string>
#include <vector>

// "server-from-ppd FILE.ppd [-o server.xml]": args are the words after the
// command name. Writes the description to the file (replaced atomically) or
// to standard output. Returns the process exit code: 0 done, 1 the PPD could
// not be read or the file written, 2 bad usage.
int RunServerFromPpdCommand(const std::vector<std::string>& args);
