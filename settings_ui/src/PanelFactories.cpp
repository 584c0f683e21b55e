#include "PanelFactories.h"

#include <vector>

#include <wx/sizer.h>

#include "CWndDCPluginNamePanel.h"
#include "ImageSizePanelWithoutMerge.h"
#include "SettingsViews.h"
#include "db/PluginInitialize.h"

namespace
{
void AddHeaderAndInputViews(wxWindow* panel, wxSizer* sizer, const wxString& pluginName,
                            const wxString& extension)
{
    auto* header = new CWndDCPluginNamePanel(panel, wxID_ANY);
    header->SetName(pluginName);
    sizer->Add(header, 0, wxEXPAND, 0);
    sizer->Add(CreateInputFileTypeView(panel, false, false, extension), 0, wxEXPAND | wxALL, 5);
}

const int kSectionFlags = wxEXPAND | wxLEFT | wxRIGHT;
} // namespace

wxWindow* ImageSizePanelWithoutMerge_Factory::CreateInstance(wxWindow* parent,
                                                             const wxString& serverDescription,
                                                             const wxString& pluginName,
                                                             const wxString& extension,
                                                             bool showSettings, bool secondFlag)
{
    std::vector<stPageAttribute> sheets;
    PluginInitialize::InitializeSheetInfo(serverDescription, sheets);
    stCustomPageSizeAttribute custom;
    PluginInitialize::InitializeCustomPageSizeInfo(serverDescription, custom);
    wxArrayString names;
    for (const auto& sheet : sheets)
        names.Add(sheet.PaperDisplayName);
    wxString preferredUnit, systemUnit;
    PluginInitialize::InitializePreferenceUnit(serverDescription, preferredUnit);
    PluginInitialize::InitializeOSUnit(serverDescription, systemUnit);

    auto* panel = new ImageSizePanelWithoutMerge(parent, showSettings, secondFlag);
    panel->SetMeasurementUnit(preferredUnit, systemUnit);
    panel->SetPageSizeArray(names);
    panel->SetPageAttributes(sheets);
    panel->SetCustomPageAttributes(custom);

    auto* sizer = new wxBoxSizer(wxVERTICAL);
    AddHeaderAndInputViews(panel, sizer, pluginName, extension);
    if (showSettings)
    {
        sizer->Add(::CreateImageSizeView(panel, false, false), 0, kSectionFlags, 5);
        sizer->Add(CreatePageViewEPS(panel, false, false), 0, kSectionFlags, 5);
        sizer->Add(pluginName.IsSameAs("EPS", false)
                       ? CreateOutputFileTypeWithoutDistillMergeViewForEPS(panel, false, false)
                       : CreateOutputFileTypeWithoutMergeView(panel, false, false),
                   0, kSectionFlags | wxBOTTOM, 5);
    }
    panel->SetSizer(sizer);
    sizer->SetSizeHints(panel);
    panel->InitializeControls();
    // The paper list knows its names only now.
    sizer->SetSizeHints(panel);
    panel->TransferDataToWindow();
    return panel;
}

wxSizer* ImageSizePanelWithoutMerge_Factory::CreateImageSizeView(wxWindow* parent)
{
    return ::CreateImageSizeView(parent, false, false);
}

wxWindow* PageSizePanelWithoutMerge_Factory::CreateInstance(wxWindow* parent,
                                                            const wxString& serverDescription)
{
    std::vector<stPageAttribute> sheets;
    PluginInitialize::InitializeSheetInfo(serverDescription, sheets);
    wxArrayString names;
    for (const auto& sheet : sheets)
        names.Add(sheet.PaperDisplayName);

    auto* panel = new PageSizePanelWithoutMerge(parent, true, true);
    panel->SetPageSizeArray(names);
    panel->SetPageAttributes(sheets);
    auto* sizer = new wxBoxSizer(wxVERTICAL);
    sizer->Add(CreatePageViewEPS(panel, false, false), 0, kSectionFlags, 5);
    sizer->Add(CreateOutputFileTypeWithoutMergeView(panel, false, false), 0, kSectionFlags, 5);
    panel->SetSizer(sizer);
    sizer->SetSizeHints(panel);
    panel->InitializeControls();
    return panel;
}

wxSizer* PageSizePanelWithoutMerge_Factory::CreatePageView(wxWindow* parent)
{
    return CreatePageViewEPS(parent, false, false);
}

wxWindow* OutputFileTypePanelWithoutMerge_Factory::CreateInstance(wxWindow* parent, const wxString&,
                                                                  const wxString& pluginName,
                                                                  const wxString& extension)
{
    auto* panel = new OutputFileTypePanelWithoutMerge(parent, true, true);
    auto* sizer = new wxBoxSizer(wxVERTICAL);
    AddHeaderAndInputViews(panel, sizer, pluginName, extension);
    sizer->Add(CreateOutputFileTypeWithoutMergeView(panel, false, false), 0, wxEXPAND | wxALL, 5);
    panel->SetSizer(sizer);
    sizer->SetSizeHints(panel);
    panel->InitializeControls();
    return panel;
}

wxSizer* OutputFileTypePanelWithoutMerge_Factory::CreateOutputFileTypeView(wxWindow* parent)
{
    return CreateOutputFileTypeWithoutMergeView(parent, false, false);
}
