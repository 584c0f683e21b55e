#include "service/FolderJournal.h"

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <string>
#include <unistd.h>

#include <wx/filename.h>

#include "cli/ConsoleText.h"

const char FolderJournal::kFileName[] = "service.journal";

namespace
{
std::string ReadAll(int fd)
{
    std::string text;
    char buffer[1 << 14];
    ssize_t got;
    while ((got = pread(fd, buffer, sizeof(buffer), static_cast<off_t>(text.size()))) > 0)
        text.append(buffer, static_cast<size_t>(got));
    return text;
}

std::vector<std::string> SplitTabs(const std::string& line)
{
    std::vector<std::string> fields;
    size_t start = 0;
    for (size_t tab; (tab = line.find('\t', start)) != std::string::npos; start = tab + 1)
        fields.push_back(FolderJournal::UnescapeField(line.substr(start, tab - start)));
    fields.push_back(FolderJournal::UnescapeField(line.substr(start)));
    return fields;
}

std::string Utf8(const wxString& text)
{
    return ToUtf8(text);
}
} // namespace

FolderJournal::~FolderJournal()
{
    if (m_fd >= 0)
        close(m_fd);
}

FolderJournal::FolderJournal(FolderJournal&& other) noexcept
    : m_path(std::move(other.m_path)), m_fd(other.m_fd), m_records(other.m_records),
      m_deliveries(std::move(other.m_deliveries)), m_prints(std::move(other.m_prints)),
      m_printOrder(std::move(other.m_printOrder))
{
    other.m_fd = -1;
}

std::string FolderJournal::EscapeField(const std::string& text)
{
    std::string escaped;
    for (unsigned char c : text)
        if (c < 0x20 || c == 0x7f || c == '%')
        {
            char hex[4];
            std::snprintf(hex, sizeof hex, "%%%02X", c);
            escaped += hex;
        }
        else
            escaped += static_cast<char>(c);
    return escaped;
}

std::string FolderJournal::UnescapeField(const std::string& text)
{
    std::string plain;
    for (size_t i = 0; i < text.size(); ++i)
    {
        if (text[i] == '%' && i + 2 < text.size() &&
            std::isxdigit(static_cast<unsigned char>(text[i + 1])) &&
            std::isxdigit(static_cast<unsigned char>(text[i + 2])))
        {
            plain += static_cast<char>(std::strtol(text.substr(i + 1, 2).c_str(), nullptr, 16));
            i += 2;
        }
        else
            plain += text[i];
    }
    return plain;
}

FolderJournal::Record FolderJournal::Deliver(const wxString& id, const wxString& name)
{
    return {"deliver", Utf8(id), Utf8(name)};
}

FolderJournal::Record FolderJournal::Print(const PrintRecord& print)
{
    return {"print", Utf8(print.id), print.queue, Utf8(print.output), Utf8(print.jobName)};
}

FolderJournal::Record FolderJournal::Job(const wxString& id, int schedulerJob)
{
    return {"job", Utf8(id), std::to_string(schedulerJob)};
}

FolderJournal::Record FolderJournal::Sent(const wxString& id)
{
    return {"sent", Utf8(id)};
}

FolderJournal::Record FolderJournal::Ended(const wxString& id, const std::string& state)
{
    return {"ended", Utf8(id), state};
}

FolderJournal::Record FolderJournal::Dropped(const wxString& id)
{
    return {"dropped", Utf8(id)};
}

void FolderJournal::Apply(const Record& record)
{
    if (record.size() < 2)
        return;
    const std::string& kind = record[0];
    const wxString id = FromUtf8(record[1]);
    ++m_records;
    if (kind == "deliver" && record.size() == 3)
        m_deliveries[id] = FromUtf8(record[2]);
    else if (kind == "print" && record.size() == 5)
    {
        if (!m_prints.count(id))
            m_printOrder.push_back(id);
        PrintRecord& print = m_prints[id];
        print = PrintRecord();
        print.id = id;
        print.queue = record[2];
        print.output = FromUtf8(record[3]);
        print.jobName = FromUtf8(record[4]);
    }
    else if (m_prints.count(id) && kind == "job" && record.size() == 3)
        m_prints[id].schedulerJob = std::atoi(record[2].c_str());
    else if (m_prints.count(id) && kind == "sent")
        m_prints[id].sent = true;
    else if (kind == "ended" || kind == "dropped")
    {
        m_prints.erase(id);
        m_printOrder.erase(std::remove(m_printOrder.begin(), m_printOrder.end(), id),
                           m_printOrder.end());
    }
}

bool FolderJournal::Open(const wxString& directory, wxString& error)
{
    m_path = wxFileName(directory, kFileName).GetFullPath();
    m_fd = open(m_path.fn_str(), O_RDWR | O_CREAT | O_APPEND | O_CLOEXEC, 0644);
    if (m_fd < 0)
    {
        error = wxString::Format("cannot open the journal %s: %s", m_path,
                                 wxString::FromUTF8(std::strerror(errno)));
        return false;
    }
    const std::string text = ReadAll(m_fd);
    size_t start = 0;
    for (size_t end; (end = text.find('\n', start)) != std::string::npos; start = end + 1)
        Apply(SplitTabs(text.substr(start, end - start)));
    // A torn last record goes, so the next one starts on a line of its own.
    if (start < text.size() && ftruncate(m_fd, static_cast<off_t>(start)) != 0)
    {
        error = "cannot repair the journal " + m_path;
        return false;
    }
    return true;
}

FolderJournal FolderJournal::ReadOnly(const wxString& directory)
{
    FolderJournal journal;
    const int fd =
        open(wxFileName(directory, kFileName).GetFullPath().fn_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0)
        return journal;
    const std::string text = ReadAll(fd);
    close(fd);
    size_t start = 0;
    for (size_t end; (end = text.find('\n', start)) != std::string::npos; start = end + 1)
        journal.Apply(SplitTabs(text.substr(start, end - start)));
    return journal;
}

wxString FolderJournal::DeliveryOf(const wxString& job) const
{
    auto it = m_deliveries.find(job);
    return it == m_deliveries.end() ? wxString() : it->second;
}

std::vector<PrintRecord> FolderJournal::Prints() const
{
    std::vector<PrintRecord> prints;
    for (const wxString& id : m_printOrder)
        prints.push_back(m_prints.at(id));
    return prints;
}

const PrintRecord* FolderJournal::PrintOf(const wxString& id) const
{
    auto it = m_prints.find(id);
    return it == m_prints.end() ? nullptr : &it->second;
}

std::string FolderJournal::Encode(const std::vector<Record>& records) const
{
    std::string lines;
    for (const Record& record : records)
    {
        for (size_t i = 0; i < record.size(); ++i)
            lines += (i ? "\t" : "") + EscapeField(record[i]);
        lines += "\n";
    }
    return lines;
}

bool FolderJournal::Append(const std::vector<Record>& records, bool sync)
{
    const std::string lines = Encode(records);
    if (write(m_fd, lines.data(), lines.size()) != static_cast<ssize_t>(lines.size()) ||
        (sync && fdatasync(m_fd) != 0))
        return false;
    for (const Record& record : records)
        Apply(record);
    return true;
}

void FolderJournal::CompactIfLarge()
{
    const size_t live = m_deliveries.size() + 3 * m_prints.size();
    if (m_records <= 256 || m_records <= 4 * live)
        return;
    std::vector<Record> records;
    for (const auto& delivery : m_deliveries)
        records.push_back(Deliver(delivery.first, delivery.second));
    for (const wxString& id : m_printOrder)
    {
        const PrintRecord& print = m_prints.at(id);
        records.push_back(Print(print));
        if (print.schedulerJob > 0)
            records.push_back(Job(id, print.schedulerJob));
        if (print.sent)
            records.push_back(Sent(id));
    }
    // The live records under a new name, on disk, then renamed over the old.
    const std::string text = Encode(records);
    const wxString temporary = m_path + ".new";
    // Opened for appending, it becomes the journal's descriptor once renamed.
    const int fd =
        open(temporary.fn_str(), O_RDWR | O_CREAT | O_TRUNC | O_APPEND | O_CLOEXEC, 0644);
    if (fd < 0)
        return;
    const bool written = write(fd, text.data(), text.size()) == static_cast<ssize_t>(text.size()) &&
                         fdatasync(fd) == 0;
    if (!written || rename(temporary.fn_str(), m_path.fn_str()) != 0)
    {
        close(fd);
        unlink(temporary.fn_str());
        return;
    }
    const int directory = open(wxFileName(m_path).GetPath().fn_str(), O_RDONLY | O_CLOEXEC);
    if (directory >= 0)
    {
        fsync(directory);
        close(directory);
    }
    close(m_fd);
    m_fd = fd;
    m_records = records.size();
}
