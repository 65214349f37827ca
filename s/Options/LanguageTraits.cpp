#include "Options/LanguageTraits.h"

#include "Options/Keywords.h"

#include <algorithm>
#include <iterator>

namespace Orn_Hdl {

namespace {

constexpr LanguageTraits AllTraits[] = {
    {Language::Verilog, "Verilog", "//", "h", IsReservedInVerilog},
    {Language::Vhdl, "VHDL", "--", "x", IsReservedInVhdl},
};

/// Whether the table has a row for each language, in their order.
constexpr bool IsComplete() {
    return std::equal(
        std::begin(AllTraits), std::end(AllTraits), std::begin(Languages), std::end(Languages),
        [](const LanguageTraits& traits, Language l) { return traits.language == l; });
}
static_assert(IsComplete());

} // namespace

const LanguageTraits& TraitsOf(Language language) noexcept {
    for (const LanguageTraits& traits : AllTraits) {
        if (traits.language == language) {
            return traits;
        }
    }
    return *AllTraits;
}

const char* GetLanguageName(Language language) noexcept {
    return TraitsOf(language).name;
}

const char* GetBaseLetter(Language language, int base) noexcept {
    return base == 2 ? "b" : base == 8 ? "o" : TraitsOf(language).hexadecimalLetter;
}

} // namespace Orn_Hdl
