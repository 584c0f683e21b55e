#include "service/FailedOriginals.h"

#include <algorithm>
#include <dirent.h>
#include <fstream>
#include <map>
#include <sys/stat.h>

#include <wx/datetime.h>
#include <wx/filename.h>

#include "cli/ConsoleText.h"
#include "folder/FileMoves.h"
#include "folder/HotFolder.h"
#include "jobs/JobPlaces.h"
#include "posix/NativePath.h"
#include "service/FailureLog.h"

namespace
{
const char kRetriedReason[] = "retried: moved back into the hot folder";

bool IsRegularFile(const std::string& path)
{
    struct stat info;
    return lstat(path.c_str(), &info) == 0 && S_ISREG(info.st_mode);
}

// Names whose last line in the failure log is a printer's verdict.
std::map<std::string, bool> LastFailedAtThePrinter(const wxString& failedFolder)
{
    std::map<std::string, bool> atThePrinter;
    std::ifstream log(posix::NativePath(wxFileName(failedFolder, kFailureLogName).GetFullPath()));
    for (std::string line; std::getline(log, line);)
    {
        const size_t name = line.find('\t');
        const size_t reason = name == std::string::npos ? name : line.find('\t', name + 1);
        if (reason == std::string::npos)
            continue;
        atThePrinter[ReadLogField(line.substr(name + 1, reason - name - 1))] =
            line.compare(reason + 1, 8, "printer:") == 0;
    }
    return atThePrinter;
}
} // namespace

std::vector<FailedOriginal> ListFailedOriginals(const HotFolder& folder)
{
    std::vector<FailedOriginal> originals;
    const wxString failedFolder = folder.GetFailedFolder();
    if (DIR* dir = opendir(posix::NativePath(failedFolder).c_str()))
    {
        while (const dirent* entry = readdir(dir))
        {
            const std::string name = entry->d_name;
            const std::string path = posix::NativePath(failedFolder) + "/" + name;
            // Hidden names are moves in progress; the log is not an original.
            if (name[0] != '.' && name != kFailureLogName && IsRegularFile(path))
                originals.push_back({posix::FromNativePath(name.c_str()),
                                     posix::FromNativePath(path.c_str()), false});
        }
        closedir(dir);
    }
    const std::string kept = posix::NativePath(folder.GetKeptOriginalsFolder());
    for (const auto& last : LastFailedAtThePrinter(failedFolder))
        if (last.second && last.first.find('/') == std::string::npos &&
            IsRegularFile(kept + "/" + last.first))
            originals.push_back({posix::FromNativePath(last.first.c_str()),
                                 posix::FromNativePath((kept + "/" + last.first).c_str()), true});
    std::sort(originals.begin(), originals.end(),
              [](const FailedOriginal& a, const FailedOriginal& b) { return a.name < b.name; });
    return originals;
}

bool RetryFailedOriginal(const HotFolder& folder, const FailedOriginal& original, wxString& movedTo,
                         wxString& error)
{
    if (!MoveIntoDirectory(original.path, folder.GetFolder(), original.name, movedTo, error))
        return false;
    const wxString log = wxFileName(folder.GetFailedFolder(), kFailureLogName).GetFullPath();
    if (!AppendLogLine(log,
                       {wxDateTime::Now().FormatISOCombined(' '), original.name, kRetriedReason}))
        error = "cannot write the failure log " + log;
    return true;
}
