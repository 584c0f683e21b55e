// hotfolder server-from-ppd: the server description of a printer from its PPD.
#include <cstdio>

#include "cli/CommandLine.h"
#include "cli/CommandSupport.h"
#include "cli/ConsoleText.h"
#include "db/AtomicFile.h"
#include "ServerFromPpd.h"

static const char kServerFromPpdUsage[] =
    "Usage: hotfolder server-from-ppd FILE.ppd [-o server.xml]\n"
    "Writes the server description of the printer that FILE.ppd describes:\n"
    "its papers, default paper, custom size limits and the features the EPS\n"
    "filter needs. Without -o the description goes to standard output.\n";

static void PrintCommandError(const std::string& message)
{
    std::fflush(stdout);
    std::fprintf(stderr, "hotfolder server-from-ppd: %s\n", message.c_str());
}

int RunServerFromPpdCommand(const Arguments& args)
{
    ParsedArgs parsed;
    int status = 0;
    if (!ParseCommandLine(args, {{"-o", true, false, "--output"}}, kServerFromPpdUsage, 1, 1,
                          parsed, status))
        return status;
    const std::string output = parsed.Get("-o");
    if (parsed.Has("-o") && output.empty())
    {
        PrintCommandError("-o needs a file name");
        std::fputs(kServerFromPpdUsage, stderr);
        return kExitUsage;
    }

    wxString xml;
    std::string error;
    if (!printing::ServerDescriptionFromPpd(parsed.positionals[0], xml, error))
    {
        PrintCommandError(error);
        return kExitSetupFailed;
    }
    const std::string bytes = ToUtf8(xml);
    if (output.empty())
    {
        const bool written = std::fwrite(bytes.data(), 1, bytes.size(), stdout) == bytes.size();
        return std::fflush(stdout) == 0 && written ? kExitSuccess : kExitJobsFailed;
    }
    // A description that could not be delivered: the work itself failed.
    wxString reason;
    if (!db::AtomicFile::Write(FromUtf8(output), bytes, &reason))
    {
        PrintCommandError("cannot write " + output + ": " + ToUtf8(reason));
        return kExitJobsFailed;
    }
    return kExitSuccess;
}
