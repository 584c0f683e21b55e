#pragma once
#include <map>
#include <set>
#include <string>
#include <vector>

#include <wx/string.h>

#include "core/FolderRows.h"

// One desktop notice.
struct Notice
{
    wxString title;
    wxString message;
};

// Turns rescans of the folder list into notices: one per new failed job
// (a line of failed-jobs.log), per printer failure (a line of
// printed-jobs.log) and per problem a printer newly reports (a queue reason,
// printing held). The same line or reason never raises a second notice while
// it stands; the first Update after start, and a folder's first appearance,
// only learn what is there already.
class NoticeTracker
{
public:
    std::vector<Notice> Update(const std::vector<FolderRow>& rows);

private:
    struct Seen
    {
        // What the status counted when the logs were last read: they are read
        // again only when it changes.
        size_t failedTotal = 0, printFailedToday = 0;
        wxString lastFailure, lastPrintFailure;
        std::set<std::string> failures;
        std::set<std::string> printFailures;
        std::set<std::string> printerProblems;
    };
    void ReadFailures(const FolderRow& row, Seen& seen, bool learnOnly,
                      std::vector<Notice>& notices);
    void ReadPrintFailures(const FolderRow& row, Seen& seen, bool learnOnly,
                           std::vector<Notice>& notices);
    void ReadPrinterProblems(const FolderRow& row, Seen& seen, bool learnOnly,
                             std::vector<Notice>& notices);

    std::map<wxString, Seen> m_folders;
};
