#pragma once
#include <string>

#include <wx/string.h>

class ServerDescription;

// A hot folder's printer: the queue it prints on, recorded beside its
// Folder.cfg, and the server description made from that queue.

// The description of a CUPS queue, and its PPD's bytes when it has one.
// False with the reason: no such queue, no scheduler, or no description.
bool LoadQueueServer(const std::string& queue, ServerDescription& server, std::string& bytes,
                     wxString& origin, wxString& error);

// Stores a file in the folder's container, replacing it whole. False with
// the reason (the second form prints it).
bool StoreBeside(const wxString& folder, const char* name, const std::string& bytes,
                 const wxString& what, wxString& error);
bool StoreBeside(const wxString& folder, const char* name, const std::string& bytes,
                 const wxString& what);

// Binds the folder to the queue: its server description (and PPD) and the
// queue's name beside Folder.cfg. False with the reason (the second form
// prints it).
bool BindFolderToQueue(const wxString& folder, const std::string& queue, wxString& error);
bool BindFolderToQueue(const wxString& folder, const std::string& queue);

// The folder prints nowhere any more: its outputs stay in the output folder.
// False with the reason (the second form prints it).
bool UnbindFolder(const wxString& folder, wxString& error);
bool UnbindFolder(const wxString& folder);
