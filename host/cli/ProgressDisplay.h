#pragma once
#include <cstddef>

#include <hotfolder/IProgressTracker.h>

// Shows the filter's progress: a redrawn bar on a terminal, one plain line
// per finished job otherwise (logs and pipes stay readable).
class ProgressDisplay : public IProgressTracker
{
public:
    explicit ProgressDisplay(bool terminal) : m_terminal(terminal) {}

    void BeginJob(size_t index, size_t total, const wxString& name);
    void ReportProgress(const wxString& path, int percent) override;
    // The job's result line, e.g. "a.eps -> Output/a.ps".
    void EndJob(const wxString& outcome);
    // A line that must not be torn by the bar.
    void Note(const wxString& line);

private:
    void Draw();
    void ClearBar();

    bool m_terminal;
    bool m_barShown = false;
    size_t m_index = 0;
    size_t m_total = 0;
    int m_percent = 0;
    wxString m_name;
};
