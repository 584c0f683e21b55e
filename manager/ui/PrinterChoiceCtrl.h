#pragma once
#include <functional>
#include <vector>

#include <wx/panel.h>

#include "core/FolderSetup.h"

class wxChoice;
class wxFilePickerCtrl;
class wxStaticText;

// Where a folder's outputs go: one of the scheduler's queues ("name — make
// and model"), a printer description file (PPD) picked beside the list, or
// no printer at all (the outputs stay in the folder's Output).
class PrinterChoiceCtrl : public wxPanel
{
public:
    // changed: called when the user picks another printer or PPD file.
    PrinterChoiceCtrl(wxWindow* parent, std::function<void()> changed);

    PrinterChoice Value() const;
    // A queue the scheduler does not list (any more) is added to the list.
    void SetValue(const PrinterChoice& choice);

    wxChoice& List() const { return *m_list; }
    wxFilePickerCtrl& PpdPicker() const { return *m_ppd; }

private:
    void ListQueues();
    void Select(int index);
    int PpdEntry() const;
    int NoneEntry() const;

    std::function<void()> m_changed;
    std::vector<std::string> m_queues; // in the list's order, before the two fixed entries
    wxChoice* m_list = nullptr;
    wxFilePickerCtrl* m_ppd = nullptr;
    wxStaticText* m_note = nullptr;
};
