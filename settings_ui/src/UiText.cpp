#include "UiText.h"

#include <wx/arrstr.h>

#include <hotfolder/HFTranslations.h>

wxString TranslateUiText(const wxString& english)
{
    return HFTranslations::GetInstance()->Translate(english);
}

void ReplacePlaceHolderString(wxString& message, const wxArrayString& placeholders,
                              const wxArrayString& replacements)
{
    if (placeholders.empty() || placeholders.size() != replacements.size())
        return;
    for (size_t i = 0; i < placeholders.size(); ++i)
        message.Replace(placeholders[i], replacements[i], false);
}
