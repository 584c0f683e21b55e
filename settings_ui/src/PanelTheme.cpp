#include "PanelTheme.h"

#include <wx/window.h>

#include <hotfolder/Themer.h>

void ApplyDefaultTheme(wxWindow* window)
{
    const stTheme theme = Themer::GetThemeService()->GetTheme("Default");
    if (theme.m_background.IsOk())
        window->SetBackgroundColour(theme.m_background);
}
