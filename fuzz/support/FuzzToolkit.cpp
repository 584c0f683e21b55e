#include "FuzzToolkit.h"

#include <cstdio>
#include <cstdlib>
#include <memory>

#include <wx/init.h>
#include <wx/log.h>

namespace fuzzsupport
{
void InitialiseToolkitOnce()
{
    static std::unique_ptr<wxInitializer> toolkit;
    if (toolkit)
        return;
    InitialiseOnce();
    toolkit = std::make_unique<wxInitializer>();
    if (!toolkit->IsOk())
    {
        std::fputs("the toolkit did not initialise\n", stderr);
        std::abort();
    }
    // Parse errors are expected by the thousand; a log window or stderr
    // chatter would only slow the run down.
    delete wxLog::SetActiveTarget(nullptr);
    wxLog::EnableLogging(false);
}

wxString TextOf(const uint8_t* data, size_t size)
{
    const char* bytes = reinterpret_cast<const char*>(data);
    wxString text = wxString::FromUTF8(bytes, size);
    if (text.empty() && size > 0)
        text = wxString::From8BitData(bytes, size);
    return text;
}
} // namespace fuzzsupport
