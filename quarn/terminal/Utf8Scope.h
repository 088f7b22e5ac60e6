#pragma once

#include <clocale>

namespace quarn::program {

/// While it lives, the C library takes wide characters for those of UTF-8 whatever the environment
/// says; numbers and sorting are left alone.
class Utf8Scope {
public:
    Utf8Scope()
        : m_locale(newlocale(LC_CTYPE_MASK, "C.UTF-8", nullptr)),
          m_before(m_locale ? uselocale(m_locale) : nullptr) {}
    ~Utf8Scope() {
        if (!m_locale)
            return;
        uselocale(m_before);
        freelocale(m_locale);
    }
    Utf8Scope(const Utf8Scope&) = delete;
    Utf8Scope& operator=(const Utf8Scope&) = delete;

private:
    locale_t m_locale;
    locale_t m_before;
};

} // namespace quarn::program
