#pragma once
#include <wx/string.h>
#include <wx/xml/xml.h>

namespace db
{
// The filters' stored settings: a copy of the "FilterSetting" element. Each
// filter has a child "Filter" (attribute "name", e.g. "Orv.EPS.1") holding a
// "UI" element with one child per settings key whose text is the value.
class FilterConfiguration
{
public:
    const wxXmlNode& GetFilterSettingNode() const { return m_FilterSettingNode; }
    void SetFilterSettingNode(const wxXmlNode& node) { m_FilterSettingNode = node; }

    // The output format the named filter produces with its stored settings,
    // or defaultFormat for filters whose output format is fixed.
    wxString GetOutputFormatForFilter(const wxString& filter, const wxString& defaultFormat) const;

private:
    // wxXmlNode() leaves the node type unset; an empty element reads as "no node".
    wxXmlNode m_FilterSettingNode{wxXML_ELEMENT_NODE, wxString()};
};
} // namespace db
