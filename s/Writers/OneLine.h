// Texts without line ends.
#pragma once

#include <algorithm>
#include <string>
#include <string_view>

namespace Orn_Hdl::Writers {

/// A text for a comment or a literal, which must not contain a line end: each character that ends a
/// line in one of the languages (IEEE 1076-2008, 15.3) becomes a blank. A text without line ends,
/// the usual case, is not copied.
class OneLine {
public:
    /// \param text must outlive this object.
    /// \param instead replaces a line end.
    explicit OneLine(std::string_view text, char instead = ' ') : view_(text) {
        if (std::any_of(text.begin(), text.end(), EndsLine)) {
            changed_ = text;
            std::replace_if(changed_.begin(), changed_.end(), EndsLine, instead);
            view_ = changed_;
        }
    }
    OneLine(const OneLine&) = delete;
    OneLine& operator=(const OneLine&) = delete;

    std::string_view GetView() const noexcept { return view_; }

private:
    static bool EndsLine(char c) noexcept { return c >= '\n' && c <= '\r'; }

    std::string_view view_;
    std::string changed_;
};

} // namespace Orn_Hdl::Writers
