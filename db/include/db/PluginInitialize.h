#pragma once
#include <vector>

#include <wx/string.h>

#include "db/PageAttributes.h"

// Queries on the print server's capability description, an XML document
// handed over as text. Every query parses the whole text again and looks
// its element up by name at any depth; the first element in search order
// wins. Every query is false for an empty text or one that does not parse;
// outputs are only written when the element is found.
class PluginInitialize
{
public:
    // Appends one record per "PSCommand"-closed group under "SheetInfo".
    // Fields a group leaves out keep the previous group's values.
    static bool InitializeSheetInfo(const wxString& xml, std::vector<stPageAttribute>& sheets);
    // The "DefaultPPDPageSize" group, written straight into page.
    static bool InitializeDefaultSheetInfo(const wxString& xml, stPageAttribute& page);
    static bool InitializeCustomPageSizeInfo(const wxString& xml, stCustomPageSizeAttribute& info);

    // These three answer true for any parsed document and set their output
    // only when the element exists.
    static bool InitializeResolution(const wxString& xml, int& dpi);
    static bool InitializePreferenceUnit(const wxString& xml, wxString& unit);
    static bool InitializeOSUnit(const wxString& xml, wxString& unit);
    static bool InitializeDecimalSeparator(const wxString& xml, wxString& separator);

    // Strict flags: the text must be exactly "yes", "1" or "true".
    static bool IsServerGA2Enabled(const wxString& xml);
    static bool IsServerGA1Enabled(const wxString& xml);
    static bool IsServerXRXEnabled(const wxString& xml);
    static bool IsServerVDPEnabled(const wxString& xml);
    static bool IsServerOneBitTiffEnabled(const wxString& xml);

    // "OEMName" is "XEROX" in any case.
    static bool IsXeroxServer(const wxString& xml);
    // Loose flag: "yes", "1", "2", "true" or "on" in any case. Kept apart
    // from the strict test on purpose: servers answer both ways.
    static bool IsFeatureEnabled(const wxString& xml, const wxString& name);
    // "ServerVersion" parsed like strtol is at least required.
    static bool IsRequiredServerVersion(const wxString& xml, const int& required);

    // Option searches: the first child of the option element whose name,
    // without the maker prefix "Orv", is the wanted option sets option and
    // value. True whenever the option element exists.
    static bool InitializeEngineScreenInfo(const wxString& xml, wxString& option, wxString& value);
    static bool InitializeImageCompressionInfo(const wxString& xml, wxString& option,
                                               wxString& value);
    static bool InitializeResolutionInfo(const wxString& xml, wxString& option, wxString& value);
};
