#pragma once
#include <cstdint>
#include <wx/arrstr.h>
#include <wx/dynarray.h>
#include <wx/string.h>
#include "hotfolder/Export.h"

// One recognised job: the files a filter accepted as one unit of work.
class HF_SDK_API ReadyToProcessJobInfo
{
public:
    ReadyToProcessJobInfo() = default;
    ReadyToProcessJobInfo(const ReadyToProcessJobInfo& other);
    ReadyToProcessJobInfo& operator=(const ReadyToProcessJobInfo& other) = default;

    wxString filterId;
    wxString jobName;
    wxArrayString files;
    wxString auxText;
    uint64_t auxValue = 0;
};

// Owning array of jobs; Add stores heap copies made with the copy constructor.
WX_DECLARE_EXPORTED_OBJARRAY(ReadyToProcessJobInfo, JobInfoCollection);
