#include "warnings/ConstantSlips.h"

#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Ascii.h"
#include "diagnostics/Words.h"

#include <algorithm>

namespace Tool {

namespace {

using std::string_view;

struct Base {
    string_view name;
    /// In small letters: the digits, and what else Verilog or VHDL takes for one.
    string_view digits;
};

constexpr Base Decimal = {"decimal", "0123456789xz?_"};
constexpr Base Binary = {"binary", "01xz?_uwlh-"};
constexpr Base Octal = {"octal", "01234567xz?_"};
constexpr Base Hexadecimal = {"hexadecimal", "0123456789abcdefxz?_"};

/// The base of a letter in small; null if there is none.
const Base* FindBase(char letter) {
    switch (letter) {
    case 'b':
        return &Binary;
    case 'o':
        return &Octal;
    case 'h':
        return &Hexadecimal;
    default:
        return nullptr;
    }
}

bool IsDigitOf(const Base& base, char c) {
    return base.digits.find(Port::ToLower(c)) != string_view::npos;
}

/// A constant as `BitVectorValue` splits it.
struct Parts {
    explicit Parts(string_view value) {
        const Orn_Hdl::StringArray parts(value, ":", true, nullptr);
        if (parts.GetSize() < 3) {
            digits = value;
            return;
        }
        hasBase = true;
        baseWord = parts.GetView(1);
        digits = parts.GetView(2);
    }

    bool hasBase = false;
    std::string baseWord;
    std::string digits;
};

/// A number as Verilog writes it, such as 8'hFF or -3: Verilog gets it as it stands.
bool IsVerilogNumber(string_view digits) {
    if (!digits.empty() && (digits.front() == '-' || digits.front() == '+')) {
        digits.remove_prefix(1);
    }
    const std::size_t quote = digits.find('\'');
    const string_view size = digits.substr(0, std::min(quote, digits.size()));
    if (!std::all_of(size.begin(), size.end(), [](char c) { return IsDigitOf(Decimal, c); })) {
        return false;
    }
    if (quote == string_view::npos) {
        return !size.empty();
    }
    digits.remove_prefix(quote + 1);
    if (digits.size() < 2) {
        return false;
    }
    const char letter = Port::ToLower(digits.front());
    const Base* const base = letter == 'd' ? &Decimal : FindBase(letter);
    digits.remove_prefix(1);
    return base != nullptr && std::all_of(digits.begin(), digits.end(),
                                          [base](char c) { return IsDigitOf(*base, c); });
}

} // namespace

std::optional<WrongDigit> FindWrongDigit(string_view value, bool dontCares) {
    const Parts parts(value);
    const Base* base = &Decimal;
    if (parts.hasBase) {
        base =
            parts.baseWord.size() == 1 ? FindBase(Port::ToLower(parts.baseWord.front())) : nullptr;
        if (base == nullptr) {
            return WrongDigit{Quoted(parts.baseWord) + " is no base: B, O or H",
                              value.find(':') + 1, parts.baseWord.size()};
        }
    } else if (IsVerilogNumber(parts.digits)) {
        return std::nullopt;
    }
    const auto wrong =
        std::find_if(parts.digits.begin(), parts.digits.end(), [base, dontCares](char c) {
            return !IsDigitOf(*base, c) && !(dontCares && c == '-');
        });
    if (wrong == parts.digits.end()) {
        return std::nullopt;
    }
    const std::size_t first = value.rfind(parts.digits);
    return WrongDigit{Quoted(string_view(&*wrong, 1)).append(" is no ").append(base->name) +
                          " digit",
                      first + static_cast<std::size_t>(wrong - parts.digits.begin()), 1};
}

bool NeedsSeveralBits(string_view value) {
    std::string digits = Parts(value).digits;
    if (const std::size_t quote = digits.find('\''); quote != std::string::npos) {
        digits.erase(0, std::min(quote + 2, digits.size()));
    }
    digits.erase(std::remove(digits.begin(), digits.end(), '_'), digits.end());
    digits.erase(0, std::min(digits.find_first_not_of('0'), digits.size()));
    return digits.size() > 1 || (digits.size() == 1 && digits.front() >= '2' &&
                                 IsDigitOf({"", "23456789abcdef"}, digits.front()));
}

} // namespace Tool
