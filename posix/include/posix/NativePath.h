#pragma once
// Paths between the toolkit's strings and the file system's bytes, in the
// toolkit's file-name encoding. For wxWidgets code only: the rest of this
// library stays free of the toolkit.
#include <string>

#include <wx/string.h>

namespace posix
{
inline std::string NativePath(const wxString& path)
{
    const wxCharBuffer bytes = path.fn_str();
    return bytes.data() ? std::string(bytes.data()) : std::string();
}

inline wxString FromNativePath(const char* bytes)
{
    return wxString(bytes, *wxConvFileName);
}
} // namespace posix
