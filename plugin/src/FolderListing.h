#pragma once
// Folder listings for sniffing, straight from the directory entries: the
// entry types readdir gives spare a stat call per file, which for folders
// of thousands of files is most of the cost.
#include <cstddef>
#include <functional>

#include <wx/string.h>

namespace folder_listing
{
// Calls visit(path, nativePath) for every file directly in folder, as wxDir
// lists them with wxDIR_FILES: no hidden names, no directories (a link
// counts as what it points to). In directory order; nativePath is the same
// path in the file system's own encoding. Both are valid during the call.
void ForEachFile(const wxString& folder,
                 const std::function<void(const wxString& path, const char* nativePath)>& visit);

struct NameCounts
{
    size_t lower = 0; // names ending in ".ppml"
    size_t upper = 0; // names ending in ".PPML"
};

// Counts the non-directory names below folder, at any depth and hidden ones
// included, that end in ".ppml" or ".PPML", as wxDir lists them: a link to a
// folder is searched like the folder (its files counted again when the
// folder is also reached another way), any other link counts by its own
// name. A folder is read at most twice, so loops of links end; counts from
// 2 up all mean "several". Folders that cannot be read are passed over.
NameCounts CountPpmlNames(const wxString& folder);
} // namespace folder_listing
