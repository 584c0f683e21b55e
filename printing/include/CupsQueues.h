#pragma once
#include <string>
#include <vector>

#include <wx/string.h>

namespace printing
{
// The queues of the CUPS scheduler the client is set up for (cupsSetServer,
// CUPS_SERVER or client.conf).

struct QueueInfo
{
    std::string name;
    std::string makeAndModel;
};

// "host:port", or the socket path, of that scheduler; for messages.
std::string SchedulerName();

// Every queue of the scheduler. False with the reason when it cannot be reached.
bool ListQueues(std::vector<QueueInfo>& queues, std::string& error);

enum class QueueLookup
{
    Found,
    UnknownQueue,
    Unreachable,
    Unusable, // found, but nothing to make a description of
};

// The server description of a queue: from its PPD when it has one (ppdBytes
// then holds the file), otherwise from the printer's IPP attributes (media
// sizes and margins; ppdBytes stays empty). error says why when not Found.
QueueLookup QueueServerDescription(const std::string& queue, wxString& xml, std::string& ppdBytes,
                                   std::string& error);
} // namespace printing
