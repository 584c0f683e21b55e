#pragma once
#include <string>

#include <wx/string.h>

// Adding a hot folder, changing its name and printer, taking it off the list:
// the same code "hotfolder init", "settings --printer/--ppd" and "remove" run.

// What a folder prints on: nothing (outputs stay in its output folder), a
// CUPS queue, or the printer a PPD file describes (output only as well).
struct PrinterChoice
{
    enum class Kind
    {
        None,
        Queue,
        PpdFile
    } kind = Kind::None;
    std::string value; // queue name or PPD path
};

// The server description the filter's panel is loaded with ("" for None).
bool LoadPrinterServer(const PrinterChoice& choice, wxString& serverXml, wxString& error);

// Makes folder (created when missing) a listed hot folder as "hotfolder init"
// does. warnings: one line each, empty when none.
bool CreateHotFolder(const wxString& folder, const wxString& name, const PrinterChoice& choice,
                     const wxString& modulePath, wxString& warnings, wxString& error);

// Stores another name and binds the folder to another queue, PPD or none,
// each only when it differs from what the folder has.
bool ChangeFolderSetup(const wxString& folder, const wxString& name, const PrinterChoice& choice,
                       wxString& error);

// The bound queue; else the PPD kept beside Folder.cfg (its stored copy);
// else None.
PrinterChoice CurrentPrinterChoice(const wxString& folder);

// Takes the folder off the machine-wide list; the folder and its files stay.
bool RemoveFolderFromList(const wxString& folder, wxString& error);
