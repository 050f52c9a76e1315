// Numbers with '.' from code that asks the locale.
#pragma once

#include <locale.h>

/// Puts this thread into the "C" locale while it lives; other threads are not touched.
class CNeutralLocale {
public:
    CNeutralLocale() : m_before(uselocale(Neutral())) {}
    CNeutralLocale(const CNeutralLocale&) = delete;
    CNeutralLocale& operator=(const CNeutralLocale&) = delete;
    ~CNeutralLocale() { uselocale(m_before); }

private:
    static locale_t Neutral()
    {
        static const locale_t neutral = newlocale(LC_ALL_MASK, "C", nullptr);
        return neutral;
    }

    locale_t m_before;
};
