#pragma once
#include <cstddef>

#include <wx/string.h>

#include <hotfolder/IProgressTracker.h>

class ProgressDisplay;

// What the road of the jobs tells as it goes: the service writes it to its
// log, "hotfolder run" to the terminal (a progress bar, result lines on
// standard output, errors on standard error).
class JobReport
{
public:
    virtual ~JobReport() = default;
    virtual void Begin(size_t index, size_t total, const wxString& name) = 0;
    // A job finished, e.g. "a.eps -> /hot/Output/a.ps".
    virtual void Done(const wxString& line) = 0;
    // A job failed for reason; what became of its original.
    virtual void Failed(const wxString& jobName, const wxString& reason,
                        const wxString& original) = 0;
    // A file no job took, with the filter's reason (empty when it gave none).
    virtual void Refused(const wxString& path, const wxString& reason) = 0;
    virtual void Info(const wxString& line) = 0;
    virtual void Warning(const wxString& line) = 0;
    virtual void Error(const wxString& line) = 0;
    // Where the filter reports its progress; none for the service.
    virtual IProgressTracker* Progress() { return nullptr; }
};

// The service's log: one line each with its severity.
class ServiceReport : public JobReport
{
public:
    void Begin(size_t, size_t, const wxString&) override {}
    void Done(const wxString& line) override;
    void Failed(const wxString& jobName, const wxString& reason, const wxString& original) override;
    void Refused(const wxString& path, const wxString& reason) override;
    void Info(const wxString& line) override;
    void Warning(const wxString& line) override;
    void Error(const wxString& line) override;
};

// A terminal or a pipe: results on standard output, problems on standard error.
class ConsoleReport : public JobReport
{
public:
    explicit ConsoleReport(ProgressDisplay& progress) : m_progress(progress) {}
    void Begin(size_t index, size_t total, const wxString& name) override;
    void Done(const wxString& line) override;
    void Failed(const wxString& jobName, const wxString& reason, const wxString& original) override;
    void Refused(const wxString& path, const wxString& reason) override;
    void Info(const wxString& line) override;
    void Warning(const wxString& line) override;
    void Error(const wxString& line) override;
    IProgressTracker* Progress() override;

private:
    ProgressDisplay& m_progress;
};
