#pragma once
#include <memory>
#include <string>
#include <vector>

#include <wx/string.h>

#include "folder/ServerDescription.h"
#include "hotfolder/PluginInfo.h"

class wxXmlNode;

// Making a folder a hot folder, as "hotfolder init" does and the desktop
// client's Add does: read and check everything first, then make it.

struct FolderCreationRequest
{
    wxString folder;        // absolute; created when missing
    std::string serverFile; // at most one of these three
    std::string ppdFile;
    std::string queue;
    wxString name;       // empty: the folder's own name
    wxString modulePath; // the filter module
};

// Everything read and checked before anything is made.
struct FolderCreationPlan
{
    FolderCreationPlan();
    ~FolderCreationPlan();
    ServerDescription server;
    std::string ppdBytes; // the printer description to keep beside it, if any
    wxString origin;      // where the server description came from
    wxString configFile;
    PluginInfo info;
    std::unique_ptr<wxXmlNode> filter;
};

// Reads the server description, checks the folder is not one already and
// loads the module's defaults. False with the reason; nothing is made.
bool PlanFolderCreation(const FolderCreationRequest& request, FolderCreationPlan& plan,
                        wxString& error);

// Makes the folders, stores the server beside Folder.cfg, writes it and
// lists the folder. warnings: what was made but may not work as meant, one
// per entry. False with the reason.
bool CreatePlannedFolder(const FolderCreationRequest& request, FolderCreationPlan& plan,
                         std::vector<wxString>& warnings, wxString& error);
