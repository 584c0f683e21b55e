#include "hotfolder/JobInfo.h"

#include <wx/arrimpl.cpp>

ReadyToProcessJobInfo::ReadyToProcessJobInfo(const ReadyToProcessJobInfo& other)
    : filterId(other.filterId), jobName(other.jobName), files(other.files), auxText(other.auxText),
      auxValue(other.auxValue)
{
}

WX_DEFINE_EXPORTED_OBJARRAY(JobInfoCollection);
