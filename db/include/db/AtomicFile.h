#pragma once
#include <cstddef>
#include <string>

#include <wx/string.h>
#include <wx/xml/xml.h>

namespace db
{
// Replaces a file so that readers see either the old or the new content,
// never a part: the bytes go to a temporary file in the same directory,
// which is flushed to disk and renamed over the target; the directory is
// synced last. An existing target's permission bits are kept; a new file
// gets 0666 less the umask. On failure the target is untouched, and reason
// (when given) receives the system's words for why, for the caller's message.
class AtomicFile
{
public:
    static bool Write(const wxString& path, const void* data, size_t size,
                      wxString* reason = nullptr);
    static bool Write(const wxString& path, const std::string& bytes, wxString* reason = nullptr);
    // Serialises the document ("UTF-8" unless the document says otherwise)
    // with the given indentation step and writes it as above. Characters
    // XML cannot carry (most control characters, U+FFFE, U+FFFF) are left
    // out, so the file always loads again.
    static bool WriteXml(const wxString& path, const wxXmlDocument& document, int indent = 2);
};
} // namespace db
