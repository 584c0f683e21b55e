#pragma once
#include <vector>

#include <wx/listctrl.h>

// A report list that a rescan updates in place: rows and cells change only
// where their text changed, and the selected row (found by its key) stays
// selected, so that a live list neither flickers nor loses the user's place.
class LiveList : public wxListCtrl
{
public:
    LiveList(wxWindow* parent, const std::vector<wxString>& headings);

    // rows[i] holds one text per column; keys[i] names the row.
    void ShowRows(const std::vector<std::vector<wxString>>& rows,
                  const std::vector<wxString>& keys);
    // The selected row's key; empty when none is selected.
    wxString SelectedKey() const;
    long SelectedIndex() const;
    void SelectKey(const wxString& key);
    // The row at a point of the list's client area, or -1.
    long RowAt(const wxPoint& point) const;
    const std::vector<wxString>& Keys() const { return m_keys; }

private:
    std::vector<wxString> m_keys;
};
