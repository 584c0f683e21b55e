#pragma once
#include <vector>

#include <wx/string.h>

#include "core/FolderRows.h"
#include "core/JobHistory.h"

// What the folders list and the jobs list show, one text per column, in the
// order of their headings. Outside text (names, paths, reasons) is shown on
// one line.
std::vector<wxString> FolderColumnHeadings();
std::vector<wxString> FolderColumnTexts(const FolderRow& row);

std::vector<wxString> JobColumnHeadings();
std::vector<wxString> JobColumnTexts(const JobEntry& job, const wxDateTime& now);
