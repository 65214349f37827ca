#include "Legal/Values.h"

#include "Check/Digits.h"
#include "HdlModel/Names/Names.h"
#include "Port/Ascii.h"
#include "Writers/Text.h"

#include <algorithm>
#include <array>

namespace Orn_Hdl::Legal {

using Checking::Digits;
using std::string_view;

namespace {

bool AreAllOf(string_view characters, string_view text) {
    return text.find_first_not_of(characters) == string_view::npos;
}

/// One digit a bit, without length and base.
std::string ReadBinary(string_view digits) {
    std::string bits(digits);
    std::transform(bits.begin(), bits.end(), bits.begin(), Port::ToLower);
    return bits;
}

/// The bits of digits with a length and a base.
std::optional<std::string> FindSizedBits(const Digits& digits, std::size_t width) {
    const bool fits = digits.length > 0 && static_cast<std::size_t>(digits.length) == width &&
                      digits.IsVerilogNumber() && digits.GetNeededBits() <= width;
    return fits ? digits.ReadVerilog(width) : std::nullopt;
}

/// The bits of plain digits: one digit a bit, or else a decimal number that cannot be mistaken for
/// bits.
std::optional<std::string> FindPlainBits(const Digits& digits, std::size_t width) {
    const std::string& text = digits.digits;
    if (text.size() == width && AreAllOf("01XZxz", text)) {
        return ReadBinary(text);
    }
    if (!std::all_of(text.begin(), text.end(), Port::IsDigit) || digits.GetNeededBits() > width) {
        return std::nullopt;
    }
    std::optional<std::string> bits = digits.ReadVerilog(width);
    if (bits && AreAllOf("01", text)) {
        const std::string significant = text.substr(std::min(text.find('1'), text.size()));
        const bool isSame = significant.size() <= 1;
        return isSame ? bits : std::nullopt;
    }
    return bits;
}

bool IsControl(char c) {
    const auto byte = static_cast<unsigned char>(c);
    return byte < 0x20 || (byte >= 0x7F && byte < 0xA0);
}

std::string EscapeForVerilog(string_view text) {
    std::string escaped;
    for (const char c : text) {
        escaped.append(c == '"' || c == '\\' ? "\\" : "").append(1, c);
    }
    return escaped;
}

/// The pieces between the quotes that the writer puts around the text.
std::string EscapeForVhdl(string_view text) {
    std::string escaped;
    for (const char c : text) {
        if (IsControl(c)) {
            escaped.append("\" & character'val(");
            escaped.append(std::to_string(static_cast<unsigned char>(c))).append(") & \"");
        } else {
            escaped.append(c == '"' ? 2 : 1, c);
        }
    }
    return escaped;
}

/// A reader of the quoted text in the comment reads the same characters.
std::string HideCommentEnd(string_view text) {
    std::string hidden;
    for (std::size_t i = 0; i < text.size(); ++i) {
        hidden.append(i > 0 && text[i] == '/' && text[i - 1] == '*' ? "\\" : "").append(1, text[i]);
    }
    return hidden;
}

/// The writers remove quotes that enclose a whole value; these are a part of it.
bool IsEnclosed(string_view text, char quote) {
    return !text.empty() && text.front() == quote && text.back() == quote;
}

std::string EscapeFor(const Attribute& attribute, string_view text, Language language,
                      const HdlOptions& options) {
    if (language == Language::Vhdl) {
        const std::string escaped = EscapeForVhdl(text);
        return IsEnclosed(text, '\'') && escaped != text ? "\" & \"" + escaped : escaped;
    }
    std::string escaped = IsGeneric(attribute) ? EscapeForVerilog(text) : std::string(text);
    const int dialect = options.verilog.synthesisType;
    const bool isInBlockComment = dialect == HdlOptions::VerilogOption::SYNPLICITY ||
                                  dialect == HdlOptions::VerilogOption::SYNOPSYS;
    if (attribute.GetSynAttrOption() != Attribute::SynAttrNone && isInBlockComment) {
        escaped = HideCommentEnd(escaped);
    }
    if (IsEnclosed(text, '\'') && escaped != text) {
        escaped.replace(0, 1, "\\047");
    }
    return escaped;
}

/// A text attribute with the options of another one.
std::unique_ptr<Attribute> MakeText(const Attribute& like, const std::string& escaped) {
    auto text = std::make_unique<AttributeString>(like.GetName().CStr(), escaped.c_str());
    text->SetGeneric(like.GetGeneric().CStr());
    text->SetSynAttr(like.GetSynAttr().CStr());
    return text;
}

/// Whether the value is written as a text in the language, and can be made another text.
bool IsWrittenAsText(const Attribute& attribute, const Plan& plan, Language language) {
    const bool isPlain = !IsGeneric(attribute) && !plan.GetOptions().vhdl.useAttrType;
    switch (attribute.GetValueType()) {
    case Attribute::String:
        return true;
    case Attribute::User:
        return language == Language::Verilog || isPlain || plan.IsText(attribute);
    case Attribute::BitVector:
        return isPlain;
    default:
        return false;
    }
}

std::unique_ptr<Attribute> Clone(const Attribute& attribute) {
    return std::unique_ptr<Attribute>(attribute.CloneAttribute());
}

} // namespace

std::optional<std::string> FindBits(const BitVectorValue& value, std::size_t width,
                                    bool dontCares) {
    if (width == 0 || width > static_cast<std::size_t>(Names::MostExpandedBits)) {
        return std::nullopt;
    }
    const Digits digits(value, dontCares);
    return digits.hasLength ? FindSizedBits(digits, width) : FindPlainBits(digits, width);
}

std::optional<std::string> FindBits(const BitVectorValue& value) {
    const Digits digits(value);
    const std::optional<std::string> bits =
        digits.hasLength
            ? FindBits(value, static_cast<std::size_t>(std::max(digits.length, 0)), false)
            : digits.digits;
    return bits && !bits->empty() && AreAllOf("01", *bits) ? bits : std::nullopt;
}

BitVectorValue MakeConstant(const std::string& bits, Language language) {
    if (language == Language::Verilog) {
        return BitVectorValue((std::to_string(bits.size()) + ":B:" + bits).c_str());
    }
    // A string of std_logic has x and z in VHDL-93 too, which a bit string has not.
    std::string capitals(bits);
    std::transform(capitals.begin(), capitals.end(), capitals.begin(), Port::ToUpper);
    return BitVectorValue(capitals.c_str());
}

std::unique_ptr<Attribute> CopyAttribute(const Attribute& attribute, const Plan& plan,
                                         Language language) {
    std::unique_ptr<Attribute> copy = Clone(attribute);
    if (plan.NeedsBits(attribute)) {
        const auto& vector = static_cast<const AttributeBitVector&>(attribute);
        const std::string bits = FindBits(vector.GetBitVectorValue()).value_or("");
        copy->SetValue((std::to_string(bits.size()) + ":B:" + bits).c_str());
    } else if (IsWrittenAsText(attribute, plan, language)) {
        const Port::String text = Writers::GetUnquotedValue(attribute);
        const std::string escaped =
            EscapeFor(attribute, text.GetView(), language, plan.GetOptions());
        const bool isQuotedUser = attribute.GetValueType() == Attribute::User &&
                                  text.GetView() != attribute.GetValueString().GetView();
        if (escaped != text.GetView() || isQuotedUser || plan.IsText(attribute)) {
            copy = MakeText(attribute, escaped);
        }
    }
    if (plan.NeedsDeclaration(attribute)) {
        copy->SetSynAttr("ASSIGN");
    }
    return copy;
}

bool CanBeEscaped(const Attribute& attribute) {
    const Port::String text = Writers::GetUnquotedValue(attribute);
    return !IsEnclosed(EscapeForVhdl(text.GetView()), '"');
}

std::string WithoutDirective(string_view line) {
    static constexpr std::array<string_view, 4> Words = {"synopsys", "synthesis", "pragma",
                                                         "verilator"};
    const string_view text = line.substr(std::min(line.find_first_not_of(' '), line.size()));
    const bool isDirective = std::any_of(Words.begin(), Words.end(), [text](string_view word) {
        return text.substr(0, word.size()) == word;
    });
    return isDirective ? "\"" + std::string(line) + "\"" : std::string(line);
}

} // namespace Orn_Hdl::Legal
