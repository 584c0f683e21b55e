#pragma once
#include <string>
#include <vector>

#include <wx/string.h>

class JobReport;

// Appends "time <TAB> name <TAB> reason" to the failure log in failedFolder,
// one whole line whoever else writes it. Each field is shown text
// (posix/OutsideText.h): no tab or line end of a name can split the record.
void AppendFailureLine(const wxString& failedFolder, const wxString& name, const wxString& reason,
                       JobReport& report);

// Appends a line of fields to the log file at path (tab-separated, shown
// as above); false when it cannot be written.
bool AppendLogLine(const wxString& path, const std::vector<wxString>& fields);

// A field of such a line as it was given (bytes; a field that is not shown
// text, as from an older log, as it stands).
std::string ReadLogField(const std::string& shown);
// The same as a string of the toolkit.
wxString LogFieldText(const std::string& shown);
