// What units ask of words, and how messages show them.
#pragma once

#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Ascii.h"

#include <string>
#include <string_view>

namespace Tool {

/// Whether the word of a line is this one, letter case ignored.
inline bool IsWord(const Orn_Hdl::StringArray& words, int index, std::string_view word) noexcept {
    return index < words.GetSize() && Port::EqualIgnoringCase(words.GetView(index), word);
}

/// A text between double quotes, as messages show it.
inline std::string Quoted(std::string_view text) {
    return std::string("\"").append(text).append("\"");
}

} // namespace Tool
