/// \file
/// `Port::TextArgument`, the type of the parameters that take a name or another C text.
#pragma once

#include "Port/String.h"
#include "Port/TextView.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <type_traits>

namespace Port {

/// A text that an operation reads as a C text and does not keep. It is made from any kind of text:
/// a literal or another pointer to a text that ends in NUL, a `std::string`, a `std::string_view`,
/// a `StringBase`. A text that is known to end in NUL is not copied and must outlive the argument;
/// any other is copied. The text ends at its first NUL.
///
/// A null pointer, the literal `nullptr` included, stays one, because many operations tell it from
/// the empty text. A `std::string_view` is never read as a null pointer.
class TextArgument {
    template <class Text>
    static constexpr bool IsPointer = std::is_convertible_v<const Text&, const char*>;
    template <class Text>
    static constexpr bool IsText =
        IsPointer<Text> || std::is_convertible_v<const Text&, std::string_view>;

public:
    /// A text that ends in NUL, or null.
    TextArgument(const char* text) noexcept : text_(text) {}
    /// A text of the standard library.
    TextArgument(const std::string& text) noexcept : text_(text.c_str()) {}
    /// A text of this library.
    TextArgument(const StringBase<char>& text) noexcept : text_(text.CStr()) {}
    /// Any other text. One that only knows its length is copied.
    template <class Text, std::enable_if_t<IsText<Text>, int> = 0>
    TextArgument(const Text& text) noexcept(IsPointer<Text>) {
        if constexpr (IsPointer<Text>) {
            text_ = text;
        } else {
            Copy(text);
        }
    }
    TextArgument(const TextArgument&) = delete;
    TextArgument& operator=(const TextArgument&) = delete;

    /// The text, which ends in NUL and is valid as long as the argument, or null.
    const char* Get() const noexcept { return text_; }
    /// The text, which ends in NUL and is valid as long as the argument, or null.
    operator const char*() const noexcept { return text_; }
    /// The text; null is read as "".
    std::string_view GetView() const noexcept { return ViewOf(text_); }

private:
    void Copy(std::string_view text) {
        copy_ = std::make_unique<char[]>(text.size() + 1);
        text.copy(copy_.get(), text.size());
        text_ = copy_.get();
    }

    const char* text_ = nullptr;
    /// The text, if it had to be copied.
    std::unique_ptr<char[]> copy_;
};

} // namespace Port
