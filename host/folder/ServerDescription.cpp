#include "folder/ServerDescription.h"

#include "db/PluginInitialize.h"

#include <wx/ffile.h>
#include <wx/log.h>
#include <wx/sstream.h>
#include <wx/xml/xml.h>

static bool ParseDocument(const wxString& text, wxXmlDocument& document)
{
    wxLogNull quiet; // the host reports the failure in its own words
    wxStringInputStream stream(text);
    return document.Load(stream, "UTF-8") && document.GetRoot();
}

bool ServerDescription::Load(const wxString& path, wxString& error)
{
    wxLogNull quiet;
    wxFFile file;
    wxString text;
    if (!file.Open(path, "rb") || !file.ReadAll(&text, wxConvUTF8))
    {
        error = wxString::Format("cannot read the server description %s", path);
        return false;
    }
    return LoadText(text, path, error);
}

bool ServerDescription::LoadText(const wxString& text, const wxString& origin, wxString& error)
{
    wxXmlDocument document;
    if (text.empty() || !ParseDocument(text, document))
    {
        error = wxString::Format("the server description %s is not well-formed XML", origin);
        return false;
    }
    m_text = text;
    return true;
}

wxArrayString ServerDescription::MissingFeatures(const wxArrayString& required) const
{
    wxArrayString missing;
    for (const wxString& feature : required)
        if (!PluginInitialize::IsFeatureEnabled(m_text, feature))
            missing.Add(feature);
    return missing;
}
