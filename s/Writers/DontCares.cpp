#include "Writers/DontCares.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <string>

namespace Orn_Hdl::Writers {

using std::string_view;

namespace {

constexpr int HexadecimalBase = 16;
constexpr int OctalBase = 8;

/// The value of a digit of any base; `HexadecimalBase` for another character.
int ValueOf(char digit) noexcept {
    const char small = Port::ToLower(digit);
    return Port::IsDigit(digit)           ? digit - '0'
           : small >= 'a' && small <= 'f' ? small - 'a' + 10
                                          : HexadecimalBase;
}

/// Whether a character is a digit that says nothing of the base.
bool IsSpecial(char digit) noexcept {
    return digit == DontCare || string_view("xXzZ").find(digit) != string_view::npos;
}

int BitsPerDigit(int base) noexcept {
    return base == HexadecimalBase ? 4 : base == OctalBase ? 3 : 1;
}

} // namespace

bool IsDontCare(const BitVectorValue& value) noexcept {
    const string_view digits = value.GetValue();
    return !digits.empty() && digits.back() == DontCare;
}

bool HasDontCare(const BitVectorValue& value) noexcept {
    const string_view digits = value.GetValue();
    return digits.find(DontCare) != string_view::npos &&
           std::all_of(digits.begin(), digits.end(), [&value](char digit) {
               return ValueOf(digit) < value.GetBase() || IsSpecial(digit) ||
                      (digit == '_' && value.HasBaseAndLength());
           });
}

BitVectorValue InVerilog(const BitVectorValue& value) {
    std::string digits(string_view(value.GetValue()));
    std::replace(digits.begin(), digits.end(), DontCare, 'x');
    const string_view base = value.GetBase() == HexadecimalBase ? ":H:"
                             : value.GetBase() == OctalBase     ? ":O:"
                                                                : ":B:";
    std::string text = value.HasBaseAndLength() ? std::to_string(value.GetLength())
                                                : std::to_string(digits.size());
    return BitVectorValue(text.append(base).append(digits).c_str());
}

BitVectorValue InVhdl(const BitVectorValue& value) {
    const int count = BitsPerDigit(value.GetBase());
    std::string bits;
    for (const char digit : string_view(value.GetValue())) {
        if (digit == '_') {
            continue;
        }
        if (IsSpecial(digit)) {
            bits.append(static_cast<std::size_t>(count), Port::ToUpper(digit));
            continue;
        }
        for (int bit = count; bit-- > 0;) {
            bits += (ValueOf(digit) >> bit & 1) != 0 ? '1' : '0';
        }
    }
    return BitVectorValue(bits.c_str());
}

} // namespace Orn_Hdl::Writers
