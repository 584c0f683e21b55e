#include "XmlHelper.h"

#include <memory>

#include <wx/filename.h>
#include <wx/log.h>
#include <wx/wfstream.h>

wxXmlDocument* CXmlDocumentHelper::Load(const CStdStr<wchar_t>& path,
                                        const CStdStr<wchar_t>& encoding)
{
    const wxString file = ToWxString(path);
    if (!wxFileName::FileExists(file))
        return nullptr;
    auto document = std::make_unique<wxXmlDocument>();
    bool loaded = false;
    {
        // The stream's own open failure would log a second message; the one
        // report of a failed load is ours.
        wxLogNull quiet;
        wxFileInputStream stream(file);
        // wxXmlDocument's parser reports its own errors through wxLog too.
        loaded = stream.IsOk() && document->Load(stream, ToWxString(encoding)) && document->IsOk();
    }
    if (!loaded)
    {
        wxLogError("Cannot load Strings from file '%s'.", file);
        return nullptr;
    }
    return document.release();
}
