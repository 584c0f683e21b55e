#include "PluginInitializeDocument.h"

#include <wx/log.h>
#include <wx/sstream.h>

#include "XmlHelper.h"

namespace server_description
{
std::unique_ptr<wxXmlDocument> Parse(const wxString& xml)
{
    if (xml.empty())
        return nullptr;
    // A malformed description is an ordinary "no" answer, not something to
    // show the user in a log window.
    wxLogNull quiet;
    wxStringInputStream stream(xml);
    auto document = std::make_unique<wxXmlDocument>();
    if (!document->Load(stream, "UTF-8") || !document->GetRoot())
        return nullptr;
    return document;
}

wxXmlNode* FindElement(const wxXmlDocument& document, const wxString& name)
{
    return CXmlNodeHelper::Find(document.GetRoot(), name, true);
}

wxString TextOf(const wxXmlNode* node)
{
    const wxXmlNode* first = node ? node->GetChildren() : nullptr;
    return first ? first->GetContent() : wxString();
}

bool HasContent(const wxXmlNode* node)
{
    return node && node->GetChildren();
}
} // namespace server_description
