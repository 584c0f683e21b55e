#include "XmlHelper.h"

namespace
{
bool IsElementNamed(const wxXmlNode* node, const wxString& name)
{
    return node->GetType() == wxXML_ELEMENT_NODE && node->GetName() == name;
}

// Both map flavours share one implementation; only the string conversion differs.
wxString ToWx(const wxString& text)
{
    return text;
}
wxString ToWx(const CStdStr<wchar_t>& text)
{
    return ToWxString(text);
}
template <typename Map> typename Map::key_type FromWx(const wxString& text);
template <> wxString FromWx<WxStrAttributeMap>(const wxString& text)
{
    return text;
}
template <> CStdStr<wchar_t> FromWx<StdStrAttributeMap>(const wxString& text)
{
    return ToStdStr(text);
}

template <typename Map> bool InsertAll(wxXmlNode* node, const Map& attributes)
{
    if (!node || attributes.empty())
        return false;
    for (const auto& entry : attributes)
        node->AddAttribute(ToWx(entry.first), ToWx(entry.second));
    return true;
}

template <typename Map> bool UpdateAll(wxXmlNode* node, const Map& attributes)
{
    if (!node || attributes.empty())
        return false;
    Map remaining(attributes);
    // Relink the surviving attributes in their order; drop the rest.
    wxXmlAttribute* kept = nullptr;
    wxXmlAttribute* last = nullptr;
    wxXmlAttribute* attribute = node->GetAttributes();
    while (attribute)
    {
        wxXmlAttribute* next = attribute->GetNext();
        attribute->SetNext(nullptr);
        auto found = remaining.find(FromWx<Map>(attribute->GetName()));
        if (found == remaining.end())
        {
            delete attribute;
        }
        else
        {
            attribute->SetValue(ToWx(found->second));
            remaining.erase(found);
            if (last)
                last->SetNext(attribute);
            else
                kept = attribute;
            last = attribute;
        }
        attribute = next;
    }
    node->SetAttributes(kept);
    for (const auto& entry : remaining)
        node->AddAttribute(ToWx(entry.first), ToWx(entry.second));
    return true;
}

template <typename Map> void ReadAll(wxXmlNode* node, Map& attributes)
{
    if (!node)
        return;
    for (wxXmlAttribute* attribute = node->GetAttributes(); attribute;
         attribute = attribute->GetNext())
        attributes.emplace(FromWx<Map>(attribute->GetName()), FromWx<Map>(attribute->GetValue()));
}

template <typename Map> void ReadSubNodes(wxXmlNode* node, Map& properties)
{
    if (!node)
        return;
    for (wxXmlNode* child = node->GetChildren(); child; child = child->GetNext())
    {
        const wxXmlAttribute* first = child->GetAttributes();
        properties.emplace(FromWx<Map>(child->GetName()),
                           FromWx<Map>(first ? first->GetValue() : wxString()));
    }
}

template <typename Map> void WriteSubNodes(wxXmlNode* node, const Map& properties)
{
    if (!node)
        return;
    for (const auto& entry : properties)
    {
        wxXmlNode* child = new wxXmlNode(wxXML_ELEMENT_NODE, ToWx(entry.first));
        if (!entry.second.empty())
            child->AddAttribute("value", ToWx(entry.second));
        node->AddChild(child);
    }
}
} // namespace

wxXmlNode* CXmlNodeHelper::Find(wxXmlNode* parent, const wxString& name, bool recursive)
{
    if (!parent)
        return nullptr;
    for (wxXmlNode* child = parent->GetChildren(); child; child = child->GetNext())
        if (IsElementNamed(child, name))
            return child;
    if (!recursive)
        return nullptr;
    for (wxXmlNode* child = parent->GetChildren(); child; child = child->GetNext())
    {
        if (child->GetType() != wxXML_ELEMENT_NODE)
            continue;
        if (wxXmlNode* found = Find(child, name, true))
            return found;
    }
    return nullptr;
}

wxXmlNode* CXmlNodeHelper::FindNext(wxXmlNode* node, const wxString& name)
{
    if (!node)
        return nullptr;
    for (wxXmlNode* sibling = node->GetNext(); sibling; sibling = sibling->GetNext())
        if (IsElementNamed(sibling, name))
            return sibling;
    return nullptr;
}

bool CXmlNodeHelper::Insert(wxXmlNode* node, const StdStrAttributeMap& attributes)
{
    return InsertAll(node, attributes);
}

bool CXmlNodeHelper::Insert(wxXmlNode* node, const WxStrAttributeMap& attributes)
{
    return InsertAll(node, attributes);
}

bool CXmlNodeHelper::Update(wxXmlNode* node, const StdStrAttributeMap& attributes)
{
    return UpdateAll(node, attributes);
}

bool CXmlNodeHelper::Update(wxXmlNode* node, const WxStrAttributeMap& attributes)
{
    return UpdateAll(node, attributes);
}

void CXmlNodeHelper::Read(wxXmlNode* node, StdStrAttributeMap& attributes)
{
    ReadAll(node, attributes);
}

void CXmlNodeHelper::Read(wxXmlNode* node, WxStrAttributeMap& attributes)
{
    ReadAll(node, attributes);
}

void CXmlNodeHelper::GetSubNodesAsProperty(wxXmlNode* node, StdStrAttributeMap& properties)
{
    ReadSubNodes(node, properties);
}

void CXmlNodeHelper::GetSubNodesAsProperty(wxXmlNode* node, WxStrAttributeMap& properties)
{
    ReadSubNodes(node, properties);
}

void CXmlNodeHelper::SetPropertyAsSubNode(wxXmlNode* node, const StdStrAttributeMap& properties)
{
    WriteSubNodes(node, properties);
}

void CXmlNodeHelper::SetPropertyAsSubNode(wxXmlNode* node, const WxStrAttributeMap& properties)
{
    WriteSubNodes(node, properties);
}

void CXmlNodeHelper::RemoveChildren(wxXmlNode* node)
{
    if (!node)
        return;
    wxXmlNode* child = node->GetChildren();
    node->SetChildren(nullptr);
    while (child)
    {
        wxXmlNode* next = child->GetNext();
        delete child; // deletes the child's own subtree, not its siblings
        child = next;
    }
}

void CXmlNodeHelper::RemoveProperties() {}
