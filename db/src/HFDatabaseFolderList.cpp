#include "db/HFDatabase.h"

#include <memory>

#include <wx/filename.h>

#include "FileLock.h"
#include "SharedDirectory.h"
#include "XmlHelper.h"
#include "db/AtomicFile.h"
#include "db/PathResolver.h"

namespace db
{
namespace
{
wxString ListFile(const wxString& directory)
{
    return wxFileName(directory, "HotFolderList", "cfg").GetFullPath();
}

// Lives beside the list; the list itself is replaced by rename, so it
// cannot carry the lock.
wxString LockFile(const wxString& directory)
{
    return wxFileName(directory, "HotFolderList.cfg.lock").GetFullPath();
}

std::unique_ptr<wxXmlDocument> LoadList(const wxString& file)
{
    std::unique_ptr<wxXmlDocument> document(CXmlDocumentHelper::Load(ToStdStr(file), L"UTF-8"));
    if (!document || !document->GetRoot())
        return nullptr;
    return document;
}

bool Save(const wxString& file, wxXmlDocument& document)
{
    document.SetFileEncoding("UTF-8");
    return AtomicFile::WriteXml(file, document, 2);
}

// The first "HotFolder" entry whose path matches in any case, or null.
wxXmlNode* FindEntry(wxXmlNode* root, const wxString& path)
{
    for (wxXmlNode* entry = CXmlNodeHelper::Find(root, "HotFolder", true); entry;
         entry = CXmlNodeHelper::FindNext(entry, "HotFolder"))
        if (entry->GetAttribute("path").IsSameAs(path, false))
            return entry;
    return nullptr;
}

// Loads the list, applies change to the first entry matching path and saves,
// all under the list's lock.
template <typename Change> bool ChangeFirstMatch(const wxString& path, Change change)
{
    const wxString warehouse = PathResolver::GetWarehousePath();
    if (!wxFileName::DirExists(warehouse))
        return false;
    FileLock lock(LockFile(warehouse));
    const wxString file = ListFile(warehouse);
    std::unique_ptr<wxXmlDocument> document = LoadList(file);
    if (!document)
        return false;
    wxXmlNode* entry = FindEntry(document->GetRoot(), path);
    if (!entry)
        return false;
    change(entry);
    return Save(file, *document);
}
} // namespace

bool HFDatabase::AddToHotfolderList(const wxString& path)
{
    const wxString warehouse = PathResolver::GetWarehousePath();
    MakeSharedDirectory(warehouse, false);
    FileLock lock(LockFile(warehouse));
    const wxString file = ListFile(warehouse);
    std::unique_ptr<wxXmlDocument> document;
    if (wxFileName::FileExists(file))
    {
        document = LoadList(file);
        if (!document)
            return false; // an unreadable list is kept for repair, not replaced
    }
    else
    {
        document = std::make_unique<wxXmlDocument>();
        document->SetRoot(new wxXmlNode(wxXML_ELEMENT_NODE, "HotFolderList"));
    }
    wxXmlNode* entry = new wxXmlNode(wxXML_ELEMENT_NODE, "HotFolder");
    entry->AddAttribute("path", path);
    document->GetRoot()->AddChild(entry);
    return Save(file, *document);
}

bool HFDatabase::DeleteFromHotfolderList(const wxString& path)
{
    return ChangeFirstMatch(path,
                            [](wxXmlNode* entry)
                            {
                                entry->GetParent()->RemoveChild(entry);
                                delete entry;
                            });
}

bool HFDatabase::EditHotFolderList(const wxString& oldPath, const wxString& newPath)
{
    return ChangeFirstMatch(oldPath,
                            [&newPath](wxXmlNode* entry)
                            {
                                WxStrAttributeMap attributes;
                                attributes["path"] = newPath;
                                CXmlNodeHelper::Update(entry, attributes);
                            });
}

bool HFDatabase::ReadFoldersList(wxArrayString& folders)
{
    return GetHotFolderListFromPath(folders, PathResolver::GetWarehousePath());
}

bool HFDatabase::GetHotFolderListFromPath(wxArrayString& folders, const wxString& directory)
{
    const std::unique_ptr<wxXmlDocument> document = LoadList(ListFile(directory));
    if (!document)
        return false;
    for (wxXmlNode* entry = CXmlNodeHelper::Find(document->GetRoot(), "HotFolder", true); entry;
         entry = CXmlNodeHelper::FindNext(entry, "HotFolder"))
    {
        const wxString folder = entry->GetAttribute("path");
        if (!folder.empty() && wxFileName::DirExists(folder))
            AddUniqueToList(folders, folder);
    }
    return true;
}

void HFDatabase::AddUniqueToList(wxArrayString& list, const wxString& item)
{
    if (list.Index(item, false) == wxNOT_FOUND)
        list.Add(item);
}
} // namespace db
