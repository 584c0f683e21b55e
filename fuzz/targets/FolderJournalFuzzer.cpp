// A folder's journal as any process (or any damage) may have left it. What
// it reads back survives being written again: the records made from it read
// back to the same state, before and after the journal is compacted, and
// every field escapes to one piece without tab or line end and back.
#include <sys/stat.h>

#include <wx/filename.h>

#include "FuzzToolkit.h"
#include "service/FolderJournal.h"

namespace
{
using State = std::pair<std::vector<std::pair<wxString, wxString>>, std::vector<PrintRecord>>;

bool SamePrints(const std::vector<PrintRecord>& a, const std::vector<PrintRecord>& b)
{
    if (a.size() != b.size())
        return false;
    for (size_t i = 0; i < a.size(); ++i)
        if (a[i].id != b[i].id || a[i].queue != b[i].queue || a[i].output != b[i].output ||
            a[i].jobName != b[i].jobName || a[i].schedulerJob != b[i].schedulerJob ||
            a[i].sent != b[i].sent)
            return false;
    return true;
}

// The records that make a journal read back as journal does.
std::vector<FolderJournal::Record> Rewritten(const FolderJournal& journal)
{
    std::vector<FolderJournal::Record> records;
    for (const PrintRecord& print : journal.Prints())
    {
        records.push_back(FolderJournal::Print(print));
        if (print.schedulerJob)
            records.push_back(FolderJournal::Job(print.id, print.schedulerJob));
        if (print.sent)
            records.push_back(FolderJournal::Sent(print.id));
    }
    return records;
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    fuzzsupport::InitialiseToolkitOnce();
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    const std::string escaped = FolderJournal::EscapeField(bytes);
    FUZZ_REQUIRE(escaped.find_first_of("\t\n\r") == std::string::npos);
    FUZZ_REQUIRE(FolderJournal::UnescapeField(escaped) == bytes);

    static const std::string directory = fuzzsupport::ScratchDirectory() + "/journal";
    static const std::string again = fuzzsupport::ScratchDirectory() + "/rewritten";
    static const bool made = mkdir(directory.c_str(), 0700) == 0 && mkdir(again.c_str(), 0700) == 0;
    FUZZ_REQUIRE(made);
    fuzzsupport::WriteScratchFile(directory + "/" + FolderJournal::kFileName, data, size);
    const wxString where = wxString::FromUTF8(directory);
    const FolderJournal read = FolderJournal::ReadOnly(where);

    // Written again from what was read, it reads back the same.
    fuzzsupport::WriteScratchFile(again + "/" + FolderJournal::kFileName, nullptr, 0);
    {
        FolderJournal fresh;
        wxString error;
        FUZZ_REQUIRE(fresh.Open(wxString::FromUTF8(again), error));
        FUZZ_REQUIRE(fresh.Append(Rewritten(read), false));
    }
    FUZZ_REQUIRE(
        SamePrints(FolderJournal::ReadOnly(wxString::FromUTF8(again)).Prints(), read.Prints()));

    // Opened for work and compacted, the journal keeps what is live.
    {
        FolderJournal working;
        wxString error;
        if (working.Open(where, error))
        {
            FUZZ_REQUIRE(SamePrints(working.Prints(), read.Prints()));
            working.CompactIfLarge();
        }
    }
    FUZZ_REQUIRE(SamePrints(FolderJournal::ReadOnly(where).Prints(), read.Prints()));
    return 0;
}
