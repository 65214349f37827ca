#include "Check/AttributeValues.h"

#include "Check/Digits.h"
#include "Port/Ascii.h"
#include "Writers/Text.h"

#include <algorithm>

namespace Orn_Hdl::Checking {

using std::string_view;

namespace {

/// Types that every netlist can see.
constexpr string_view VisibleTypes[] = {"bit",
                                        "bit_vector",
                                        "boolean",
                                        "character",
                                        "integer",
                                        "natural",
                                        "positive",
                                        "real",
                                        "signed",
                                        "std_logic",
                                        "std_logic_vector",
                                        "std_ulogic",
                                        "string",
                                        "time",
                                        "std_ulogic_vector",
                                        "unsigned",
                                        "severity_level",
                                        "x01",
                                        "x01z",
                                        "ux01",
                                        "ux01z",
                                        "delay_length"};

bool IsNumber(string_view text, bool isReal) {
    if (!text.empty() && (text.front() == '-' || text.front() == '+')) {
        text.remove_prefix(1);
    }
    const bool hasPoint = text.find('.') != string_view::npos;
    return !text.empty() && Port::IsDigit(text.front()) && Port::IsDigit(text.back()) &&
           hasPoint == isReal && std::all_of(text.begin(), text.end(), [](char c) {
               return Port::IsDigit(c) || c == '.';
           });
}

bool IsQuotedBy(string_view text, char quote) {
    return text.size() >= 2 && text.front() == quote && text.back() == quote;
}

/// Whether a text is a string literal of these characters.
bool IsStringOf(string_view characters, string_view text) {
    return IsQuotedBy(text, '"') &&
           text.substr(1, text.size() - 2).find_first_not_of(characters) == string_view::npos;
}

bool IsControl(char c) {
    const auto byte = static_cast<unsigned char>(c);
    return byte < 0x20 || (byte >= 0x7F && byte < 0xA0);
}

/// One value and the places where it is written.
class ValueCheck {
public:
    ValueCheck(Context& context, const Holder& holder, const Attribute& attribute,
               const Places& places)
        : context_(context), holder_(holder), attribute_(attribute), places_(places) {}

    void CheckAll();

private:
    void CheckText(string_view text, bool isInVhdl);
    void CheckDigits();
    void CheckLength(const Digits& digits);
    void CheckUser();
    Finding* Add(RuleId rule, const Verdicts& verdicts) {
        return AddFinding(context_, rule, verdicts, holder_, attribute_);
    }

    Context& context_;
    const Holder& holder_;
    const Attribute& attribute_;
    const Places& places_;
};

void ValueCheck::CheckAll() {
    if (places_.vhdl && places_.typed) {
        context_.usedTypes.insert(TypeOf(attribute_));
        if (attribute_.GetValueType() == Attribute::Boolean) {
            context_.usedTypes.insert(Lower(attribute_.GetValueString().GetView()));
        }
    }
    switch (attribute_.GetValueType()) {
    case Attribute::String:
        CheckText(Writers::GetUnquotedValue(attribute_).GetView(), places_.vhdl);
        break;
    case Attribute::User: {
        const Port::String text = attribute_.GetValueString();
        CheckText(places_.verilogNumber ? text.GetView()
                                        : Writers::GetUnquotedValue(attribute_).GetView(),
                  places_.vhdl && !places_.typed);
        if (places_.vhdl && places_.typed && places_.bound) {
            CheckUser();
        }
        break;
    }
    case Attribute::BitVector:
        if (places_.verilogNumber || places_.typed) {
            CheckDigits();
        } else {
            CheckText(Writers::GetUnquotedValue(attribute_).GetView(), places_.vhdl);
        }
        break;
    default:
        break;
    }
}

void ValueCheck::CheckText(string_view text, bool isInVhdl) {
    if (context_.isMended) {
        return;
    }
    if (text.find('"') != string_view::npos && (places_.verilogNumber || isInVhdl)) {
        Verdicts verdicts(places_.verilogNumber ? "rrr..rrr" : "");
        verdicts.Worsen(Verdicts(isInVhdl ? "...rr...r" : ""));
        if (Finding* finding = Add(RuleId::QuoteInValue, verdicts)) {
            finding->message =
                "the value of " + holder_.Describe(attribute_) + " holds a double quote";
        }
    }
    const bool endsComment = text.find("*/") != string_view::npos ||
                             attribute_.GetNameView().find("*/") != string_view::npos;
    if (places_.verilogComment && endsComment) {
        if (Finding* finding =
                Add(RuleId::CommentInValue, GetRule(RuleId::CommentInValue).verdicts)) {
            finding->message = holder_.Describe(attribute_) + " holds */, which ends its comment";
        }
    }
    if (places_.verilogNumber && text.find('\\') != string_view::npos) {
        const bool isLast = text.back() == '\\';
        if (Finding* finding =
                Add(RuleId::BackslashInValue, Verdicts(isLast ? "rrr..rrr" : "mmm..mmm"))) {
            finding->message = "the value of " + holder_.Describe(attribute_) +
                               (isLast ? " ends in a backslash, which hides the closing quote"
                                       : " holds a backslash");
        }
    }
    if (isInVhdl && std::any_of(text.begin(), text.end(), IsControl)) {
        if (Finding* finding =
                Add(RuleId::CharacterInValue, GetRule(RuleId::CharacterInValue).verdicts)) {
            finding->message =
                "the value of " + holder_.Describe(attribute_) + " holds a control character";
        }
    }
}

void ValueCheck::CheckDigits() {
    const Digits digits(static_cast<const AttributeBitVector&>(attribute_).GetBitVectorValue());
    Verdicts characters(places_.vhdl && places_.typed && !digits.IsVhdlBitVector() ? "...rr...r"
                                                                                   : "");
    const bool isNumber = digits.IsVerilogNumber();
    characters.Worsen(Verdicts(places_.verilogNumber && !isNumber ? "rrr..rrr" : ""));
    if (Finding* finding = Add(RuleId::ConstantCharacter, characters)) {
        finding->message = "the value " + Quoted(digits.digits) + " of " +
                           holder_.Describe(attribute_) + " has a character that is no digit";
    }
    if (digits.hasLength) {
        CheckLength(digits);
    } else if (places_.verilogNumber && isNumber) {
        const BitText read = digits.ReadVerilog(digits.digits.size());
        const bool isLong = digits.GetNeededBits() > 32;
        const bool differs = !read || *read != digits.digits || isLong;
        const Verdicts verdicts(!differs ? "" : isLong ? "mmm..mrm" : "mmm..mmm");
        if (Finding* finding = Add(RuleId::GenericDigits, verdicts)) {
            finding->message = "the value " + Quoted(digits.digits) + " of " +
                               holder_.Describe(attribute_) + " is a decimal number in Verilog";
        }
    }
}

/// The length that stands before the digits. VHDL has as many bits as the digits stand for.
void ValueCheck::CheckLength(const Digits& digits) {
    Verdicts verdicts;
    if (places_.verilogNumber && digits.IsVerilogNumber()) {
        const bool isCut =
            digits.length > 0 && digits.GetNeededBits() > static_cast<std::size_t>(digits.length);
        verdicts = Verdicts(digits.length == 0  ? "rrr..r.r"
                            : digits.length < 0 ? "mmm..mmm"
                            : isCut             ? "mmm..mrm"
                                                : "");
    }
    const bool isAsLong =
        digits.length >= 0 && digits.GetVhdlLength() == static_cast<std::size_t>(digits.length);
    if (places_.vhdl && places_.typed && digits.IsVhdlBitVector() && !isAsLong) {
        verdicts.Worsen(Verdicts("...mm...m"));
    }
    if (Finding* finding = Add(RuleId::ConstantLength, verdicts)) {
        finding->message = "the value " + Quoted(digits.digits) + " of " +
                           holder_.Describe(attribute_) + " does not fit its length";
    }
}

void ValueCheck::CheckUser() {
    const std::string type = TypeOf(attribute_);
    const bool isVisible = IsVisibleType(type);
    if (type.empty() || !isVisible) {
        const bool mayBeDeclared = !type.empty() && context_.options.vhdl.useClauses.GetSize() > 0;
        if (Finding* finding =
                Add(RuleId::UserType, Verdicts(mayBeDeclared ? "...ww...w" : "...rr...r"))) {
            finding->message =
                holder_.Describe(attribute_) +
                (type.empty() ? " has no type's name"
                              : " has the type " + Quoted(type) + ", which nothing declares");
        }
        return;
    }
    const Port::String value = attribute_.GetValueString();
    if (!CanBeValueOf(type, value.GetView())) {
        if (Finding* finding = Add(RuleId::UserValue, GetRule(RuleId::UserValue).verdicts)) {
            finding->message = "the value " + Quoted(value.GetView()) + " of " +
                               holder_.Describe(attribute_) + " is no value of the type " + type;
        }
    }
}

} // namespace

void CheckValue(Context& context, const Holder& holder, const Attribute& attribute,
                const Places& places) {
    ValueCheck(context, holder, attribute, places).CheckAll();
}

bool IsVisibleType(string_view type) {
    return std::find(std::begin(VisibleTypes), std::end(VisibleTypes), type) !=
           std::end(VisibleTypes);
}

bool CanBeValueOf(string_view type, string_view text) {
    if (type == "integer") {
        return IsNumber(text, false);
    }
    if (type == "natural" || type == "positive") {
        return IsNumber(text, false) && text.front() != '-' && (type == "natural" || text != "0");
    }
    if (type == "real") {
        return IsNumber(text, true);
    }
    if (type == "boolean") {
        return Port::EqualIgnoringCase(text, "true") || Port::EqualIgnoringCase(text, "false");
    }
    if (type == "bit") {
        return text == "'0'" || text == "'1'";
    }
    if (type == "std_logic" || type == "std_ulogic" || type == "character") {
        return text.size() == 3 && IsQuotedBy(text, '\'') &&
               (type == "character" || StdLogic.find(text[1]) != string_view::npos);
    }
    if (type == "bit_vector") {
        return text.empty() || IsStringOf("01", text);
    }
    if (type == "std_logic_vector") {
        return text.empty() || IsStringOf(StdLogic, text);
    }
    if (type == "string") {
        return text.empty() || (IsQuotedBy(text, '"') &&
                                text.substr(1, text.size() - 2).find('"') == string_view::npos);
    }
    return !text.empty();
}

} // namespace Orn_Hdl::Checking
