#pragma once
// Paths between the toolkit's strings and the file system's bytes. For
// wxWidgets code only: the rest of this library stays free of the toolkit.
//
// File names are bytes. They are read as UTF-8; a byte that is not UTF-8 is
// carried through the toolkit's strings as a private-use character and
// comes back as the same byte, so a name that is no UTF-8 still names its
// file (the locale's conversion would turn it into an empty string).
#include <string>

#include <wx/strconv.h>
#include <wx/string.h>

#include "posix/OutsideText.h"

namespace posix
{
inline wxMBConv& FileNameConversion()
{
    static wxMBConvUTF8 conversion(wxMBConvUTF8::MAP_INVALID_UTF8_TO_PUA);
    return conversion;
}

// Makes the toolkit's file-name conversion (fn_str, wxFileName, wxDir) the
// one above, for the whole process and every module it loads.
inline void KeepFileNameBytes()
{
    wxConvFileName = &FileNameConversion();
}

inline std::string NativePath(const wxString& path)
{
    const wxCharBuffer bytes = path.mb_str(FileNameConversion());
    return bytes.data() ? std::string(bytes.data()) : std::string();
}

inline wxString FromNativePath(const char* bytes)
{
    return wxString(bytes, FileNameConversion());
}

// Text that may hold outside text (names above all), made safe to show as
// one line: see ShownText.
inline wxString ShownLine(const wxString& text)
{
    const std::string shown = ShownText(NativePath(text));
    return wxString::FromUTF8(shown.data(), shown.size());
}
} // namespace posix
