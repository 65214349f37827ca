#include "Proof/Meaning.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <cstdlib>

namespace Orn_Hdl::Proving {

using std::string_view;

namespace {

constexpr std::size_t MostBits = 1'048'576;
constexpr std::size_t MostDecimalDigits = 4096;
constexpr char DontCare = '-';

bool AreAllOf(string_view characters, string_view text) {
    return text.find_first_not_of(characters) == string_view::npos;
}

/// The bits of one digit of a base, leftmost first; empty when it is none.
std::string BitsOfDigit(char digit, int base) {
    const std::size_t count = base == 16 ? 4 : base == 8 ? 3 : 1;
    const char small = Port::ToLower(digit);
    if (small == 'x' || small == 'z' || small == '?') {
        return std::string(count, small == '?' ? 'z' : small);
    }
    const int value = Port::IsDigit(digit)           ? digit - '0'
                      : small >= 'a' && small <= 'f' ? small - 'a' + 10
                                                     : base;
    std::string bits;
    for (std::size_t bit = count; value < base && bit-- > 0;) {
        bits += (value >> bit & 1) != 0 ? '1' : '0';
    }
    return bits;
}

/// Cuts bits off on the left, or fills up there.
void Resize(std::string& bits, std::size_t width) {
    if (bits.size() > width) {
        bits.erase(0, bits.size() - width);
        return;
    }
    const char first = bits.empty() ? '0' : bits.front();
    bits.insert(0, width - bits.size(), first == '1' ? '0' : first);
}

/// \param dontCares whether a digit "-" stands for don't cares, which are bits "-".
std::optional<std::string> BitsOfSized(const BitVectorValue& value, std::size_t width,
                                       bool dontCares) {
    std::string bits;
    for (const char digit : string_view(value.GetValue())) {
        std::string more = digit == '_' ? std::string() : BitsOfDigit(digit, value.GetBase());
        if (dontCares && digit == DontCare) {
            more.assign(BitsOfDigit('0', value.GetBase()).size(), DontCare);
        }
        if (digit != '_' && more.empty()) {
            return std::nullopt;
        }
        bits += more;
    }
    if (bits.empty() || value.GetLength() < 1 ||
        static_cast<std::size_t>(value.GetLength()) > MostBits) {
        return std::nullopt;
    }
    Resize(bits, static_cast<std::size_t>(value.GetLength()));
    Resize(bits, width);
    return bits;
}

/// The bits of a decimal number, by doubling: each digit multiplies what is there by ten.
std::string BitsOfDecimal(string_view digits) {
    std::string bits; // Lowest first.
    for (const char digit : digits) {
        int carry = digit - '0';
        for (char& bit : bits) {
            const int sum = (bit - '0') * 10 + carry;
            bit = static_cast<char>('0' + sum % 2);
            carry = sum / 2;
        }
        for (; carry > 0; carry /= 2) {
            bits += static_cast<char>('0' + carry % 2);
        }
    }
    std::reverse(bits.begin(), bits.end());
    return bits;
}

/// Plain digits are one bit each. When there are not as many as bits, they can be a decimal number,
/// but only one that nobody takes for bits.
/// \param dontCares whether a digit "-" is a don't care; such digits are never a decimal number.
std::optional<std::string> BitsOfPlain(string_view digits, std::size_t width, bool dontCares) {
    if (digits.size() == width && AreAllOf(dontCares ? "01xXzZ-" : "01xXzZ", digits)) {
        std::string bits(digits);
        std::transform(bits.begin(), bits.end(), bits.begin(), Port::ToLower);
        return bits;
    }
    if (digits.empty() || digits.size() > MostDecimalDigits || !AreAllOf("0123456789", digits)) {
        return std::nullopt;
    }
    const string_view significant =
        digits.substr(std::min(digits.find_first_not_of('0'), digits.size()));
    if (significant.size() > 1 && AreAllOf("01", significant)) {
        return std::nullopt;
    }
    std::string bits = BitsOfDecimal(significant);
    if (bits.size() > width) {
        return std::nullopt;
    }
    Resize(bits, width);
    return bits;
}

bool IsSingle(const Signal& signal) {
    const int type = signal.GetSignalType();
    return type == SignalTypeScalar || type == SignalTypeBusIndex;
}

/// Whatever ends a line is a blank.
std::string InOneLine(const Attribute& attribute) {
    std::string text(attribute.GetValueString().GetView());
    std::replace_if(
        text.begin(), text.end(), [](char c) { return c >= '\n' && c <= '\r'; }, ' ');
    return text;
}

/// The characters of a text that holds the escape sequences of Verilog.
std::string WithoutVerilogEscapes(string_view text) {
    constexpr std::size_t OctalDigits = 3;
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '\\' || i + 1 == text.size()) {
            result += text[i];
        } else if (Port::IsDigit(text[i + 1])) {
            result += static_cast<char>(
                std::strtol(std::string(text.substr(i + 1, OctalDigits)).c_str(), nullptr, 8));
            i += OctalDigits;
        } else {
            result += text[++i];
        }
    }
    return result;
}

/// The characters of what stands between the quotes around a VHDL string, which may end the
/// literal, go on with the code of a character, and begin another literal.
std::string WithoutVhdlEscapes(string_view text) {
    constexpr string_view Begin = "\" & character'val(";
    constexpr string_view End = ") & \"";
    constexpr string_view Nothing = "\" & \"";
    std::string result;
    for (std::size_t i = 0; i < text.size();) {
        const string_view rest = text.substr(i);
        const std::size_t end = rest.find(End);
        if (rest.substr(0, Begin.size()) == Begin && end != string_view::npos) {
            result += static_cast<char>(
                std::strtol(std::string(rest.substr(Begin.size(), end)).c_str(), nullptr, 10));
            i += end + End.size();
        } else if (rest.substr(0, Nothing.size()) == Nothing) {
            i += Nothing.size();
        } else {
            result += text[i];
            i += rest.substr(0, 2) == "\"\"" ? 2 : 1;
        }
    }
    return result;
}

std::string WithoutEscapes(const std::string& text, Language language, bool isEscaped) {
    return !isEscaped                   ? text
           : language == Language::Vhdl ? WithoutVhdlEscapes(text)
                                        : WithoutVerilogEscapes(text);
}

bool AreSameNumbers(const std::string& a, const std::string& b) {
    return AttributeFloat("", a.c_str()).GetValue() == AttributeFloat("", b.c_str()).GetValue();
}

/// Whether a number of Verilog is the bits of an attribute.
bool IsSameVector(const BitVectorValue& wanted, const Readers::Value& value) {
    if (wanted.HasBaseAndLength()) {
        if (wanted.GetLength() < 1) {
            return false;
        }
        const auto width = static_cast<std::size_t>(wanted.GetLength());
        const std::optional<std::string> bits = BitsOf(wanted, width);
        if (value.type == Attribute::Bit) {
            return bits == value.text;
        }
        const BitVectorValue read(value.text.c_str());
        return bits && value.type == Attribute::BitVector &&
               read.GetLength() == wanted.GetLength() && bits == BitsOf(read, width);
    }
    const string_view digits = wanted.GetValue();
    const std::optional<std::string> bits = BitsOf(wanted, digits.size());
    return bits && value.type == Attribute::Integer && AreAllOf("01", *bits) &&
           std::count(bits->begin(), bits->end(), '1') <= (bits->back() == '1' ? 1 : 0) &&
           value.text == (bits->back() == '1' ? "1" : "0");
}

/// Whether a bit string of VHDL, which has no length of its own, is the bits of an attribute.
bool IsSameVectorInVhdl(const BitVectorValue& wanted, const Readers::Value& value) {
    const BitVectorValue read(value.text.c_str());
    const std::size_t width = wanted.HasBaseAndLength()
                                  ? static_cast<std::size_t>(std::max(wanted.GetLength(), 0))
                                  : string_view(wanted.GetValue()).size();
    if (value.type != Attribute::BitVector || static_cast<std::size_t>(read.GetLength()) != width) {
        return value.text.empty() && width == 0;
    }
    const std::optional<std::string> bits = BitsOf(wanted, width);
    return bits && bits == BitsOf(read, width);
}

} // namespace

string_view NameInVerilog(string_view name) noexcept {
    if (!name.empty() && name.front() == '\\') {
        name.remove_prefix(1);
        name = name.substr(0, name.find(' '));
    }
    return name;
}

bool IsNothing(string_view name, Language language) noexcept {
    return name.empty() || (language == Language::Vhdl && Port::EqualIgnoringCase(name, "open"));
}

std::optional<std::string> BitsOf(const BitVectorValue& value, std::size_t width, bool dontCares) {
    if (width == 0 || width > MostBits) {
        return std::nullopt;
    }
    return value.HasBaseAndLength() ? BitsOfSized(value, width, dontCares)
                                    : BitsOfPlain(value.GetValue(), width, dontCares);
}

std::optional<std::string> BitsOfConstant(const Signal& signal, bool dontCares, Language language) {
    const BitVectorValue& value = signal.GetConstantValue();
    std::optional<std::string> bits;
    if (IsSingle(signal)) {
        const string_view digits = value.GetValue();
        const char last = digits.empty() ? '1' : digits.back();
        bits = last == '0' ? "0" : dontCares && last == DontCare ? "-" : "1";
    } else {
        bits = BitsOf(value, static_cast<std::size_t>(signal.GetWidth()), dontCares);
    }
    if (bits && language == Language::Verilog) {
        // Verilog has no value that only says that it does not matter.
        std::replace(bits->begin(), bits->end(), DontCare, 'x');
    }
    return bits;
}

std::string TextOf(const Attribute& attribute) {
    std::string text = InOneLine(attribute);
    for (const char quote : {'"', '\''}) {
        if (!text.empty() && text.front() == quote && text.back() == quote) {
            const std::size_t first = text.find_first_not_of(quote);
            const std::size_t last = text.find_last_not_of(quote);
            return first == std::string::npos ? "" : text.substr(first, last - first + 1);
        }
    }
    return text;
}

bool IsSameValue(const Attribute& attribute, const Readers::Value& value, Language language,
                 bool isEscaped) {
    const bool isVhdl = language == Language::Vhdl;
    const std::string text = InOneLine(attribute);
    switch (attribute.GetValueType()) {
    case Attribute::Integer:
        return value.type == Attribute::Integer && value.text == text;
    case Attribute::Float:
        return (value.type == Attribute::Float || (!isVhdl && value.type == Attribute::Integer)) &&
               AreSameNumbers(value.text, text);
    case Attribute::Bit:
        return value.type == Attribute::Bit && value.text == text;
    case Attribute::Boolean:
        return isVhdl
                   ? value.type == Attribute::Boolean && Port::EqualIgnoringCase(value.text, text)
                   : value.type == Attribute::String && value.text == text;
    case Attribute::BitVector: {
        const BitVectorValue wanted =
            static_cast<const AttributeBitVector&>(attribute).GetBitVectorValue();
        return isVhdl ? IsSameVectorInVhdl(wanted, value) : IsSameVector(wanted, value);
    }
    case Attribute::User:
        return isVhdl ? value.text == (text.empty() ? "\"\"" : text)
                      : value.type == Attribute::String &&
                            value.text == WithoutEscapes(text, language, isEscaped);
    default:
        return IsSameText(attribute, value, language, isEscaped);
    }
}

bool IsSameText(const Attribute& attribute, const Readers::Value& value, Language language,
                bool isEscaped) {
    return value.type == Attribute::String &&
           value.text == WithoutEscapes(TextOf(attribute), language, isEscaped);
}

} // namespace Orn_Hdl::Proving
