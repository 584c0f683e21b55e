#pragma once
#include <vector>

#include <hotfolder/MapPropToValue.h>

#include "Units.h"
#include "db/PageAttributes.h"

// The page description the converter reads, written from the chosen sheet or
// custom size. Numbers always carry "." whatever the locale.

// First sheet whose display name (or paper name) equals the text
// case-sensitively; null when none does.
const stPageAttribute* FindSheetByDisplayName(const std::vector<stPageAttribute>& sheets,
                                              const wxString& displayName);
const stPageAttribute* FindSheetByPaperName(const std::vector<stPageAttribute>& sheets,
                                            const wxString& paperName);

// Forced page size, imageable box and command of a server sheet.
void WriteSheetPageKeys(MapPropToValue& settings, const stPageAttribute& sheet);

// The same for a custom size in points, inside the server's hardware margins.
void WriteCustomPageKeys(MapPropToValue& settings, double widthPoints, double heightPoints,
                         const stCustomPageSizeAttribute& custom, Unit_t unit);

// Paper list entry of a custom size given in `unit`: "8.50in x 11.00in".
wxString CustomPageEntryText(double width, double height, Unit_t unit);
