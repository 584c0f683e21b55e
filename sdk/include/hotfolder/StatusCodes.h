#pragma once
// The status codes of the filter family and their texts: part of the host
// contract, shared by every filter and by the hosts that show the texts.
// The texts are English source strings; filters pass them through the
// translation service before handing them out.

// The codes a filter operation returns.
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

struct HFStatusText
{
    long code;
    const char* text;
};

// Every code with a text, in table order: success, the generic error, the
// framework codes (-1002 to -1010) and the converter codes (1011 to 1015,
// 1020 to 1032). Codes 1016 to 1019 have none.
inline constexpr HFStatusText kHFStatusTexts[] = {
    {0, "No Error"},
    {-1, "Error"},
    {-1002, "Input file not found"},
    {-1003, "Filter conversion failed"},
    {-1004, "This filter is not supported on server"},
    {-1005, "Invalid input file"},
    {-1006, "Filter is not initialized"},
    {-1007, "PDF conversion failed"},
    {-1008, "PDF preflight failed"},
    {-1009, "PDF merge failed"},
    {-1010, "Distiller is not installed"},
    {1011, "MS Office is not installed"},
    {1012, "MS Word is not installed"},
    {1013, "MS Power Point is not installed"},
    {1014, "MS Excel is not installed"},
    {1015, "MS Publisher is not installed"},
    {1020, "Error printing output file"},
    {1021, "Output file not found"},
    {1022, "Error: Expecting Correct PS Header"},
    {1023, "Error: Publisher 2000 or Previous"},
    {1024, "Error: Unable to Open ps/pdf prefix.ps file"},
    {1025, "Error: Unable to open or create RES file"},
    {1026, "Error: Unable to get CT/LW Resolution"},
    {1027, "Error: Resolution is not reasonable"},
    {1028, "Error: Unable to open temp directory"},
    {1029, "Error: Unable to open configuration file for filter"},
    {1030, "Error: invalid separation name for 1-bit Tiff"},
    {1031, "Error: General processing error during conversion"},
    {1032, "Error: CSL library error during conversion"},
};

// The untranslated text for a code. A code without an entry reads as
// success ("No Error"): hosts' logs have always shown it so.
inline const char* HFStatusTextFor(long code)
{
    for (const HFStatusText& entry : kHFStatusTexts)
        if (entry.code == code)
            return entry.text;
    return kHFStatusTexts[0].text;
}
