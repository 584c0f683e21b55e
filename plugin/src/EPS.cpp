#include "EPS.h"

#include <cstring>

#include "ErrorCodes.h"
#include "FilterVersion.h"
#include "SettingsKeys.h"

const wxString ERRORDIFFUSION_KEY = "ErrorDiffusion";
const wxString IMAGEPRIORITY_KEY = "Quality";
const wxString RESOLUTION_1200_KEY = "600x600dpi"; // the name and the value disagree; both stay

namespace
{
const char* const kDisplayName = "EPS";
} // namespace

EPS::EPS(wxString) : m_settings(100)
{
    m_settings[SettingsKeys::OUTPUTFILETYPEEPS] = FormatSettingFlag(true);
    std::memset(&m_params, 0, sizeof m_params);
    m_params.pageWidth = 595.0;
    m_params.pageHeight = 843.0; // 843, not 842: hosts depend on this default
    m_params.imageableLLX = 12.1;
    m_params.imageableLLY = 12.0;
    m_params.imageableURX = 583.0;
    m_params.imageableURY = 830.0;
    m_params.imagePosition = IMG_POS_CENTER;
    m_params.setPageDeviceString = nullptr;
}

EPS::~EPS()
{
    delete[] m_params.setPageDeviceString;
}

void EPS::GetVersion(wxString& out)
{
    out = HF_FILTER_VERSION;
}

void EPS::GetDisplayName(wxString& out)
{
    out = kDisplayName;
}

void EPS::GetShortName(wxString& out)
{
    out = HF_FILTER_IDENTIFIER;
}

void EPS::GetSupportedFileExtensions(wxArrayString& extensions, wxArrayString& second)
{
    second.Empty();
    extensions.Insert("eps", 0);
}

int EPS::GetGroupType()
{
    return 1;
}

bool EPS::GetErrorString(long code, wxString& out)
{
    out = GetErrorStringFromID(code);
    if (code != HF_NO_ERROR && code == m_lFailureCode && !m_strFailureReason.empty())
        out += ": " + m_strFailureReason;
    return true;
}

bool EPS::IsInitialized()
{
    return true;
}

long EPS::DeInitialize()
{
    return 0;
}

void EPS::GetServerKeys(wxArrayString& keys)
{
    keys.Add("GA2_HOTFOLDERS");
    keys.Add("HF_EPS_FILTER");
}
