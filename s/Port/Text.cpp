#include "Port/Text.h"

#include "Port/Ascii.h"

#include <charconv>
#include <climits>
#include <cmath>
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

/// Whether the whole text matches a pattern with "*"; `same` compares two characters. Linear in the
/// product at worst: on a mismatch the last "*" takes one character more.
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

bool strtol(const char* text, long& value) noexcept {
    std::string_view digits = ViewOf(text);
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

int ToIntSaturated(std::string_view text) noexcept {
    text = WithoutLeadingBlanks(text);
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

double ToDouble(const char* text) {
    std::string_view number = WithoutLeadingBlanks(ViewOf(text));
    const bool negative = !number.empty() && number.front() == '-';
    if (!number.empty() && (number.front() == '-' || number.front() == '+')) {
        number.remove_prefix(1);
    }
    std::chars_format format = std::chars_format::general;
    if (number.size() > 2 && number[0] == '0' && ToLower(number[1]) == 'x') {
        number.remove_prefix(2);
        format = std::chars_format::hex;
    }
    // A second sign ends the number before it began; the conversion below would take a "-".
    if (!number.empty() && (number.front() == '-' || number.front() == '+')) {
        return 0.0;
    }
    double value = 0.0;
    const auto result =
        std::from_chars(number.data(), number.data() + number.size(), value, format);
    if (result.ec != std::errc() || !std::isfinite(value)) {
        return 0.0;
    }
    return negative ? -value : value;
}

int stricmp(const char* a, const char* b) noexcept {
    return strnicmp(a, b, std::string_view::npos);
}

int strnicmp(const char* a, const char* b, std::size_t count) noexcept {
    return OrderIgnoringCase(ViewOf(a).substr(0, count), ViewOf(b).substr(0, count));
}

bool strmatch(const char* text, const char* pattern) noexcept {
    return Matches(ViewOf(text), ViewOf(pattern), [](char a, char b) { return a == b; });
}

bool strimatch(const char* text, const char* pattern) noexcept {
    return Matches(ViewOf(text), ViewOf(pattern),
                   [](char a, char b) { return ToUpper(a) == ToUpper(b); });
}

} // namespace Port
