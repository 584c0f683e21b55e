// Operations whose engines land separately answer their neutral values
// until then.
#include "EPS.h"

long EPS::Initialize(const wxString&) { return m_lStatus = 0; }
long EPS::InitilaizeFromPreference(wxXmlNode*) { return m_lStatus = 0; }
wxWindow* EPS::ShowPluginUI(wxWindow*) { return nullptr; }
long EPS::SniffFiles(const wxArrayString&, wxArrayString& second, wxArrayString&, JobInfoCollection&)
{
    second.Empty();
    return m_lStatus = 0;
}
long EPS::SniffFolder(const wxString&, wxArrayString&, JobInfoCollection&, FolderContent*&) { return m_lStatus = 0; }
long EPS::SniffFolder(const wxString&, wxArrayString&, JobInfoCollection&) { return m_lStatus = 0; }
long EPS::Process(const wxString&, const ReadyToProcessJobInfo&, const wxString&, wxString&, IProgressTracker*) { return m_lStatus = -1003; }
long EPS::SavePreference(wxXmlNode*) { return 0; }
long EPS::LoadPreference(wxXmlNode*) { return m_lStatus = 0; }
void EPS::LoadEPSParams() {}
bool EPS::WriteJobOverrides(wxString) { return true; }
bool EPS::IsPPMLFolder(const wxString&) { return false; }
