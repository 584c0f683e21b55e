#include "ErrorCodes.h"

#include <wx/translation.h>

namespace
{
const char* const kFrameworkMessages[] = {
    // -1010 .. -1002
    "Distiller is not installed",
    "PDF merge failed",
    "PDF preflight failed",
    "PDF conversion failed",
    "Filter is not initialized",
    "Invalid input file",
    "This filter is not supported on server",
    "Filter conversion failed",
    "Input file not found",
};

const char* const kConverterMessages[] = {
    // 1011 .. 1032; 1016 to 1019 have no message
    "MS Office is not installed",
    "MS Word is not installed",
    "MS Power Point is not installed",
    "MS Excel is not installed",
    "MS Publisher is not installed",
    nullptr,
    nullptr,
    nullptr,
    nullptr,
    "Error printing output file",
    "Output file not found",
    "Error: Expecting Correct PS Header",
    "Error: Publisher 2000 or Previous",
    "Error: Unable to Open ps/pdf prefix.ps file",
    "Error: Unable to open or create RES file",
    "Error: Unable to get CT/LW Resolution",
    "Error: Resolution is not reasonable",
    "Error: Unable to open temp directory",
    "Error: Unable to open configuration file for filter",
    "Error: invalid separation name for 1-bit Tiff",
    "Error: General processing error during conversion",
    "Error: CSL library error during conversion",
};

const char* MessageFor(long code)
{
    if (code == HF_ERROR)
        return "Error";
    if (code >= HF_DISTILLER_NOT_INSTALLED && code <= HF_INPUT_FILE_NOT_FOUND)
        return kFrameworkMessages[code - HF_DISTILLER_NOT_INSTALLED];
    if (code >= HF_MS_OFFICE_NOT_INSTALLED && code <= HF_CSL_LIBRARY_ERROR)
    {
        const char* text = kConverterMessages[code - HF_MS_OFFICE_NOT_INSTALLED];
        if (text)
            return text;
    }
    return "No Error";
}
} // namespace

wxString GetErrorStringFromID(long code)
{
    return wxGetTranslation(wxString::FromUTF8(MessageFor(code)));
}
