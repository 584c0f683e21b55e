#pragma once
#include <string>
#include <utility>
#include <vector>

namespace printing
{
using OptionList = std::vector<std::pair<std::string, std::string>>;

// Job overrides as a hot folder writes them, turned into CUPS job options.
// "PageSize" with a paper keyword stays as it is; "PageSize" "Custom" with
// "CustomPageSize" "W H" (points) becomes PageSize=Custom.WxH. Other
// overrides pass through; empty values are dropped; a later override of the
// same name wins.
OptionList CupsOptionsFromOverrides(const OptionList& overrides);
} // namespace printing
