#pragma once
#include <string>
#include <utility>
#include <vector>

namespace printing
{
// Sends a PostScript file to a CUPS queue of the scheduler the CUPS client
// is set up for (cupsSetServer, CUPS_SERVER or client.conf). The job is
// named jobName (the file's own name when empty) and carries the job
// overrides as options. On failure error holds the scheduler's reason and
// no job is left behind. jobId, when given, receives the new job's number.
bool SubmitToCups(const std::string& queue, const std::string& psFile, const std::string& jobName,
                  const std::vector<std::pair<std::string, std::string>>& overrides,
                  std::string& error, int* jobId = nullptr);
} // namespace printing
