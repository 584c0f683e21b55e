#pragma once
#include <wx/string.h>

#include "db/Setting.h"

namespace db
{
class VelmarDBXMLHelper
{
public:
    // 0 when no file exists at path; -1 when it cannot be loaded, has no
    // root, carries no root attribute or lacks one of "name", "description",
    // "server_ip", "server_name"; else 1. Later attributes are read in a fixed
    // chain that stops at the first missing one, so an older file loads its
    // leading part. Input formats are appended whenever the file loaded.
    static int ReadSettingsInfo(const wxString& path, Setting& setting);
};
} // namespace db
