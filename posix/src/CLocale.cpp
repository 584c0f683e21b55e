#include "posix/CLocale.h"

namespace posix
{
locale_t CLocale()
{
    static const locale_t cLocale = ::newlocale(LC_ALL_MASK, "C", static_cast<locale_t>(nullptr));
    return cLocale;
}

CLocaleScope::CLocaleScope()
{
    if (locale_t c = CLocale())
        m_previous = ::uselocale(c);
}

CLocaleScope::~CLocaleScope()
{
    if (m_previous)
        ::uselocale(m_previous);
}
} // namespace posix
