// What the digits of a constant or of a bit vector mean in each language.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Check.h"

#include <optional>
#include <string>
#include <string_view>

namespace Orn_Hdl::Checking {

/// The values of std_logic.
constexpr std::string_view StdLogic = "UX01ZWLH-";

/// A value's bits, leftmost first, each of "01xz", and "-" for a don't care; nothing when the text
/// is no number.
using BitText = std::optional<std::string>;

/// The text that the writers write for a value, seen by each language.
struct Digits {
    /// \param dontCares whether a digit "-" is a don't care.
    explicit Digits(const BitVectorValue& value, bool dontCares = false);

    /// The digits as they stand.
    std::string digits;
    int base = 2;
    int length = 1;
    bool hasLength = false;
    /// Whether there are don't cares. The writers then give Verilog a length and a base, and VHDL a
    /// string with an element for each bit.
    bool hasDontCare = false;

    /// How many bits one digit stands for.
    int BitsPerDigit() const noexcept { return base == 16 ? 4 : base == 8 ? 3 : 1; }
    /// Whether Verilog reads a number.
    bool IsVerilogNumber() const;
    bool HasLeadingUnderscore() const { return !digits.empty() && digits.front() == '_'; }
    /// Whether Verilog reads a bit z.
    bool HasHighImpedance() const {
        return hasLength && digits.find_first_of("zZ?") != std::string::npos;
    }
    /// Whether VHDL-93, or 2008, reads a bit string or, without a length, a string of std_logic.
    bool IsVhdlString(bool is2008) const;
    /// Whether VHDL-93, or 2008, reads a bit vector, which has no bits but 0 and 1.
    bool IsVhdlBitVector() const;
    /// How many elements VHDL's string has.
    std::size_t GetVhdlLength() const;
    /// How many bits the digits need, without leading zeros.
    std::size_t GetNeededBits() const;
    /// The low `width` bits of the number that Verilog reads.
    BitText ReadVerilog(std::size_t width) const;
    /// The bits of VHDL's string.
    BitText ReadVhdl() const;

private:
    /// The digits of a number with a base, as bits.
    std::string ExpandDigits() const;
    /// The digits of a decimal number, without leading zeros.
    std::string GetDecimalDigits() const;
};

} // namespace Orn_Hdl::Checking
