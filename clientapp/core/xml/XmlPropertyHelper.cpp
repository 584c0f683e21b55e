#include "XmlHelper.h"

size_t CXmlPropertyHelper::Count(wxXmlAttribute* first)
{
    size_t count = 0;
    for (wxXmlAttribute* attribute = first; attribute; attribute = attribute->GetNext())
        ++count;
    return count;
}

wxXmlAttribute* CXmlPropertyHelper::Find(wxXmlAttribute* first, const CStdStr<wchar_t>& name)
{
    const wxString wanted = ToWxString(name);
    for (wxXmlAttribute* attribute = first; attribute; attribute = attribute->GetNext())
        if (attribute->GetName() == wanted)
            return attribute;
    return nullptr;
}

wxString CXmlPropertyHelper::ValueAt(wxXmlAttribute* first, size_t index)
{
    wxXmlAttribute* attribute = first;
    for (size_t i = 0; attribute && i < index; ++i)
        attribute = attribute->GetNext();
    return attribute ? attribute->GetValue() : wxString();
}
