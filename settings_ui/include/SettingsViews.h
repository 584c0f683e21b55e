#pragma once
#include <wx/string.h>

class wxSizer;
class wxWindow;

// Builders of the settings sections. Each creates its controls as children
// of `parent` (the panel whose members they are bound to) and returns the
// sizer that lays them out. The two flags are part of the shared builder
// signature; the EPS views do not use them.

// "EPS" or "PS".
wxSizer* CreateOutputFileTypeWithoutDistillMergeViewForEPS(wxWindow* parent, bool, bool);
// "PS" or "PDF", for the other filters.
wxSizer* CreateOutputFileTypeWithoutMergeView(wxWindow* parent, bool, bool);
// Paper, custom size button and image position.
wxSizer* CreatePageViewEPS(wxWindow* parent, bool, bool);
// Original, custom or automatic image size.
wxSizer* CreateImageSizeView(wxWindow* parent, bool, bool);
// The file type this filter accepts.
wxSizer* CreateInputFileTypeView(wxWindow* parent, bool, bool, const wxString& extension);
