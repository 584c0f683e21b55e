#include "service/FolderJournal.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <string>
#include <unistd.h>

#include <wx/filename.h>

#include "cli/ConsoleText.h"

const char FolderJournal::kFileName[] = "service.journal";

FolderJournal::~FolderJournal()
{
    if (m_fd >= 0)
        close(m_fd);
}

bool FolderJournal::Open(const wxString& directory, wxString& error)
{
    const wxString path = wxFileName(directory, kFileName).GetFullPath();
    m_fd = open(path.fn_str(), O_RDWR | O_CREAT | O_APPEND | O_CLOEXEC, 0644);
    if (m_fd < 0)
    {
        error = wxString::Format("cannot open the journal %s: %s", path,
                                 wxString::FromUTF8(std::strerror(errno)));
        return false;
    }
    std::string text;
    char buffer[1 << 14];
    ssize_t got;
    while ((got = pread(m_fd, buffer, sizeof(buffer), static_cast<off_t>(text.size()))) > 0)
        text.append(buffer, static_cast<size_t>(got));
    size_t start = 0;
    for (size_t end; (end = text.find('\n', start)) != std::string::npos; start = end + 1)
    {
        const std::string line = text.substr(start, end - start);
        const size_t first = line.find('\t');
        const size_t second = first == std::string::npos ? first : line.find('\t', first + 1);
        if (second == std::string::npos || line.compare(0, first, "deliver") != 0)
            continue;
        m_deliveries[FromUtf8(line.substr(first + 1, second - first - 1))] =
            FromUtf8(line.substr(second + 1));
        ++m_records;
    }
    // A torn last record goes, so the next one starts on a line of its own.
    if (start < text.size() && ftruncate(m_fd, static_cast<off_t>(start)) != 0)
    {
        error = "cannot repair the journal " + path;
        return false;
    }
    return true;
}

wxString FolderJournal::DeliveryOf(const wxString& job) const
{
    auto it = m_deliveries.find(job);
    return it == m_deliveries.end() ? wxString() : it->second;
}

bool FolderJournal::RecordDeliveries(const std::vector<std::pair<wxString, wxString>>& records)
{
    std::string lines;
    for (const auto& record : records)
        lines += "deliver\t" + ToUtf8(record.first) + "\t" + ToUtf8(record.second) + "\n";
    if (write(m_fd, lines.data(), lines.size()) != static_cast<ssize_t>(lines.size()) ||
        fdatasync(m_fd) != 0)
        return false;
    for (const auto& record : records)
        m_deliveries[record.first] = record.second;
    m_records += records.size();
    return true;
}

void FolderJournal::Clear()
{
    if (ftruncate(m_fd, 0) == 0)
    {
        fdatasync(m_fd);
        m_deliveries.clear();
        m_records = 0;
    }
}
