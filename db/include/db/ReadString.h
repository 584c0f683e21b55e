#pragma once
#include "XmlHelper.h"

namespace db
{
// Copies the value of key into value when the map holds it; true then.
bool ReadString(const StdStrAttributeMap& map, const CStdStr<wchar_t>& key, wxString& value);
} // namespace db
