#include "diagnostics/Utf8.h"

namespace Tool {

namespace {

unsigned GetByte(std::string_view text, std::size_t i) noexcept {
    return static_cast<unsigned char>(text[i]);
}

/// Whether the second byte makes the character an overlong form, a surrogate, or greater than the
/// last character.
bool IsBadSecond(unsigned first, unsigned second) noexcept {
    return (first == 0xE0 && second < 0xA0) || (first == 0xED && second > 0x9F) ||
           (first == 0xF0 && second < 0x90) || (first == 0xF4 && second > 0x8F);
}

} // namespace

std::size_t GetCharacterSize(std::string_view text) noexcept {
    const unsigned first = GetByte(text, 0);
    const std::size_t size = first >= 0xF0 ? 4 : first >= 0xE0 ? 3 : 2;
    if (first < 0xC2 || first > 0xF4 || text.size() < size) {
        return 1;
    }
    for (std::size_t i = 1; i < size; ++i) {
        if ((GetByte(text, i) & 0xC0U) != 0x80U) {
            return 1;
        }
    }
    return IsBadSecond(first, GetByte(text, 1)) ? 1 : size;
}

std::size_t CountCharacters(std::string_view text) noexcept {
    std::size_t count = 0;
    for (; !text.empty(); text.remove_prefix(GetCharacterSize(text))) {
        ++count;
    }
    return count;
}

} // namespace Tool
