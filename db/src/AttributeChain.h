#pragma once
// Internal: reading the root attributes of the store's files as a chain.
// Each key is taken in a fixed order only while all earlier ones were
// present, so that a file from an older writer, which lacks the later keys,
// loads its leading part and leaves the rest of the target as it was.
#include <cstddef>

#include <wx/string.h>

#include "XmlHelper.h"

namespace db
{
template <typename Target> struct AttributeLink
{
    const char* key;
    void (*apply)(Target& target, const wxString& text);
    // An absent key is passed over instead of ending the chain.
    bool mayBeAbsent = false;
};

// Applies the links to the element's attributes in table order and returns
// the table position of the missing key that ended the chain (the table's
// size when none did). With duplicate attribute names the first counts.
template <typename Target, size_t N>
size_t ReadAttributeChain(wxXmlNode* element, const AttributeLink<Target> (&links)[N],
                          Target& target)
{
    WxStrAttributeMap attributes;
    CXmlNodeHelper::Read(element, attributes);
    for (size_t i = 0; i < N; ++i)
    {
        const auto found = attributes.find(links[i].key);
        if (found != attributes.end())
            links[i].apply(target, found->second);
        else if (!links[i].mayBeAbsent)
            return i;
    }
    return N;
}

// The class whose setter Set is.
template <typename Setter> struct SetterClass;
template <typename Target, typename Value> struct SetterClass<void (Target::*)(Value)>
{
    using Type = Target;
};

// Codecs bound to a setter of the target, for the links' apply.
template <auto Set>
void AsText(typename SetterClass<decltype(Set)>::Type& target, const wxString& text)
{
    (target.*Set)(text);
}

// A flag is on exactly when its text is "1".
template <auto Set>
void AsOneFlag(typename SetterClass<decltype(Set)>::Type& target, const wxString& text)
{
    (target.*Set)(text == "1");
}
} // namespace db
