// Paper sizes and custom page size limits of the server description.
#include "db/PluginInitialize.h"

#include <cstdint>

#include "PluginInitializeDocument.h"
#include "utils/CLocaleNumbers.h"

using server_description::FindElement;
using server_description::HasContent;
using server_description::Parse;
using server_description::TextOf;

namespace
{
// Stores the text of a paper child into the field of its name. "PSCommand"
// is left to the caller, which decides what closes a group.
void SetPageField(stPageAttribute& page, const wxString& name, const wxString& text)
{
    if (name == "PaperName")
        page.PaperName = text;
    else if (name == "PaperAlias")
        page.PaperAlias = text;
    else if (name == "PaperDisplayName")
        page.PaperDisplayName = text;
    else if (name == "Left")
        page.Left = utils::StrToDoubleC(text);
    else if (name == "Top")
        page.Top = utils::StrToDoubleC(text);
    else if (name == "Right")
        page.Right = utils::StrToDoubleC(text);
    else if (name == "Bottom")
        page.Bottom = utils::StrToDoubleC(text);
    else if (name == "Width")
        page.Width = utils::StrToDoubleC(text);
    else if (name == "Height")
        page.Height = utils::StrToDoubleC(text);
}

int32_t ToMargin(const wxString& text)
{
    // The server's margins are 32-bit; a longer number is narrowed as the
    // record has always done.
    return static_cast<int32_t>(utils::StrToLongC(text));
}

void SetCustomField(stCustomPageSizeAttribute& info, const wxString& name, const wxString& text)
{
    if (name == "MinMediaWidth")
        info.MinMediaWidth = utils::StrToDoubleC(text);
    else if (name == "MaxMediaWidth")
        info.MaxMediaWidth = utils::StrToDoubleC(text);
    else if (name == "MinMediaHeight")
        info.MinMediaHeight = utils::StrToDoubleC(text);
    else if (name == "MaxMediaHeight")
        info.MaxMediaHeight = utils::StrToDoubleC(text);
    else if (name == "LeftHWMargin")
        info.LeftHWMargin = ToMargin(text);
    else if (name == "RightHWMargin")
        info.RightHWMargin = ToMargin(text);
    else if (name == "TopHWMargin")
        info.TopHWMargin = ToMargin(text);
    else if (name == "BottomHWMargin")
        info.BottomHWMargin = ToMargin(text);
    else if (name == "command")
        info.command = text;
    else if (name == "SubstrateHeightToLength")
        info.SubstrateHeightToLength = utils::StrToLongC(text) != 0;
}

bool IsElementWithContent(const wxXmlNode* node)
{
    return node->GetType() == wxXML_ELEMENT_NODE && HasContent(node);
}
} // namespace

bool PluginInitialize::InitializeSheetInfo(const wxString& xml,
                                           std::vector<stPageAttribute>& sheets)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    const wxXmlNode* sheetInfo = FindElement(*document, "SheetInfo");
    if (!sheetInfo)
        return false;

    // One working record for the whole run: the server leaves out fields
    // that repeat, so a group inherits what the group before it set.
    stPageAttribute page;
    for (const wxXmlNode* child = sheetInfo->GetChildren(); child; child = child->GetNext())
    {
        if (!IsElementWithContent(child))
            continue;
        if (child->GetName() == "PSCommand")
        {
            page.PSCommand = TextOf(child);
            sheets.push_back(page);
        }
        else
            SetPageField(page, child->GetName(), TextOf(child));
    }
    return true;
}

bool PluginInitialize::InitializeDefaultSheetInfo(const wxString& xml, stPageAttribute& page)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    const wxXmlNode* defaultPage = FindElement(*document, "DefaultPPDPageSize");
    if (!defaultPage)
        return false;
    for (const wxXmlNode* child = defaultPage->GetChildren(); child; child = child->GetNext())
    {
        if (!IsElementWithContent(child))
            continue;
        if (child->GetName() == "PSCommand")
            page.PSCommand = TextOf(child);
        else
            SetPageField(page, child->GetName(), TextOf(child));
    }
    return true;
}

bool PluginInitialize::InitializeCustomPageSizeInfo(const wxString& xml,
                                                    stCustomPageSizeAttribute& info)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    const wxXmlNode* custom = FindElement(*document, "CustomPageSizeInfo");
    if (!custom)
        return false;
    for (const wxXmlNode* child = custom->GetChildren(); child; child = child->GetNext())
    {
        if (IsElementWithContent(child))
            SetCustomField(info, child->GetName(), TextOf(child));
    }
    return true;
}
