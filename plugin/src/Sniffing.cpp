// Which arriving files the filter takes as jobs.
#include <cstring>
#include <utility>

#include <wx/dir.h>
#include <wx/filename.h>

#include "EPS.h"
#include "EPStoPS.h"
#include "ErrorCodes.h"
#include "FolderListing.h"

namespace
{
// Whether the name's extension is "EPS" in any case. As the toolkit's file
// names see it: the part after the last dot, unless that dot begins the name.
bool HasEpsExtension(const wxString& name)
{
    const size_t dot = name.rfind('.');
    if (dot == wxString::npos || dot == 0 || name.length() - dot != 4)
        return false;
    static const wxUniChar kEps[] = {'E', 'P', 'S'};
    for (size_t i = 0; i < 3; ++i)
        if (wxToupper(name[dot + 1 + i]) != kEps[i])
            return false;
    return true;
}

// A file named .eps that the engine cannot read, or a DOS EPS binary whose
// PostScript section is not in the file, is meant to print: a converting
// filter takes it, so that its job fails with the reason rather than the
// file lying in the folder unexplained. Passed through unread, it would be
// delivered as it is; that filter refuses it as before.
bool TakenAsBroken(EPSFailureKind_t kind, bool passThrough)
{
    return !passThrough && (kind == EPS_FAILURE_UNREADABLE || kind == EPS_FAILURE_DAMAGED);
}
} // namespace

std::string RefusalReason(const char* nativePath)
{
    if (!nativePath || *nativePath == '\0')
        return "no file was named";
    const char* slash = std::strrchr(nativePath, '/');
    const wxString name(slash ? slash + 1 : nativePath, *wxConvFileName);
    if (!HasEpsExtension(name))
        return "not an EPS file: its name does not end in .eps";
    void* context = nullptr;
    if (IsThisEPS(nativePath, &context))
    {
        EPStoPSfreeMemory(&context);
        return std::string();
    }
    return EPStoPSFailureReason();
}

EPS::SniffResult EPS::SniffOne(const wxString& path, const char* nativePath,
                               const wxString& filterId, JobInfoCollection& jobs)
{
    if (path.empty())
        return SniffResult::EmptyPath;
    wxString name = path.AfterLast('/');
    if (!HasEpsExtension(name))
        return SniffResult::Refused;
    wxCharBuffer converted;
    if (!nativePath)
    {
        converted = path.fn_str();
        nativePath = converted.data();
    }
    if (!nativePath || *nativePath == '\0')
        return SniffResult::Refused; // not expressible as a file name here

    void* context = nullptr;
    if (IsThisEPS(nativePath, &context))
        EPStoPSfreeMemory(&context);
    else if (!TakenAsBroken(EPStoPSFailureKind(), m_bOutputTypeIsOne))
        return SniffResult::NotEPS;

    auto* job = new ReadyToProcessJobInfo; // the collection takes it over
    job->filterId = filterId;
    job->jobName = std::move(name);
    job->files.Alloc(1); // a first Add would make room for sixteen
    job->files.Add(path);
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
        switch (SniffOne(path, nullptr, filterId, jobs))
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

EPS::SniffResult EPS::SniffListed(const wxString& path, const char* nativePath,
                                  const wxString& filterId, wxArrayString& rejected,
                                  JobInfoCollection& jobs)
{
    const SniffResult result = SniffOne(path, nativePath, filterId, jobs);
    if (result == SniffResult::Refused)
        rejected.Add(path);
    return result;
}

long EPS::SniffFileList(const wxArrayString& files, wxArrayString& rejected,
                        JobInfoCollection& jobs)
{
    wxString filterId;
    GetShortName(filterId);
    for (const wxString& path : files)
        if (SniffListed(path, nullptr, filterId, rejected, jobs) == SniffResult::EmptyPath)
            return m_lStatus = HF_INPUT_FILE_NOT_FOUND;
    return m_lStatus = HF_NO_ERROR;
}

long EPS::SniffFolder(const wxString& folder, wxArrayString& rejected, JobInfoCollection& jobs)
{
    if (IsPPMLFolder(folder))
        return HF_NO_ERROR;
    wxString filterId;
    GetShortName(filterId);
    // Straight from the listing: no list of every path is built first.
    folder_listing::ForEachFile(folder, [&](const wxString& path, const char* nativePath)
                                { SniffListed(path, nativePath, filterId, rejected, jobs); });
    return m_lStatus = HF_NO_ERROR;
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

bool EPS::IsPPMLFolder(const wxString& folder)
{
    if (!wxDir::Exists(folder))
        return false;
    const folder_listing::NameCounts counts = folder_listing::CountPpmlNames(folder);
    // The upper-case spelling is looked at only when no lower-case one
    // exists. Exactly one PPML file makes a PPML job; several make an
    // ordinary folder.
    const size_t count = counts.lower > 0 ? counts.lower : counts.upper;
    return count == 1;
}
