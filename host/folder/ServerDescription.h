#pragma once
#include <wx/arrstr.h>
#include <wx/string.h>

// The print server's capability description, kept as the XML text the filter
// receives. The host only checks that it is well-formed and which required
// features it offers; the filter runs the real queries.
class ServerDescription
{
public:
    // False with a one-line reason when the file cannot be read or is not
    // well-formed XML with a root element.
    bool Load(const wxString& path, wxString& error);
    bool LoadText(const wxString& text, const wxString& origin, wxString& error);

    const wxString& GetText() const { return m_text; }
    bool IsEmpty() const { return m_text.empty(); }

    // Features of the list whose element is missing or not switched on.
    wxArrayString MissingFeatures(const wxArrayString& required) const;

private:
    wxString m_text;
};
