// The differences between the languages, except the syntax of their statements.
#pragma once

#include "Orn_Hdl/Language.h"

#include <string_view>

namespace Orn_Hdl {

struct LanguageTraits {
    Language language;
    const char* name;
    /// Begins a comment that ends at the end of the line.
    const char* commentPrefix;
    /// The letter of a literal whose base is neither 2 nor 8.
    const char* hexadecimalLetter;
    /// Whether a word is reserved; whether letter case matters depends on the language.
    bool (*isReserved)(std::string_view word);
};

/// The traits of a language; for an invalid value those of the first one.
const LanguageTraits& TraitsOf(Language language) noexcept;

/// The letter for a base in a literal of the language.
const char* GetBaseLetter(Language language, int base) noexcept;

/// The language for the `bool` parameter of older signatures.
constexpr Language WithComments(bool vhdlComments) noexcept {
    return vhdlComments ? Language::Vhdl : Language::Verilog;
}

} // namespace Orn_Hdl
