// Keeps texts from ending the line in which they stand.
#pragma once

#include <algorithm>
#include <string>
#include <string_view>

namespace Orn_Hdl::Writers {

/// A text for the rest of a comment or for a literal, which a line end would let it leave: whatever
/// ends a line in one of the languages (IEEE 1076-2008, 15.3) becomes a blank. A text without any,
/// as nearly all are, is not copied.
class OneLine {
public:
    /// \param text must outlive this.
    /// \param instead what stands in the place of a line end.
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
