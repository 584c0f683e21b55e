#include "db/FilterConfiguration.h"

#include "SettingsKeys.h"
#include "XmlHelper.h"

namespace
{
// Filters whose output format does not depend on their settings.
bool HasFixedOutputFormat(const wxString& filter)
{
    static const char* const fixed[] = {"Orv.JDF.1", "Orv.PDF.1", "Orv.Passthrough.1", "Orv.VDP.1",
                                        "Orv.XRX.1", "Orv.PS.1",  "Orv.FFP.1"};
    for (const char* name : fixed)
        if (filter == name)
            return true;
    return false;
}

wxString TextOf(const wxXmlNode* node)
{
    const wxXmlNode* first = node->GetChildren();
    return first ? first->GetContent() : wxString();
}

bool HasChildWithText(wxXmlNode* parent, const wxString& name, const wxString& text)
{
    for (wxXmlNode* child = CXmlNodeHelper::Find(parent, name); child;
         child = CXmlNodeHelper::FindNext(child, name))
        if (TextOf(child) == text)
            return true;
    return false;
}
} // namespace

namespace db
{
wxString FilterConfiguration::GetOutputFormatForFilter(const wxString& filter,
                                                       const wxString& defaultFormat) const
{
    wxXmlNode settings(m_FilterSettingNode);
    wxString result;
    for (wxXmlNode* node = CXmlNodeHelper::Find(&settings, "Filter", true); node;
         node = CXmlNodeHelper::FindNext(node, "Filter"))
    {
        wxString name = node->GetAttribute("name");
        name.Trim(true);
        if (name != filter)
            continue;
        if (HasFixedOutputFormat(filter))
        {
            result = defaultFormat;
            continue;
        }
        wxXmlNode* ui = CXmlNodeHelper::Find(node, "UI", true);
        if (!ui)
            continue;
        if (filter == "Orv.EPS.1" &&
            HasChildWithText(ui, SettingsKeys::OUTPUTFILETYPEEPS, FormatSettingFlag(true)))
            return "EPS";
        if (filter == "Orv.TIFF.1" &&
            HasChildWithText(ui, "OUTPUTFILETYPETIFF", FormatSettingFlag(true)))
            return "TIFF";
        if (wxXmlNode* ps = CXmlNodeHelper::Find(ui, SettingsKeys::OUTPUTFILETYPEPS))
            return IsSettingOn(TextOf(ps)) ? "PS" : "PDF";
    }
    return result;
}
} // namespace db
