#include "db/ReadString.h"

namespace db
{
bool ReadString(const StdStrAttributeMap& map, const CStdStr<wchar_t>& key, wxString& value)
{
    const auto found = map.find(key);
    if (found == map.end())
        return false;
    value = ToWxString(found->second);
    return true;
}
} // namespace db
