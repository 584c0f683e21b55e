#include "module/FilterSettings.h"

#include <map>
#include <set>

#include <wx/xml/xml.h>

#include "cli/CommandLine.h"
#include "cli/ConsoleText.h"
#include "PageSizeKeys.h"
#include "module/DimensionLimits.h"
#include "module/SettingCatalogue.h"
#include "SettingsKeys.h"

static wxXmlNode* FindChildElement(const wxXmlNode* parent, const wxString& name)
{
    for (wxXmlNode* child = parent->GetChildren(); child; child = child->GetNext())
        if (child->GetType() == wxXML_ELEMENT_NODE && child->GetName() == name)
            return child;
    return nullptr;
}

SettingList ReadFilterSettings(const wxXmlNode* filter)
{
    SettingList settings;
    const wxXmlNode* ui = filter ? FindChildElement(filter, "UI") : nullptr;
    if (!ui)
        return settings;
    for (const wxXmlNode* key = ui->GetChildren(); key; key = key->GetNext())
        if (key->GetType() == wxXML_ELEMENT_NODE)
            settings.emplace_back(key->GetName(), key->GetNodeContent());
    return settings;
}

void WriteFilterSetting(wxXmlNode* filter, const wxString& key, const wxString& value)
{
    wxXmlNode* ui = FindChildElement(filter, "UI");
    if (!ui)
    {
        ui = new wxXmlNode(wxXML_ELEMENT_NODE, "UI");
        filter->AddChild(ui);
    }
    wxXmlNode* element = FindChildElement(ui, key);
    if (!element)
    {
        element = new wxXmlNode(wxXML_ELEMENT_NODE, key);
        ui->AddChild(element);
    }
    while (wxXmlNode* child = element->GetChildren())
    {
        element->RemoveChild(child);
        delete child;
    }
    // Same shape as the filter's own SavePreference: one text node.
    if (!value.empty())
        element->AddChild(new wxXmlNode(wxXML_TEXT_NODE, "text", value));
}

static const stPageAttribute* FindPaper(const std::vector<stPageAttribute>& sheets,
                                        const wxString& name)
{
    if (const stPageAttribute* sheet = FindSheetByPaperName(sheets, name))
        return sheet;
    return FindSheetByDisplayName(sheets, name);
}

static wxString PaperNames(const std::vector<stPageAttribute>& sheets)
{
    wxString names;
    for (const stPageAttribute& sheet : sheets)
        names << (names.empty() ? "" : ", ") << sheet.PaperName;
    return names;
}

bool ApplySettingAssignments(wxXmlNode* filter, const std::vector<std::string>& assignments,
                             const std::vector<stPageAttribute>& sheets, wxString& error,
                             std::set<wxString>* changedKeys)
{
    std::vector<std::pair<wxString, wxString>> explicitValues;
    std::set<wxString> changed;
    const stPageAttribute* paper = nullptr;
    for (const std::string& assignment : assignments)
    {
        std::string rawKey, rawValue;
        if (!SplitAssignment(assignment, rawKey, rawValue))
        {
            error = wxString::Format("\"%s\" is not KEY=VALUE", FromUtf8(assignment));
            return false;
        }
        wxString key = FromUtf8(rawKey), stored;
        if (!NormaliseSettingValue(key, FromUtf8(rawValue), stored, error))
            return false;
        if (key == SettingsKeys::DEFAULTPAGESIZE && !sheets.empty())
        {
            paper = FindPaper(sheets, stored);
            if (!paper)
            {
                error = wxString::Format("the server offers no paper \"%s\" (papers: %s)", stored,
                                         PaperNames(sheets));
                return false;
            }
            stored = paper->PaperName;
        }
        explicitValues.emplace_back(key, stored);
        changed.insert(key);
    }
    // Written to a copy first: a dimension is checked against its unit as
    // both will be stored, and a refusal must leave the settings untouched.
    wxXmlNode updated(*filter);
    if (paper)
    {
        MapPropToValue pageKeys;
        WriteSheetPageKeys(pageKeys, *paper);
        pageKeys[SettingsKeys::CUSTOMPAGESIZE] = FormatSettingFlag(false);
        for (const auto& entry : pageKeys)
            WriteFilterSetting(&updated, entry.first, entry.second);
    }
    for (const auto& entry : explicitValues)
        WriteFilterSetting(&updated, entry.first, entry.second);
    if (!CheckImageDimensions(ReadFilterSettings(&updated), changed, error))
        return false;
    *filter = updated;
    if (changedKeys)
        *changedKeys = changed;
    return true;
}
