#include "utils/Config.h"

#include <cstdlib>
#include <memory>
#include <unistd.h>

#include <wx/filename.h>
#include <wx/xml/xml.h>

#include "XmlHelper.h"
#include "posix/ExecutablePath.h"
#include "utils/CLocaleNumbers.h"

namespace
{
wxString ExecutablePath()
{
    const std::string program = posix::ExecutablePath();
    return wxString::FromUTF8(program.data(), program.size());
}
} // namespace

namespace utils
{
Config& Config::GetInstance()
{
    static Config instance;
    return instance;
}

wxString Config::GetResourcesDirectory()
{
    const char* overridden = std::getenv("HOTFOLDER_RESOURCES_DIR");
    if (overridden && *overridden)
        return wxString::FromUTF8(overridden);
    // <prefix>/bin/program -> <prefix>/Resources, as Contents/MacOS and
    // Contents/Resources stand in an application bundle.
    wxFileName directory = wxFileName(ExecutablePath()).GetPath();
    wxFileName resources = wxFileName::DirName(directory.GetPath());
    resources.AppendDir("Resources");
    return resources.GetPath();
}

wxString Config::GetConfigFilePath()
{
    return wxFileName(GetResourcesDirectory(), "HFConfig", "cfg").GetFullPath();
}

bool Config::Initialize()
{
    const wxString path = GetConfigFilePath();
    if (!wxFileName::FileExists(path))
        return false;
    std::unique_ptr<wxXmlDocument> document(
        CXmlDocumentHelper::Load(ToStdStr(path), CStdStr<wchar_t>(L"UTF-8")));
    if (!document || !document->GetRoot())
        return false;
    wxXmlNode* root = document->GetRoot();

    if (wxXmlNode* entries = CXmlNodeHelper::Find(root, "HFConfiguration", true))
    {
        for (wxXmlNode* child = entries->GetChildren(); child; child = child->GetNext())
        {
            if (child->GetType() != wxXML_ELEMENT_NODE ||
                CXmlPropertyHelper::Count(child->GetAttributes()) < 2)
                continue;
            AddKey(CXmlPropertyHelper::ValueAt(child->GetAttributes(), 0),
                   CXmlPropertyHelper::ValueAt(child->GetAttributes(), 1));
        }
    }

    m_displayKeys.clear();
    m_displayNames.clear();
    if (wxXmlNode* display = CXmlNodeHelper::Find(root, "JPDisplayKeys", true))
    {
        for (wxXmlNode* child = display->GetChildren(); child; child = child->GetNext())
        {
            if (child->GetType() != wxXML_ELEMENT_NODE)
                continue;
            wxXmlAttribute* attributes = child->GetAttributes();
            const size_t count = CXmlPropertyHelper::Count(attributes);
            if (count >= 1)
                m_displayKeys.push_back(CXmlPropertyHelper::ValueAt(attributes, 0));
            if (count >= 2)
                m_displayNames.push_back(CXmlPropertyHelper::ValueAt(attributes, 1));
        }
    }
    return true;
}

void Config::AddKey(const wxString& key, const wxString& value)
{
    m_values.emplace(key, value);
}

bool Config::GetKey(const wxString& key, wxString& value) const
{
    const auto found = m_values.find(key);
    if (found == m_values.end())
        return false;
    value = found->second;
    return true;
}

void Config::GetJPDisplayKeys(wxArrayString& keys, wxArrayString& displayNames) const
{
    keys = m_displayKeys;
    displayNames = m_displayNames;
}

bool Config::ReadString(const wxString& key, wxString& value)
{
    return GetInstance().GetKey(key, value);
}

long Config::ReadLong(const wxString& key, long /*defaultValue*/)
{
    wxString value;
    if (!ReadString(key, value))
        return 1;
    return StrToLongC(value);
}
} // namespace utils
