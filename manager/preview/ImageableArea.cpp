// The imageable area of a folder's page: the paper its settings name, as the
// folder's stored server description offers it.
#include <wx/filename.h>
#include <wx/xml/xml.h>

#include "PageSizeKeys.h"
#include "SettingsKeys.h"
#include "folder/HotFolder.h"
#include "folder/ServerDescription.h"
#include "folder/ServerPapers.h"
#include "module/FilterSettings.h"
#include "preview/PagePreview.h"

namespace
{
// The folder's filter settings: those of the first "Filter" element stored.
SettingList StoredSettings(const HotFolder& folder)
{
    for (const wxXmlNode* child = folder.GetFilterSetting().GetChildren(); child;
         child = child->GetNext())
        if (child->GetType() == wxXML_ELEMENT_NODE && child->GetName() == "Filter")
            return ReadFilterSettings(child);
    return SettingList();
}

wxString ValueOf(const SettingList& settings, const wxString& key)
{
    for (const auto& setting : settings)
        if (setting.first == key)
            return setting.second;
    return wxString();
}
} // namespace

PointRect ImageableAreaOf(const wxString& folderPath)
{
    HotFolder folder;
    wxString error;
    if (!folder.Open(folderPath, error) ||
        !wxFileName::FileExists(folder.GetServerDescriptionFile()))
        return PointRect();
    ServerDescription server;
    if (!server.Load(folder.GetServerDescriptionFile(), error))
        return PointRect();
    const SettingList settings = StoredSettings(folder);
    // A custom page has no paper of the server's to tell its area.
    if (IsSettingOn(ValueOf(settings, SettingsKeys::CUSTOMPAGESIZE)))
        return PointRect();
    const wxString paper = ValueOf(settings, SettingsKeys::DEFAULTPAGESIZE).Strip(wxString::both);
    if (paper.empty())
        return PointRect();
    ServerPapers papers;
    papers.Load(server.GetText());
    const stPageAttribute* sheet = FindSheetByPaperName(papers.sheets, paper);
    if (!sheet)
        sheet = FindSheetByDisplayName(papers.sheets, paper);
    if (!sheet)
        return PointRect();
    PointRect area;
    area.x0 = sheet->Left;
    area.y0 = sheet->Top;
    area.x1 = sheet->Right;
    area.y1 = sheet->Bottom;
    return area.IsEmpty() ? PointRect() : area;
}
