#include "ServerFromPpdCommand.h"

#include <cstdio>

#include "ServerFromPpd.h"
#include "db/AtomicFile.h"

namespace
{
const char* const kUsage =
    "Usage: hotfolder server-from-ppd FILE.ppd [-o server.xml]\n"
    "Writes the server description of the printer that FILE.ppd describes:\n"
    "its papers, default paper, custom size limits and the features the EPS\n"
    "filter needs. Without -o the description goes to standard output.\n";

struct Arguments
{
    std::string ppd;
    std::string output;
    bool help = false;
};

// Returns false with a message for anything it cannot make sense of.
bool Parse(const std::vector<std::string>& args, Arguments& parsed, std::string& problem)
{
    for (size_t i = 0; i < args.size(); ++i)
    {
        const std::string& arg = args[i];
        if (arg == "--help" || arg == "-h")
            parsed.help = true;
        else if (arg == "-o" || arg == "--output")
        {
            if (i + 1 >= args.size() || args[i + 1].empty())
            {
                problem = arg + " needs a file name";
                return false;
            }
            parsed.output = args[++i];
        }
        else if (arg.size() > 1 && arg[0] == '-')
        {
            problem = "unknown option " + arg;
            return false;
        }
        else if (parsed.ppd.empty())
            parsed.ppd = arg;
        else
        {
            problem = "only one PPD file can be given";
            return false;
        }
    }
    if (!parsed.help && parsed.ppd.empty())
    {
        problem = "no PPD file given";
        return false;
    }
    return true;
}
} // namespace

int RunServerFromPpdCommand(const std::vector<std::string>& args)
{
    Arguments parsed;
    std::string problem;
    if (!Parse(args, parsed, problem))
    {
        std::fprintf(stderr, "hotfolder server-from-ppd: %s\n%s", problem.c_str(), kUsage);
        return 2;
    }
    if (parsed.help)
    {
        std::fputs(kUsage, stdout);
        return 0;
    }

    wxString xml;
    std::string error;
    if (!ServerDescriptionFromPpd(parsed.ppd, xml, error))
    {
        std::fprintf(stderr, "hotfolder server-from-ppd: %s\n", error.c_str());
        return 1;
    }
    const wxScopedCharBuffer utf8 = xml.utf8_str();
    const std::string bytes(utf8.data(), utf8.length());
    if (parsed.output.empty())
    {
        const bool written = std::fwrite(bytes.data(), 1, bytes.size(), stdout) == bytes.size();
        return std::fflush(stdout) == 0 && written ? 0 : 1;
    }
    wxString reason;
    if (!db::AtomicFile::Write(wxString::FromUTF8(parsed.output), bytes, &reason))
    {
        std::fprintf(stderr, "hotfolder server-from-ppd: cannot write %s: %s\n",
                     parsed.output.c_str(), reason.utf8_str().data());
        return 1;
    }
    return 0;
}
