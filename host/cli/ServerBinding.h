#pragma once
#include <string>

#include <wx/string.h>

class ServerDescription;

// The server a hot folder submits to: its description, and the printer
// description it was made from, beside Folder.cfg.

// The description of the printer a PPD file describes, and the file's bytes.
// False with the reason.
bool LoadPpdServer(const std::string& ppd, ServerDescription& server, std::string& bytes,
                   wxString& error);

// Stores the description (and the PPD's bytes, when there are any; else an
// older PPD goes) beside the folder's Folder.cfg, each replaced whole. False
// with the reason (the second form prints it).
bool StoreServerBeside(const wxString& folder, const ServerDescription& server,
                       const std::string& ppdBytes, wxString& error);
bool StoreServerBeside(const wxString& folder, const ServerDescription& server,
                       const std::string& ppdBytes);
