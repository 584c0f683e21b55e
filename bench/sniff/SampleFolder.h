#pragma once
// A scratch folder of generated EPS files for the sniffing benchmark.
#include <string>

namespace sniffbench
{
// Creates a fresh directory under $TMPDIR (or /tmp) and returns its path.
std::string MakeScratchDirectory(const char* prefix);

// Writes count EPS files named "<n>.eps" of about bytesEach bytes into
// folder: a header with a bounding box, then drawing lines.
void WriteEpsFiles(const std::string& folder, int count, long bytesEach);

// Removes the directory and everything below it.
void RemoveTree(const std::string& path);
} // namespace sniffbench
