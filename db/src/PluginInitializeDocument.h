#pragma once
#include <memory>

#include <wx/string.h>
#include <wx/xml/xml.h>

// The parse step that every server query shares.
namespace server_description
{
// A parsed description, or null for an empty text, a parse error or a
// document without root.
std::unique_ptr<wxXmlDocument> Parse(const wxString& xml);

// The first element named name below the root in recursive search order.
wxXmlNode* FindElement(const wxXmlDocument& document, const wxString& name);

// The content of the node's first child; empty when it has none.
wxString TextOf(const wxXmlNode* node);

// Whether the node has a first child at all (text may still be empty).
bool HasContent(const wxXmlNode* node);
} // namespace server_description
