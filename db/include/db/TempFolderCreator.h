#pragma once
#include <wx/datetime.h>
#include <wx/string.h>

namespace utils
{
class TempFolderCreator
{
public:
    // Local time as year, month, day, hour, minute, second, millisecond, each
    // without padding: unique only to the millisecond, which callers accept.
    static wxString GetTempFolder();
    // The name GetTempFolder gives at the given moment.
    static wxString FormatName(const wxDateTime& time);
};
} // namespace utils
