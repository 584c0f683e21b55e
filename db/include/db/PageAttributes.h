#pragma once
#include <cstdint>
#include <wx/string.h>

// One paper size the print server offers. Numbers as the server writes them.
struct stPageAttribute
{
    wxString PaperName;
    wxString PaperAlias;
    wxString PaperDisplayName;
    double Left = 0;
    double Top = 0;
    double Right = 0;
    double Bottom = 0;
    double Width = 0;
    double Height = 0;
    wxString PSCommand;
    double Reserved1 = 0; // zeroed, never set: no source in the description
    double Reserved2 = 0;
};

// The server's limits for custom media.
struct stCustomPageSizeAttribute
{
    double MinMediaWidth = 0;
    double MaxMediaWidth = 0;
    double MinMediaHeight = 0;
    double MaxMediaHeight = 0;
    int32_t LeftHWMargin = 0;
    int32_t RightHWMargin = 0;
    int32_t TopHWMargin = 0;
    int32_t BottomHWMargin = 0;
    wxString command;
    bool SubstrateHeightToLength = false;
};
