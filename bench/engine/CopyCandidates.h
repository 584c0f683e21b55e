#pragma once
// Ways the engine could copy the body of a conversion into its output
// behind the header, kept so that the engine's choice can be checked
// again on another machine or kernel.
#include <sys/types.h>

#include <string>
#include <vector>

struct CopyCandidate
{
    const char* name;
    // Copies length bytes from offset of inFd to the current end of outFd.
    bool (*copy)(int inFd, off_t offset, size_t length, int outFd);
};

const std::vector<CopyCandidate>& CopyCandidates();

// Writes header, the body by the candidate's way and trailer to output, as
// a conversion would; false when any step failed.
bool CopyAsConversion(const CopyCandidate& candidate, const std::string& input, off_t offset,
                      size_t length, const std::string& header, const std::string& trailer,
                      const std::string& output);
