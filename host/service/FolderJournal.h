#pragma once
#include <map>
#include <utility>
#include <vector>

#include <wx/string.h>

// The service's record of deliveries in one hot folder, so a job killed at
// any instant is finished exactly once after a restart. One line per record,
// appended and flushed to disk before the step it announces:
//
//     deliver <TAB> job directory name <TAB> output name <LF>
//
// A torn last line (no line feed) is ignored. Records of finished jobs mean
// nothing (their work directory is gone), so the file is emptied whenever no
// job is in hand and it has grown.
class FolderJournal
{
public:
    static const char kFileName[];

    FolderJournal() = default;
    ~FolderJournal();
    FolderJournal(const FolderJournal&) = delete;
    FolderJournal& operator=(const FolderJournal&) = delete;

    // Opens (creating) the journal in directory and replays its records.
    bool Open(const wxString& directory, wxString& error);

    // The output name last recorded for a job; empty when none.
    wxString DeliveryOf(const wxString& job) const;
    // Appends (job, output name) records and syncs them; false when they are
    // not on disk.
    bool RecordDeliveries(const std::vector<std::pair<wxString, wxString>>& records);
    // Drops every record; only when no job is in hand.
    void Clear();
    bool Large() const { return m_records > 256; }

private:
    int m_fd = -1;
    size_t m_records = 0;
    std::map<wxString, wxString> m_deliveries;
};
