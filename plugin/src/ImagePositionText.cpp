// The settings word of the image position to the converter's numbering. It
// asks the translation service, so it lives with the settings loading and not
// in the conversion engine.
#include "ImagePositionText.h"

#include <hotfolder/HFTranslations.h>

#include "EPStoPSparams.h"
#include "SettingsKeys.h"

uint32_t ConvertToImgPosStr(const wxString& text)
{
    const HFTranslations* translations = HFTranslations::GetInstance();
    struct Word
    {
        const char* english;
        ImagePosition_t position;
    };
    // Looked up in this order; the first list holding the text wins.
    static const Word words[] = {
        {kImagePositionWords[0], IMG_POS_TOP_LEFT},
        {kImagePositionWords[1], IMG_POS_TOP_RIGHT},
        {kImagePositionWords[2], IMG_POS_CENTER},
        {kImagePositionWords[4], IMG_POS_BOTTOM_RIGHT},
        {kImagePositionWords[3], IMG_POS_BOTTOM_LEFT},
    };
    for (const Word& word : words)
    {
        const wxArrayString all = translations->GetTranslations(word.english);
        if (all.Index(text, true) != wxNOT_FOUND)
            return word.position;
    }
    return IMG_POS_CENTER;
}
