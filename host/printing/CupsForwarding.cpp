#include "printing/CupsForwarding.h"

#include <utility>
#include <vector>

#include "cli/ConsoleText.h"
#include "db/ConfigurationReader.h"
#include "db/JobConfiguration.h"

#include "CupsJobOptions.h"

static const char kCupsPrefix[] = "cups:";

bool ParseSubmitTarget(const std::string& text, std::string& queue, wxString& error)
{
    const std::string prefix = kCupsPrefix;
    if (text.compare(0, prefix.size(), prefix) != 0)
    {
        error = "--submit takes cups:QUEUE, not \"" + FromUtf8(text) + "\"";
        return false;
    }
    queue = text.substr(prefix.size());
    // The characters the scheduler refuses in a queue name; checked here so
    // a typing error stops the run before any job is processed.
    const std::string refused = "/\\?'\"#";
    bool usable = !queue.empty() && queue.size() < 128;
    for (unsigned char c : queue)
        usable = usable && c > ' ' && c != 0x7f &&
                 refused.find(static_cast<char>(c)) == std::string::npos;
    if (!usable)
    {
        error =
            "--submit cups:QUEUE needs a queue name (printable, no spaces, none of / \\ ? ' \" #)";
        return false;
    }
    return true;
}

std::vector<std::pair<std::string, std::string>> TicketOptions(const wxString& ticket)
{
    db::JobConfiguration overrides;
    db::ConfigurationReader::ReadJobConfiguration(ticket, overrides);
    std::vector<std::pair<std::string, std::string>> options;
    for (const auto& entry : overrides.GetProperties())
        options.emplace_back(ToUtf8(entry.first), ToUtf8(entry.second.GetValue()));
    return printing::CupsOptionsFromOverrides(options);
}
