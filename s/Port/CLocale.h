// Formatting and parsing by the C library that do not depend on the program's locale.
#pragma once

#include <clocale>
#include <locale.h>
#if defined(__APPLE__)
#include <xlocale.h>
#endif

namespace Port {

/// Sets the "C" locale for this thread during its lifetime.
class CLocale {
public:
    CLocale() noexcept : former_(uselocale(Get())) {}
    CLocale(const CLocale&) = delete;
    CLocale& operator=(const CLocale&) = delete;
    ~CLocale() { uselocale(former_); }

private:
    /// Null if the system cannot create the locale; the present one stays in use then.
    static locale_t Get() noexcept {
        static const locale_t locale = newlocale(LC_ALL_MASK, "C", static_cast<locale_t>(nullptr));
        return locale;
    }

    locale_t former_;
};

} // namespace Port
