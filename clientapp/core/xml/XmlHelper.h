#pragma once
#include <map>

#include <wx/string.h>
#include <wx/xml/xml.h>

#include "StdString.h"

// Attribute maps in the two flavours the client code uses. Both order keys
// by plain code-point comparison.
using StdStrAttributeMap = std::map<CStdStr<wchar_t>, CStdStr<wchar_t>>;
using WxStrAttributeMap = std::map<wxString, wxString>;

// Stateless helpers over wxXmlNode trees. Only element nodes take part in
// searches; text, comment and other nodes are skipped.
class CXmlNodeHelper
{
public:
    // First element child of parent named name (case-sensitive). With
    // recursive, when no direct child matches, each element child is searched
    // the same way in document order: a direct match always beats a deeper one.
    static wxXmlNode* Find(wxXmlNode* parent, const wxString& name, bool recursive = false);

    // First later sibling of node that is an element named name.
    static wxXmlNode* FindNext(wxXmlNode* node, const wxString& name);

    // Adds every entry as an attribute, in key order. False for an empty map.
    static bool Insert(wxXmlNode* node, const StdStrAttributeMap& attributes);
    static bool Insert(wxXmlNode* node, const WxStrAttributeMap& attributes);

    // Makes the node's attributes equal the map: surviving attributes keep
    // their place, new ones are appended in key order. False for an empty map.
    static bool Update(wxXmlNode* node, const StdStrAttributeMap& attributes);
    static bool Update(wxXmlNode* node, const WxStrAttributeMap& attributes);

    // Adds every attribute (name to value); existing keys are kept, so with
    // duplicate attribute names the first wins.
    static void Read(wxXmlNode* node, StdStrAttributeMap& attributes);
    static void Read(wxXmlNode* node, WxStrAttributeMap& attributes);

    // Child name to the value of the child's first attribute ("" without one).
    static void GetSubNodesAsProperty(wxXmlNode* node, StdStrAttributeMap& properties);
    static void GetSubNodesAsProperty(wxXmlNode* node, WxStrAttributeMap& properties);

    // One child element per entry, named as the key, with attribute "value"
    // unless the value is empty.
    static void SetPropertyAsSubNode(wxXmlNode* node, const StdStrAttributeMap& properties);
    static void SetPropertyAsSubNode(wxXmlNode* node, const WxStrAttributeMap& properties);

    // Deletes every child of node.
    static void RemoveChildren(wxXmlNode* node);

    // Kept for the older callers; does nothing.
    static void RemoveProperties();
};

class CXmlPropertyHelper
{
public:
    // Attributes in the list starting at first; 0 for null.
    static size_t Count(wxXmlAttribute* first);

    // First attribute of the list named exactly name, or null.
    static wxXmlAttribute* Find(wxXmlAttribute* first, const CStdStr<wchar_t>& name);

    // Value of the index-th attribute of the list (from 0), or "" when the
    // list is shorter. For files whose entries are read by position, not by
    // attribute name.
    static wxString ValueAt(wxXmlAttribute* first, size_t index);
};

class CXmlDocumentHelper
{
public:
    // A new document owned by the caller, or null. A missing file is not an
    // error; a file that does not parse is logged at error level.
    static wxXmlDocument* Load(const CStdStr<wchar_t>& path, const CStdStr<wchar_t>& encoding);
};

// Conversions between the two string flavours.
inline wxString ToWxString(const CStdStr<wchar_t>& text)
{
    return wxString(text.c_str());
}
inline CStdStr<wchar_t> ToStdStr(const wxString& text)
{
    return CStdStr<wchar_t>(text.ToStdWstring());
}
