#include "Port/Text.h"

#include "Port/Ascii.h"
#include "Port/CLocale.h"

#include <charconv>
#include <climits>
#include <cmath>
#include <cstdlib>
#include <string>
#include <string_view>
#include <system_error>

namespace Port {

namespace {

constexpr bool IsBlank(char c) noexcept {
    return c == ' ' || (c >= '\t' && c <= '\r');
}

std::string_view WithoutLeadingBlanks(std::string_view text) noexcept {
    while (!text.empty() && IsBlank(text.front())) {
        text.remove_prefix(1);
    }
    return text;
}

/// Whether the whole text matches a pattern with "*"; `same` compares two characters. On a mismatch
/// the last "*" takes one more character, so the time is at most proportional to the product of the
/// lengths.
template <class Same>
bool Matches(std::string_view text, std::string_view pattern, Same same) noexcept {
    std::size_t t = 0;
    std::size_t p = 0;
    std::size_t star = std::string_view::npos;
    std::size_t starText = 0;
    while (t < text.size()) {
        if (p < pattern.size() && pattern[p] == '*') {
            star = p++;
            starText = t;
        } else if (p < pattern.size() && same(text[t], pattern[p])) {
            ++t;
            ++p;
        } else if (star != std::string_view::npos) {
            p = star + 1;
            t = ++starText;
        } else {
            return false;
        }
    }
    while (p < pattern.size() && pattern[p] == '*') {
        ++p;
    }
    return p == pattern.size();
}

} // namespace

bool strtol(TextView text, long& value) noexcept {
    std::string_view digits = text;
    if (!digits.empty() && digits.front() == '+') {
        digits.remove_prefix(1);
        if (!digits.empty() && digits.front() == '-') {
            return false;
        }
    }
    long parsed = 0;
    const char* const end = digits.data() + digits.size();
    const auto [stop, error] = std::from_chars(digits.data(), end, parsed);
    if (digits.empty() || error != std::errc() || stop != end) {
        return false;
    }
    value = parsed;
    return true;
}

int ToIntSaturated(TextView number) noexcept {
    std::string_view text = WithoutLeadingBlanks(number);
    const bool negative = !text.empty() && text.front() == '-';
    if (!text.empty() && (text.front() == '-' || text.front() == '+')) {
        text.remove_prefix(1);
    }
    long long value = 0;
    for (const char c : text) {
        if (!IsDigit(c)) {
            break;
        }
        value = value * 10 + (c - '0');
        if (value > INT_MAX) {
            return negative ? INT_MIN : INT_MAX;
        }
    }
    return static_cast<int>(negative ? -value : value);
}

double ToDouble(TextView text) {
    const std::string copy(text.GetView());
    const CLocale scope;
    const double value = std::strtod(copy.c_str(), nullptr);
    return std::isfinite(value) ? value : 0.0;
}

int stricmp(TextView a, TextView b) noexcept {
    return OrderIgnoringCase(a, b);
}

int strnicmp(TextView a, TextView b, std::size_t count) noexcept {
    return OrderIgnoringCase(a.GetView().substr(0, count), b.GetView().substr(0, count));
}

bool strmatch(TextView text, TextView pattern) noexcept {
    return Matches(text, pattern, [](char a, char b) { return a == b; });
}

bool strimatch(TextView text, TextView pattern) noexcept {
    return Matches(text, pattern, [](char a, char b) { return ToUpper(a) == ToUpper(b); });
}

} // namespace Port
