// What tells the languages apart besides the shape of their statements.
#pragma once

#include "Orn_Hdl/Language.h"

#include <string_view>

namespace Orn_Hdl {

struct LanguageTraits {
    Language language;
    const char* name;
    /// Begins a comment that ends with its line.
    const char* commentPrefix;
    /// The letter of a literal whose base is neither 2 nor 8.
    const char* hexadecimalLetter;
    /// Whether a word is reserved, by the language's own rule for letter case.
    bool (*isReserved)(std::string_view word);
};

/// The traits of a language; of a value that is none, those of the first one.
const LanguageTraits& TraitsOf(Language language) noexcept;

/// The letter that stands for a base in a literal of the language.
const char* GetBaseLetter(Language language, int base) noexcept;

/// The language of the flag by which older signatures ask for comments.
constexpr Language WithComments(bool vhdlComments) noexcept {
    return vhdlComments ? Language::Vhdl : Language::Verilog;
}

} // namespace Orn_Hdl
