/// \file
/// `Port::TextView`, the type of the parameters that take a text.
#pragma once

#include "Port/Export.h"

#include <cstddef>
#include <string_view>
#include <type_traits>

namespace Port {

/// A text that an operation reads and does not keep. It is made from any kind of text: a
/// literal or another pointer to a text that ends in NUL, a `std::string`, a `std::string_view`, a
/// `StringBase`. A null pointer, the literal `nullptr` included, is read as the empty text; a
/// `std::string_view` cannot be made from one.
template <class Char> class BasicTextView {
public:
    /// The view of the standard library.
    using View = std::basic_string_view<Char>;

    /// The empty text.
    constexpr BasicTextView() noexcept = default;
    /// A text that ends in NUL. It must outlive the view; null is read as "".
    constexpr BasicTextView(const Char* text) noexcept
        : view_(text == nullptr ? View() : View(text)) {}
    /// A text that knows its length. It must outlive the view.
    template <class Text, std::enable_if_t<std::is_convertible_v<const Text&, View> &&
                                               !std::is_convertible_v<const Text&, const Char*>,
                                           int> = 0>
    constexpr BasicTextView(const Text& text) noexcept : view_(text) {}

    /// The text for the standard library, which may hold any characters, NUL included.
    constexpr operator View() const noexcept { return view_; }
    /// The text for the standard library, where an explicit conversion is needed.
    constexpr View GetView() const noexcept { return view_; }

private:
    View view_;
};

/// The parameter type for texts of `char`.
using TextView = BasicTextView<char>;

/// The text of a pointer that may be null, which is read as the empty text.
constexpr std::string_view ViewOf(const char* text) noexcept {
    return TextView(text);
}

} // namespace Port
