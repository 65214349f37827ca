// What the C library formats and parses shall not depend on the locale that the program has set.
#pragma once

#include <clocale>
#include <locale.h>
#if defined(__APPLE__)
#include <xlocale.h>
#endif

namespace Port {

/// Puts the "C" locale in use for this thread as long as it lives.
class CLocale {
public:
    CLocale() noexcept : former_(uselocale(Get())) {}
    CLocale(const CLocale&) = delete;
    CLocale& operator=(const CLocale&) = delete;
    ~CLocale() { uselocale(former_); }

private:
    /// Null, which leaves the locale in use as it is, where the system cannot make one.
    static locale_t Get() noexcept {
        static const locale_t locale = newlocale(LC_ALL_MASK, "C", static_cast<locale_t>(nullptr));
        return locale;
    }

    locale_t former_;
};

} // namespace Port
