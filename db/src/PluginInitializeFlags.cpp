// Feature flags, maker and version of the server description.
#include "db/PluginInitialize.h"

#include "PluginInitializeDocument.h"
#include "utils/CLocaleNumbers.h"

using server_description::FindElement;
using server_description::HasContent;
using server_description::Parse;
using server_description::TextOf;

namespace
{
// The older server flags: exact, case-sensitive words only.
bool IsStrictFlagOn(const wxString& xml, const wxString& name)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    const wxXmlNode* flag = FindElement(*document, name);
    if (!flag)
        return false;
    const wxString text = TextOf(flag);
    return text == "yes" || text == "1" || text == "true";
}
} // namespace

bool PluginInitialize::IsServerGA2Enabled(const wxString& xml)
{
    return IsStrictFlagOn(xml, "GA2_HOTFOLDERS");
}

bool PluginInitialize::IsServerGA1Enabled(const wxString& xml)
{
    return IsStrictFlagOn(xml, "GA_FEATURE_SET");
}

bool PluginInitialize::IsServerXRXEnabled(const wxString& xml)
{
    return IsStrictFlagOn(xml, "HF_XRX_FILTER");
}

bool PluginInitialize::IsServerVDPEnabled(const wxString& xml)
{
    return IsStrictFlagOn(xml, "ppmlsupport");
}

bool PluginInitialize::IsServerOneBitTiffEnabled(const wxString& xml)
{
    return IsStrictFlagOn(xml, "HF_ONE_BIT_TIFF_FILTER");
}

bool PluginInitialize::IsXeroxServer(const wxString& xml)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    const wxXmlNode* maker = FindElement(*document, "OEMName");
    return maker && TextOf(maker).CmpNoCase("XEROX") == 0;
}

bool PluginInitialize::IsFeatureEnabled(const wxString& xml, const wxString& name)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    const wxXmlNode* flag = FindElement(*document, name);
    if (!HasContent(flag))
        return false;
    const wxString text = TextOf(flag).Lower();
    return text == "yes" || text == "1" || text == "2" || text == "true" || text == "on";
}

bool PluginInitialize::IsRequiredServerVersion(const wxString& xml, const int& required)
{
    const auto document = Parse(xml);
    if (!document)
        return false;
    const wxXmlNode* version = FindElement(*document, "ServerVersion");
    if (!HasContent(version))
        return false;
    return utils::StrToLongC(TextOf(version)) >= required;
}
