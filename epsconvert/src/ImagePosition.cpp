#include "ImagePosition.h"

#include <hotfolder/HFTranslations.h>

FilterImgPosition_t ConvertToImgPos(ImagePosition_t position)
{
    static const FilterImgPosition_t table[] = {
        FILTER_IMG_POS_BOTTOM_LEFT,  // IMG_POS_BOTTOM_LEFT
        FILTER_IMG_POS_TOP_LEFT,     // IMG_POS_TOP_LEFT
        FILTER_IMG_POS_TOP_RIGHT,    // IMG_POS_TOP_RIGHT
        FILTER_IMG_POS_BOTTOM_RIGHT, // IMG_POS_BOTTOM_RIGHT
        FILTER_IMG_POS_CENTER,       // IMG_POS_CENTER
    };
    // Out of range maps to top right, not to the centre: kept as hosts expect.
    return position <= IMG_POS_CENTER ? table[position] : FILTER_IMG_POS_TOP_RIGHT;
}

ImagePosition_t ConvertFromImgPos(FilterImgPosition_t position)
{
    static const ImagePosition_t table[] = {
        IMG_POS_CENTER,       // FILTER_IMG_POS_CENTER
        IMG_POS_BOTTOM_LEFT,  // FILTER_IMG_POS_BOTTOM_LEFT
        IMG_POS_TOP_LEFT,     // FILTER_IMG_POS_TOP_LEFT
        IMG_POS_BOTTOM_RIGHT, // FILTER_IMG_POS_BOTTOM_RIGHT
    };
    // Top right is reached through the default only.
    return position <= FILTER_IMG_POS_BOTTOM_RIGHT ? table[position] : IMG_POS_TOP_RIGHT;
}

uint32_t ConvertToImgPosStr(const wxString& text)
{
    HFTranslations* translations = HFTranslations::GetInstance();
    struct Word
    {
        const char* english;
        ImagePosition_t position;
    };
    // Looked up in this order; the first list holding the text wins.
    static const Word words[] = {
        {"Top Left", IMG_POS_TOP_LEFT},       {"Top Right", IMG_POS_TOP_RIGHT},
        {"Center", IMG_POS_CENTER},           {"Bottom Right", IMG_POS_BOTTOM_RIGHT},
        {"Bottom Left", IMG_POS_BOTTOM_LEFT},
    };
    for (const Word& word : words)
    {
        const wxArrayString all = translations->GetTranslations(word.english);
        if (all.Index(text, true) != wxNOT_FOUND)
            return word.position;
    }
    return IMG_POS_CENTER;
}
