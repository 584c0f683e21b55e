#include "ui/LiveList.h"

#include <algorithm>

LiveList::LiveList(wxWindow* parent, const std::vector<wxString>& headings)
    : wxListCtrl(parent, wxID_ANY, wxDefaultPosition, wxDefaultSize, wxLC_REPORT | wxLC_SINGLE_SEL)
{
    for (size_t i = 0; i < headings.size(); ++i)
        AppendColumn(headings[i], wxLIST_FORMAT_LEFT, wxLIST_AUTOSIZE_USEHEADER);
}

void LiveList::ShowRows(const std::vector<std::vector<wxString>>& rows,
                        const std::vector<wxString>& keys)
{
    const wxString selected = SelectedKey();
    // Columns fit their texts again whenever a text changes (a reason that
    // appears later must not stay cut off), not on every rescan.
    bool changed = keys != m_keys;
    Freeze();
    while (GetItemCount() > static_cast<int>(rows.size()))
        DeleteItem(GetItemCount() - 1);
    for (size_t i = 0; i < rows.size(); ++i)
    {
        const long item = static_cast<long>(i);
        if (item >= GetItemCount())
            InsertItem(item, wxString());
        for (size_t column = 0; column < rows[i].size(); ++column)
            if (GetItemText(item, static_cast<int>(column)) != rows[i][column])
            {
                SetItem(item, static_cast<int>(column), rows[i][column]);
                changed = true;
            }
    }
    m_keys = keys;
    Thaw();
    if (!selected.empty() && SelectedKey() != selected)
        SelectKey(selected);
    if (changed)
        for (int column = 0; column < GetColumnCount(); ++column)
            SetColumnWidth(column, wxLIST_AUTOSIZE_USEHEADER);
}

wxString LiveList::SelectedKey() const
{
    const long index = SelectedIndex();
    return index >= 0 && index < static_cast<long>(m_keys.size()) ? m_keys[index] : wxString();
}

long LiveList::SelectedIndex() const
{
    return GetNextItem(-1, wxLIST_NEXT_ALL, wxLIST_STATE_SELECTED);
}

void LiveList::SelectKey(const wxString& key)
{
    for (size_t i = 0; i < m_keys.size(); ++i)
        if (m_keys[i] == key)
        {
            SetItemState(static_cast<long>(i), wxLIST_STATE_SELECTED | wxLIST_STATE_FOCUSED,
                         wxLIST_STATE_SELECTED | wxLIST_STATE_FOCUSED);
            EnsureVisible(static_cast<long>(i));
            return;
        }
    const long old = SelectedIndex();
    if (old >= 0)
        SetItemState(old, 0, wxLIST_STATE_SELECTED);
}

long LiveList::RowAt(const wxPoint& point) const
{
    // Points come in the list's own coordinates; the generic list tests
    // them in its rows' window, the child below the column headings.
    wxPoint rowsOrigin;
    for (const wxWindow* child : GetChildren())
        rowsOrigin.y = std::max(rowsOrigin.y, child->GetPosition().y);
    if (point.y < rowsOrigin.y)
        return -1;
    const wxPoint at = point - rowsOrigin;
    int flags = 0;
    const long row = HitTest(at, flags);
    return (flags & wxLIST_HITTEST_ONITEM) ? row : -1;
}
