#pragma once
#include <map>
#include <string>
#include <vector>

#include <wx/string.h>

// A delivered output's way to the printer, as far as the journal knows.
struct PrintRecord
{
    wxString id;          // the job's work directory name, also its marker at the scheduler
    std::string queue;    // where it prints
    wxString output;      // the delivered output
    wxString jobName;     // the original's file name, the job's name at the scheduler
    int schedulerJob = 0; // the scheduler's job id once created
    bool sent = false;    // the whole document is at the scheduler
};

// The folder's record of deliveries and printing, so a process killed at any
// instant finishes each job exactly once after a restart: delivered once,
// printed once. One line per record, fields separated by tabs, every field
// escaped (see EscapeField) so no name can split or forge a record; records
// are appended and flushed to disk before the step they announce:
//
//     deliver  id  output-name          the output's final name (before it is placed)
//     print    id  queue  output  name  the output is to be printed (with its deliver)
//     job      id  scheduler-job-id     the job exists at the scheduler
//     sent     id                       the scheduler has the whole document
//     ended    id  state                the scheduler's verdict is logged; done
//     dropped  id                       the output will not be printed (job failed)
//
// A torn last line (no line feed) is ignored. Records of finished jobs mean
// nothing; once they outnumber the live ones the file is rewritten with the
// live records only (a new file renamed over the old).
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
    // Reads a journal without changing it (for status); empty when absent.
    static FolderJournal ReadOnly(const wxString& directory);

    // The output name last recorded for a job; empty when none.
    wxString DeliveryOf(const wxString& job) const;
    // Every output still on its way to the printer, in the order recorded.
    std::vector<PrintRecord> Prints() const;
    const PrintRecord* PrintOf(const wxString& id) const;

    // One record: its fields, the first naming it ("deliver", "print", ...).
    using Record = std::vector<std::string>;
    // Appends the records; with sync they are on disk when this returns
    // true. False when they could not be written.
    bool Append(const std::vector<Record>& records, bool sync = true);
    // A delivery no longer in hand: forgotten by the next rewrite.
    void ForgetDelivery(const wxString& job) { m_deliveries.erase(job); }
    // Rewrites the file when finished records outnumber live ones.
    void CompactIfLarge();

    static Record Deliver(const wxString& id, const wxString& name);
    static Record Print(const PrintRecord& print);
    static Record Job(const wxString& id, int schedulerJob);
    static Record Sent(const wxString& id);
    static Record Ended(const wxString& id, const std::string& state);
    static Record Dropped(const wxString& id);

    // Tabs, line ends, other control characters and "%" become "%XX".
    static std::string EscapeField(const std::string& text);
    static std::string UnescapeField(const std::string& text);

    FolderJournal(FolderJournal&& other) noexcept;

private:
    void Apply(const Record& record);
    std::string Encode(const std::vector<Record>& records) const;

    wxString m_path;
    int m_fd = -1;
    size_t m_records = 0;
    std::map<wxString, wxString> m_deliveries;
    std::map<wxString, PrintRecord> m_prints;
    std::vector<wxString> m_printOrder;
};
