#include "Check/Digits.h"

#include "Port/Ascii.h"
#include "Writers/DontCares.h"

#include <algorithm>
#include <iterator>

namespace Orn_Hdl::Checking {

using std::string_view;

namespace {

/// The value of a hexadecimal digit; -1 for any other character.
int ValueOf(char c) {
    if (Port::IsDigit(c)) {
        return c - '0';
    }
    const char small = Port::ToLower(c);
    return small >= 'a' && small <= 'f' ? small - 'a' + 10 : -1;
}

bool IsDigitOf(int base, char c) {
    const int value = ValueOf(c);
    return value >= 0 && value < base;
}

/// The digits and signs of a decimal number, as they stand in an expression.
bool IsDecimal(string_view text) {
    while (!text.empty() && (text.front() == '-' || text.front() == '+' || text.front() == ' ')) {
        text.remove_prefix(1);
    }
    return !text.empty() && Port::IsDigit(text.front()) &&
           std::all_of(text.begin(), text.end(),
                       [](char c) { return Port::IsDigit(c) || c == '_' || c == ' '; }) &&
           text.find(' ') == string_view::npos;
}

/// Single underscores between characters are allowed and say nothing.
bool HasProperUnderscores(string_view text) {
    return text.empty() ||
           (text.front() != '_' && text.back() != '_' && text.find("__") == string_view::npos);
}

/// A decimal number's bits, lowest last, by repeated halving.
std::string ToBinary(std::string decimal) {
    std::string bits;
    while (!decimal.empty()) {
        int rest = 0;
        std::string half;
        for (const char c : decimal) {
            const int value = rest * 10 + (c - '0');
            if (!half.empty() || value > 1) {
                half.push_back(static_cast<char>('0' + value / 2));
            }
            rest = value % 2;
        }
        bits.push_back(static_cast<char>('0' + rest));
        decimal = std::move(half);
    }
    std::reverse(bits.begin(), bits.end());
    return bits;
}

/// The low `width` bits; a number that is too short is filled up as Verilog does.
std::string Resize(const std::string& bits, std::size_t width) {
    if (bits.size() >= width) {
        return bits.substr(bits.size() - width);
    }
    const char first = bits.empty() ? '0' : bits.front();
    return std::string(width - bits.size(), first == '1' ? '0' : first) + bits;
}

void Negate(std::string& bits) {
    bool carry = true;
    for (auto bit = bits.rbegin(); bit != bits.rend(); ++bit) {
        const bool one = *bit == '0';
        *bit = one != carry ? '1' : '0';
        carry = one && carry;
    }
}

/// Numbers of more digits are told apart by their digits alone.
constexpr std::size_t MostDecimalDigits = 4096;

} // namespace

Digits::Digits(const BitVectorValue& value, bool dontCares)
    : digits(string_view(value.GetValue())), base(value.GetBase()), length(value.GetLength()),
      hasLength(value.HasBaseAndLength()), hasDontCare(dontCares && Writers::HasDontCare(value)) {
    if (hasDontCare && !hasLength) {
        hasLength = true;
        length = static_cast<int>(digits.size());
    }
}

bool Digits::IsVerilogNumber() const {
    if (!hasLength) {
        return IsDecimal(digits);
    }
    const string_view text =
        string_view(digits).substr(std::min(digits.find_first_not_of(' '), digits.size()));
    return !text.empty() && text.front() != '_' &&
           std::all_of(text.begin(), text.end(), [this](char c) {
               const char small = Port::ToLower(c);
               return IsDigitOf(base, c) || small == 'x' || small == 'z' || c == '?' || c == '_' ||
                      (hasDontCare && c == Writers::DontCare);
           });
}

bool Digits::IsVhdlString(bool is2008) const {
    if (hasDontCare) {
        return true;
    }
    if (!hasLength) {
        return std::all_of(digits.begin(), digits.end(),
                           [](char c) { return StdLogic.find(c) != string_view::npos; });
    }
    return HasProperUnderscores(digits) &&
           std::all_of(digits.begin(), digits.end(), [this, is2008](char c) {
               return c == '_' || IsDigitOf(base, c) ||
                      (is2008 && StdLogic.find(c) != string_view::npos);
           });
}

bool Digits::IsVhdlBitVector() const {
    if (!hasLength) {
        return digits.find_first_not_of("01") == std::string::npos;
    }
    return IsVhdlString(false);
}

std::size_t Digits::GetVhdlLength() const {
    if (!hasLength) {
        return digits.size();
    }
    const auto underscores = std::count(digits.begin(), digits.end(), '_');
    return (digits.size() - static_cast<std::size_t>(underscores)) *
           static_cast<std::size_t>(BitsPerDigit());
}

std::string Digits::ExpandDigits() const {
    std::string bits;
    for (const char c : digits) {
        const int value = ValueOf(c);
        const bool isDigit = IsDigitOf(base, c);
        if (c == '_' || c == ' ') {
            continue;
        }
        for (int bit = BitsPerDigit() - 1; bit >= 0; --bit) {
            const char unknown = c == Writers::DontCare ? c : Port::ToLower(c) == 'x' ? 'x' : 'z';
            bits.push_back(!isDigit ? unknown : ((value >> bit) & 1) != 0 ? '1' : '0');
        }
    }
    return bits;
}

std::string Digits::GetDecimalDigits() const {
    std::string decimal;
    std::copy_if(digits.begin(), digits.end(), std::back_inserter(decimal), Port::IsDigit);
    return decimal.erase(0, std::min(decimal.find_first_not_of('0'), decimal.size()));
}

std::size_t Digits::GetNeededBits() const {
    const std::string bits =
        hasLength ? ExpandDigits() : ToBinary(GetDecimalDigits().substr(0, MostDecimalDigits));
    const std::size_t first = bits.find_first_not_of('0');
    return first == std::string::npos ? 0 : bits.size() - first;
}

BitText Digits::ReadVerilog(std::size_t width) const {
    if (!IsVerilogNumber()) {
        return std::nullopt;
    }
    if (hasLength) {
        const std::size_t size =
            static_cast<std::size_t>(length < 0 ? -std::int64_t(length) : length);
        // Nothing is longer than what is compared with it.
        std::string bits = ExpandDigits();
        bits = Resize(bits, std::min(size, std::max(bits.size(), width)));
        bits = Resize(bits, width);
        if (length < 0) {
            Negate(bits);
        }
        return bits;
    }
    const std::string decimal = GetDecimalDigits();
    if (decimal.size() > MostDecimalDigits) {
        return std::nullopt;
    }
    std::string bits = Resize(ToBinary(decimal), width);
    if (std::count(digits.begin(), digits.end(), '-') % 2 != 0) {
        Negate(bits);
    }
    return bits;
}

BitText Digits::ReadVhdl() const {
    if (!IsVhdlString(true)) {
        return std::nullopt;
    }
    std::string bits;
    if (hasLength) {
        bits = ExpandDigits();
    } else {
        for (const char c : digits) {
            bits.push_back(c == '0' || c == '1' ? c : c == 'Z' ? 'z' : 'x');
        }
    }
    return bits;
}

} // namespace Orn_Hdl::Checking
