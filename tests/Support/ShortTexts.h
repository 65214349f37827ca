/// \file
/// All short texts over an alphabet, for exhaustive comparison with a slow second implementation.
#pragma once

#include <gtest/gtest.h>

#include <cstddef>
#include <string>
#include <string_view>

namespace Support {

/// Calls `visit` with every text of at most `longest` characters of `alphabet`, "" first, until the
/// running test has failed.
template <class Visit>
void ForEachText(std::string_view alphabet, std::size_t longest, Visit visit) {
    std::string text;
    auto extend = [&](auto& self) -> void {
        visit(static_cast<const std::string&>(text));
        if (text.size() == longest) {
            return;
        }
        for (const char c : alphabet) {
            if (testing::Test::HasFailure()) {
                return;
            }
            text.push_back(c);
            self(self);
            text.pop_back();
        }
    };
    extend(extend);
}

} // namespace Support
