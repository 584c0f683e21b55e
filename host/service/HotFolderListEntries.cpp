#include "service/HotFolderListEntries.h"

#include <wx/filename.h>
#include <wx/log.h>
#include <wx/xml/xml.h>

#include "db/PathResolver.h"

wxString HotFolderListFile()
{
    return wxFileName(db::PathResolver::GetWarehousePath(), "HotFolderList", "cfg").GetFullPath();
}

static void CollectEntries(const wxXmlNode* node, std::vector<wxString>& paths)
{
    for (const wxXmlNode* child = node->GetChildren(); child; child = child->GetNext())
    {
        if (child->GetType() != wxXML_ELEMENT_NODE)
            continue;
        if (child->GetName() == "HotFolder")
        {
            const wxString path = child->GetAttribute("path");
            bool seen = path.empty();
            for (const wxString& earlier : paths)
                seen = seen || wxFileName::DirName(earlier).SameAs(wxFileName::DirName(path));
            if (!seen)
                paths.push_back(path);
        }
        CollectEntries(child, paths);
    }
}

std::vector<wxString> ReadHotFolderListEntries()
{
    std::vector<wxString> paths;
    const wxString file = HotFolderListFile();
    if (!wxFileName::FileExists(file))
        return paths;
    wxLogNull quiet; // a list being replaced right now is read again on its event
    wxXmlDocument document;
    if (document.Load(file, "UTF-8") && document.GetRoot())
        CollectEntries(document.GetRoot(), paths);
    return paths;
}

wxString FindHotFolderListEntry(const wxString& path)
{
    wxFileName wanted = wxFileName::DirName(path);
    wanted.MakeAbsolute();
    for (const wxString& entry : ReadHotFolderListEntries())
        if (wxFileName::DirName(entry).SameAs(wanted))
            return entry;
    return wxString();
}
