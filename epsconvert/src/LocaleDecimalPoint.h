#pragma once
// The decimal point the current locale uses for numbers, trimmed.
#include <string>

std::string CurrentLocaleDecimalPoint();

// True when the locale's decimal point is "." (compared without case).
bool LocaleUsesFullStop(const std::string& decimalPoint);
