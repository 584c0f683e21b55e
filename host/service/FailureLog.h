#pragma once
#include <vector>

#include <wx/string.h>

class JobReport;

// Appends "time <TAB> name <TAB> reason" to the failure log in failedFolder,
// one whole line whoever else writes it. Tabs and line ends in name or reason
// become blanks, so a line always reads back as one record.
void AppendFailureLine(const wxString& failedFolder, const wxString& name, const wxString& reason,
                       JobReport& report);

// Appends a line of fields to the log file at path (tab-separated, made safe
// as above); false when it cannot be written.
bool AppendLogLine(const wxString& path, const std::vector<wxString>& fields);
