#pragma once
#include <wx/colour.h>
#include <wx/font.h>
#include <wx/string.h>
#include "hotfolder/Export.h"

struct stTheme
{
    wxColour m_background;
    wxColour m_foreground;
    wxFont m_font;
};

// The host's theme service: colours and fonts by theme name ("Default",
// "HeaderView"). Unknown names answer the "Default" theme.
class HF_SDK_API Themer
{
public:
    static Themer* GetThemeService();
    stTheme GetTheme(const wxString& name) const;

private:
    Themer() = default;
};
