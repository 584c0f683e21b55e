#pragma once
// Switches the calling thread to the "C" locale for its lifetime, so numbers
// are printed and parsed with "." whatever locale the process runs in.
#include <locale.h>

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
