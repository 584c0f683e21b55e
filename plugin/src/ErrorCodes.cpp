#include "ErrorCodes.h"

#include <wx/translation.h>

wxString GetErrorStringFromID(long code)
{
    return wxGetTranslation(wxString::FromUTF8(HFStatusTextFor(code)));
}
