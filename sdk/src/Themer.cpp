#include "hotfolder/Themer.h"

#include <wx/settings.h>

Themer* Themer::GetThemeService()
{
    static Themer service;
    return &service;
}

stTheme Themer::GetTheme(const wxString& name) const
{
    stTheme theme;
    if (name == "HeaderView")
    {
        // A dark strip with light bold text, used above filter panels.
        theme.m_background = wxColour(0x3b, 0x4a, 0x5a);
        theme.m_foreground = *wxWHITE;
        theme.m_font = wxFont(wxFontInfo(11).Bold());
        return theme;
    }
    theme.m_background = wxSystemSettings::GetColour(wxSYS_COLOUR_WINDOW);
    theme.m_foreground = wxSystemSettings::GetColour(wxSYS_COLOUR_WINDOWTEXT);
    theme.m_font = wxSystemSettings::GetFont(wxSYS_DEFAULT_GUI_FONT);
    return theme;
}
