#pragma once
#include <wx/string.h>

// Status codes shared by every filter of the host family.
enum HFStatus : long
{
    HF_NO_ERROR = 0,
    HF_ERROR = -1,
    HF_INPUT_FILE_NOT_FOUND = -1002,
    HF_FILTER_CONVERSION_FAILED = -1003,
    HF_FILTER_NOT_SUPPORTED_ON_SERVER = -1004,
    HF_INVALID_INPUT_FILE = -1005,
    HF_FILTER_NOT_INITIALIZED = -1006,
    HF_PDF_CONVERSION_FAILED = -1007,
    HF_PDF_PREFLIGHT_FAILED = -1008,
    HF_PDF_MERGE_FAILED = -1009,
    HF_DISTILLER_NOT_INSTALLED = -1010,
    HF_MS_OFFICE_NOT_INSTALLED = 1011,
    HF_CSL_LIBRARY_ERROR = 1032
};

// The message for a code, through the user-interface catalogue. Unknown
// codes read "No Error", as the hosts' logs expect.
wxString GetErrorStringFromID(long code);
