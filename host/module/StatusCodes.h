#pragma once
#include <vector>

// Every status code the filter family defines, in table order: success, the
// generic error, the framework codes and the converter codes.
const std::vector<long>& KnownStatusCodes();
