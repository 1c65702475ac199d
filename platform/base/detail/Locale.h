#pragma once

#include <locale.h>

namespace tvx::detail {

/// The C locale with Unicode letters. Made once and never freed: text is handled until the process is gone.
[[nodiscard]] locale_t neutralLocale();

/// Puts this thread into the neutral locale for a scope; other threads and the process's locale are not touched.
class NeutralLocaleScope {
public:
    NeutralLocaleScope() : m_previous(uselocale(neutralLocale())) {}
    ~NeutralLocaleScope() {
        uselocale(m_previous);
    }
    NeutralLocaleScope(const NeutralLocaleScope&) = delete;
    NeutralLocaleScope& operator=(const NeutralLocaleScope&) = delete;

private:
    locale_t m_previous;
};

} // namespace tvx::detail
