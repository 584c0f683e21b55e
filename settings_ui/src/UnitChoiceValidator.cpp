#include "UnitChoiceValidator.h"

#include <wx/combobox.h>

UnitChoiceValidator::UnitChoiceValidator(wxString* unit) : wxGenericValidator(unit), m_pUnit(unit)
{
}

bool UnitChoiceValidator::TransferToWindow()
{
    auto* list = wxDynamicCast(GetWindow(), wxComboBox);
    if (list && list->FindString(*m_pUnit) == wxNOT_FOUND)
    {
        list->SetSelection(wxNOT_FOUND);
        list->ChangeValue(wxString()); // some toolkits keep the old text in view
        return true;
    }
    return wxGenericValidator::TransferToWindow();
}
