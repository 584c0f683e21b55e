#pragma once
#include <wx/string.h>
#include <wx/valgen.h>

// Binds a unit list to its text. A text the list does not offer (none at
// all when the server names no unit) shows as no choice, so that reading
// the list back keeps it instead of whatever the list showed before.
class UnitChoiceValidator : public wxGenericValidator
{
public:
    explicit UnitChoiceValidator(wxString* unit);

    wxObject* Clone() const override { return new UnitChoiceValidator(*this); }
    bool TransferToWindow() override;

private:
    wxString* m_pUnit;
};
