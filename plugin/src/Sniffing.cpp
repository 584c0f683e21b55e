// Which arriving files the filter takes as jobs.
#include <ftw.h>

#include <cstring>

#include <wx/dir.h>
#include <wx/filename.h>

#include "EPS.h"
#include "EPStoPS.h"
#include "ErrorCodes.h"

EPS::SniffResult EPS::SniffOne(const wxString& path, const wxString& filterId,
                               JobInfoCollection& jobs)
{
    if (path.empty())
        return SniffResult::EmptyPath;
    const wxFileName name(path, wxPATH_NATIVE);
    const wxCharBuffer bytes = name.GetFullPath().fn_str();
    if (!bytes.data() || bytes.length() == 0 || name.GetExt().CmpNoCase("EPS") != 0)
        return SniffResult::Refused;

    void* context = nullptr;
    if (!IsThisEPS(bytes.data(), &context))
        return SniffResult::NotEPS;
    EPStoPSfreeMemory(&context);

    ReadyToProcessJobInfo job;
    job.filterId = filterId;
    job.jobName = name.GetFullName();
    job.files.Add(path);
    jobs.Add(job);
    return SniffResult::Accepted;
}

long EPS::SniffFiles(const wxArrayString& files, wxArrayString& second, wxArrayString& rejected,
                     JobInfoCollection& jobs)
{
    wxString filterId;
    GetShortName(filterId);
    second.Empty();
    bool accepted = false;
    for (const wxString& path : files)
    {
        switch (SniffOne(path, filterId, jobs))
        {
        case SniffResult::EmptyPath:
            return m_lStatus = HF_INPUT_FILE_NOT_FOUND;
        case SniffResult::Accepted:
            accepted = true;
            break;
        case SniffResult::Refused:
        case SniffResult::NotEPS:
            // Hosts rely on this: once a file was accepted, later refusals
            // are no longer reported.
            if (!accepted)
                rejected.Add(path);
            break;
        }
    }
    return m_lStatus = HF_NO_ERROR;
}

long EPS::SniffFileList(const wxArrayString& files, wxArrayString& rejected,
                        JobInfoCollection& jobs)
{
    wxString filterId;
    GetShortName(filterId);
    for (const wxString& path : files)
    {
        switch (SniffOne(path, filterId, jobs))
        {
        case SniffResult::EmptyPath:
            return m_lStatus = HF_INPUT_FILE_NOT_FOUND;
        case SniffResult::Refused:
            rejected.Add(path);
            break;
        case SniffResult::NotEPS: // an .eps that is not EPS is dropped, not offered elsewhere
        case SniffResult::Accepted:
            break;
        }
    }
    return m_lStatus = HF_NO_ERROR;
}

long EPS::SniffFolder(const wxString& folder, wxArrayString& rejected, JobInfoCollection& jobs)
{
    if (IsPPMLFolder(folder))
        return HF_NO_ERROR;
    wxArrayString files;
    if (wxDir::Exists(folder))
    {
        wxDir dir(folder);
        wxString name;
        for (bool more = dir.IsOpened() && dir.GetFirst(&name, wxEmptyString, wxDIR_FILES); more;
             more = dir.GetNext(&name))
            files.Add(wxFileName(folder, name).GetFullPath());
    }
    return SniffFileList(files, rejected, jobs);
}

long EPS::SniffFolder(const wxString& folder, wxArrayString& rejected, JobInfoCollection& jobs,
                      FolderContent*& content)
{
    const wxArrayString files = content ? content->m_arrFiles : wxArrayString();
    if (IsPPMLFolder(folder))
    {
        rejected = files; // a PPML job is refused whole
        return m_lStatus = HF_NO_ERROR;
    }
    return SniffFileList(files, rejected, jobs);
}

namespace
{
// Names matching "*.ppml" and "*.PPML" below the folder, in one walk.
thread_local size_t lowerMatches = 0;
thread_local size_t upperMatches = 0;

bool EndsWith(const char* name, const char* suffix)
{
    const size_t n = std::strlen(name), m = std::strlen(suffix);
    return n >= m && std::memcmp(name + n - m, suffix, m) == 0;
}

int CountPpml(const char* path, const struct stat*, int type, struct FTW* where)
{
    if (type == FTW_F || type == FTW_SL)
    {
        const char* name = path + where->base;
        lowerMatches += EndsWith(name, ".ppml");
        upperMatches += EndsWith(name, ".PPML");
    }
    return 0;
}
} // namespace

bool EPS::IsPPMLFolder(const wxString& folder)
{
    if (!wxDir::Exists(folder))
        return false;
    lowerMatches = upperMatches = 0;
    nftw(folder.fn_str(), CountPpml, 32, FTW_PHYS);
    // The upper-case spelling is looked at only when no lower-case one
    // exists. Exactly one PPML file makes a PPML job; several make an
    // ordinary folder.
    const size_t count = lowerMatches > 0 ? lowerMatches : upperMatches;
    return count == 1;
}
