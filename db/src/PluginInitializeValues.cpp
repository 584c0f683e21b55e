// Single values and option searches of the server description.
#include "db/PluginInitialize.h"

#include "PluginInitializeDocument.h"
#include "utils/CLocaleNumbers.h"

using server_description::FindElement;
using server_description::Parse;
using server_description::TextOf;

namespace
{
// True for any parsed document; value is only written when the element
// exists.
bool ReadText(const wxString& xml, const wxString& name, wxString& value)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    if (const wxXmlNode* element = FindElement(*document, name))
        value = TextOf(element);
    return true;
}

bool FindOption(const wxString& xml, const wxString& group, const wxString& wanted,
                wxString& option, wxString& value)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    const wxXmlNode* options = FindElement(*document, group);
    if (!options)
        return false;
    for (const wxXmlNode* child = options->GetChildren(); child; child = child->GetNext())
    {
        if (child->GetType() != wxXML_ELEMENT_NODE)
            continue;
        // The server names options with the maker prefix: "OrvQuality".
        wxString name = child->GetName();
        name.Replace("Orv", "", false);
        if (name == wanted)
        {
            option = name;
            value = TextOf(child);
            break;
        }
    }
    return true;
}
} // namespace

bool PluginInitialize::InitializeResolution(const wxString& xml, int& dpi)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    if (const wxXmlNode* element = FindElement(*document, "Resolution"))
        dpi = static_cast<int>(utils::StrToLongC(TextOf(element)));
    return true;
}

bool PluginInitialize::InitializePreferenceUnit(const wxString& xml, wxString& unit)
{
    return ReadText(xml, "Units", unit);
}

bool PluginInitialize::InitializeOSUnit(const wxString& xml, wxString& unit)
{
    return ReadText(xml, "OSUnit", unit);
}

bool PluginInitialize::InitializeDecimalSeparator(const wxString& xml, wxString& separator)
{
    return ReadText(xml, "DecimalSeparator", separator);
}

bool PluginInitialize::InitializeEngineScreenInfo(const wxString& xml, wxString& option,
                                                  wxString& value)
{
    return FindOption(xml, "RvCopierMode", "ErrorDiffusion", option, value);
}

bool PluginInitialize::InitializeImageCompressionInfo(const wxString& xml, wxString& option,
                                                      wxString& value)
{
    return FindOption(xml, "RvCompRatio", "Quality", option, value);
}

bool PluginInitialize::InitializeResolutionInfo(const wxString& xml, wxString& option,
                                                wxString& value)
{
    return FindOption(xml, "RvResolution", "600x600dpi", option, value);
}
