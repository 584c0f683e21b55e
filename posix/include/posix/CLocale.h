#pragma once
// The "C" locale, for numbers that are printed and parsed with "." whatever
// locale the process runs in.
#include <locale.h>

namespace posix
{
// One locale object for the whole process, made on first use and kept until
// exit (uselocale needs it to outlive every scope that installs it). Null
// only when newlocale failed.
locale_t CLocale();

// Switches the calling thread to the "C" locale for its lifetime.
class CLocaleScope
{
public:
    CLocaleScope();
    ~CLocaleScope();
    CLocaleScope(const CLocaleScope&) = delete;
    CLocaleScope& operator=(const CLocaleScope&) = delete;

private:
    locale_t m_previous = nullptr;
};
} // namespace posix
