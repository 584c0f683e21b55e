#include "cli/ProgressDisplay.h"

#include <algorithm>
#include <cstdio>

#include "cli/ConsoleText.h"
#include "posix/NativePath.h"

void ProgressDisplay::BeginJob(size_t index, size_t total, const wxString& name)
{
    m_index = index;
    m_total = total;
    m_percent = 0;
    m_name = posix::ShownLine(name);
    if (m_terminal)
        Draw();
}

void ProgressDisplay::ReportProgress(const wxString&, int percent)
{
    m_percent = std::clamp(percent, 0, 100);
    if (m_terminal)
        Draw();
}

void ProgressDisplay::EndJob(const wxString& outcome)
{
    if (m_terminal)
    {
        Note(outcome);
        return;
    }
    PrintLine(wxString::Format("[%zu/%zu] %s", m_index + 1, m_total, posix::ShownLine(outcome)));
    std::fflush(stdout);
}

void ProgressDisplay::Note(const wxString& line)
{
    ClearBar();
    PrintLine(posix::ShownLine(line));
    std::fflush(stdout);
}

void ProgressDisplay::ClearBar()
{
    if (m_terminal && m_barShown)
    {
        std::fputs("\r\033[K", stdout);
        m_barShown = false;
    }
}

void ProgressDisplay::Draw()
{
    const int width = 30;
    double done = m_total ? (m_index + m_percent / 100.0) / m_total : 1.0;
    int filled = static_cast<int>(done * width + 0.5);
    std::string bar(filled, '#');
    bar.append(width - filled, '-');
    std::printf("\r\033[K[%s] %3d%%  %zu/%zu  %s", bar.c_str(), static_cast<int>(done * 100),
                m_index + 1, m_total, ToUtf8(m_name).c_str());
    std::fflush(stdout);
    m_barShown = true;
}
