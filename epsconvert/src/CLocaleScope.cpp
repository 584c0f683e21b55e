#include "CLocaleScope.h"

namespace
{
locale_t TheCLocale()
{
    // Made once and kept for the life of the process: uselocale needs it to
    // outlive every scope that installs it.
    static locale_t const cLocale = newlocale(LC_ALL_MASK, "C", static_cast<locale_t>(nullptr));
    return cLocale;
}
} // namespace

CLocaleScope::CLocaleScope()
{
    if (locale_t c = TheCLocale())
        m_previous = uselocale(c);
}

CLocaleScope::~CLocaleScope()
{
    if (m_previous)
        uselocale(m_previous);
}
