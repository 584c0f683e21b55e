#include "db/TempFolderCreator.h"

#include <wx/datetime.h>

namespace utils
{
wxString TempFolderCreator::GetTempFolder()
{
    return FormatName(wxDateTime::UNow());
}

wxString TempFolderCreator::FormatName(const wxDateTime& time)
{
    const wxDateTime::Tm tm = time.GetTm(wxDateTime::Local);
    return wxString::Format("%d%d%d%d%d%d%d", tm.year, static_cast<int>(tm.mon) + 1,
                            static_cast<int>(tm.mday), static_cast<int>(tm.hour),
                            static_cast<int>(tm.min), static_cast<int>(tm.sec),
                            static_cast<int>(tm.msec));
}
} // namespace utils
