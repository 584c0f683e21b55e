#pragma once
#include <wx/string.h>

class wxSizer;
class wxWindow;

// Assemble a settings panel from the server description: the server's
// papers, custom size limits and units, the views, and the validators.

// The EPS filter's panel: header strip, input file type and, when
// showSettings, the image, page and output sections.
class ImageSizePanelWithoutMerge_Factory
{
public:
    static wxWindow* CreateInstance(wxWindow* parent, const wxString& serverDescription,
                                    const wxString& pluginName, const wxString& extension,
                                    bool showSettings, bool secondFlag);
    static wxSizer* CreateImageSizeView(wxWindow* parent);
};

// Page and output sections only; for filters without image sizing.
class PageSizePanelWithoutMerge_Factory
{
public:
    static wxWindow* CreateInstance(wxWindow* parent, const wxString& serverDescription);
    static wxSizer* CreatePageView(wxWindow* parent);
};

// Output section only.
class OutputFileTypePanelWithoutMerge_Factory
{
public:
    static wxWindow* CreateInstance(wxWindow* parent, const wxString& serverDescription,
                                    const wxString& pluginName, const wxString& extension);
    static wxSizer* CreateOutputFileTypeView(wxWindow* parent);
};
