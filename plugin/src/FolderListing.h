#pragma once
// Folder listings for sniffing, straight from the directory entries: the
// entry types readdir gives spare a stat call per file, which for folders
// of thousands of files is most of the cost.
#include <cstddef>
#include <string>
#include <vector>

#include <wx/arrstr.h>
#include <wx/string.h>

namespace folder_listing
{
// The files directly in folder, as wxDir lists them with wxDIR_FILES: no
// hidden names, no directories (a link counts as what it points to).
// Full paths, in directory order, and the same paths in the file system's
// own encoding.
void ListFiles(const wxString& folder, wxArrayString& files, std::vector<std::string>& nativePaths);

struct NameCounts
{
    size_t lower = 0; // names ending in ".ppml"
    size_t upper = 0; // names ending in ".PPML"
};

// Counts the non-directory names below folder, at any depth and hidden ones
// included, that end in ".ppml" or ".PPML". Links are counted by their own
// name and never followed; folders that cannot be read are passed over.
NameCounts CountPpmlNames(const wxString& folder);
} // namespace folder_listing
