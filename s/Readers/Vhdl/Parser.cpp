#include "Readers/Vhdl/Parser.h"

#include "Port/Ascii.h"
#include "Readers/Heads.h"
#include "Readers/Limits.h"
#include "Readers/Vhdl/Literals.h"

namespace Orn_Hdl::Readers::Vhdl {

namespace {

/// Keeps sums and products within 64 bits.
constexpr std::int64_t LargestInteger = std::int64_t(1) << 31;

std::optional<std::int64_t> Limited(std::int64_t value) {
    return value > LargestInteger || value < -LargestInteger ? std::nullopt
                                                             : std::optional<std::int64_t>(value);
}

std::string_view TextOfSign(char sign) {
    switch (sign) {
    case Arrow:
        return "=>";
    case LeftArrow:
        return "<=";
    case Becomes:
        return ":=";
    default:
        return {};
    }
}

/// The token as it stands in the file.
std::string SourceOf(const Token& token) {
    switch (token.kind) {
    case TokenKind::String:
        return std::string("\"").append(token.text).append("\"");
    case TokenKind::Character:
        return std::string("'").append(token.text).append("'");
    default:
        return std::string(token.text);
    }
}

} // namespace

bool Parser::IsWord(std::string_view word) const noexcept {
    return Get().kind == TokenKind::Name && Port::EqualIgnoringCase(Get().text, word);
}

bool Parser::Accept(char sign) {
    if (!IsSign(sign)) {
        return false;
    }
    Next();
    return true;
}

bool Parser::Accept(Keyword keyword) {
    if (GetKeyword() != keyword) {
        return false;
    }
    Next();
    return true;
}

std::string Parser::Show() const {
    const Token& token = Get();
    switch (token.kind) {
    case TokenKind::End:
        return "the end of the file";
    case TokenKind::String:
        return "a string";
    default:
        return Quoted(SourceOf(token));
    }
}

void Parser::FailExpected(std::string_view what) const {
    Fail(std::string(what) + " is expected here, not " + Show());
}

void Parser::Expect(char sign) {
    if (!Accept(sign)) {
        const std::string_view text = TextOfSign(sign);
        FailExpected(Quoted(text.empty() ? std::string_view(&sign, 1) : text));
    }
}

void Parser::Expect(Keyword keyword, std::string_view word) {
    if (!Accept(keyword)) {
        FailExpected(Quoted(word));
    }
}

void Parser::TakeName(std::string& name, std::string_view what) {
    if (!IsName()) {
        FailExpected("the " + std::string(what));
    }
    if (GetKeyword() != Keyword::None) {
        Fail(Quoted(Get().text) + " is a reserved word and no " + std::string(what));
    }
    name = Get().text;
    Next();
}

bool Parser::TakeSelectedName(std::string& name, std::string_view what) {
    TakeName(name, what);
    bool isSelected = false;
    while (Accept('.')) {
        isSelected = true;
        TakeName(name, what);
    }
    return isSelected;
}

void Parser::SkipTo(char sign, char other) {
    std::size_t depth = 0;
    for (; !IsEnd() && !IsSign(';'); Next()) {
        if (depth == 0 && (IsSign(sign) || IsSign(other))) {
            return;
        }
        if (IsSign('(')) {
            ++depth;
        } else if (depth > 0 && IsSign(')')) {
            --depth;
        }
    }
}

std::string Parser::TakeSource(char sign, char other) {
    std::string text;
    std::size_t depth = 0;
    Place end = Get().place;
    for (; !IsEnd() && !IsSign(';'); Next()) {
        if (depth == 0 && (IsSign(sign) || IsSign(other))) {
            break;
        }
        const Place& begin = Get().place;
        if (!text.empty() && (begin.line != end.line || begin.column != end.column)) {
            text += ' ';
        }
        text += SourceOf(Get());
        end = scanner_.GetPlace();
        depth += IsSign('(') ? 1 : 0;
        depth -= depth > 0 && IsSign(')') ? 1 : 0;
    }
    return text;
}

void Parser::SkipStatement() {
    scanner_.SkipToSemicolon();
    Expect(';');
}

void Parser::SkipEnd(const std::string& name) {
    while (!IsSign(';')) {
        if (!IsName()) {
            FailExpected("\";\"");
        }
        if (GetKeyword() == Keyword::None && !IsSameName(Get().text, name, true)) {
            Fail("the end of " + Quoted(name) + " has another name");
        }
        Next();
    }
    Next();
}

std::optional<std::int64_t> Parser::ReadInteger(const Resolve& resolve) {
    if (depth_ >= DeepestExpression) {
        Fail("an expression that is nested too deeply");
    }
    ++depth_;
    const std::optional<std::int64_t> value = ReadSum(resolve);
    --depth_;
    return value;
}

std::optional<std::int64_t> Parser::ReadSum(const Resolve& resolve) {
    // A sign belongs to the first term as a whole.
    const bool isNegative = IsSign('-');
    if (isNegative || IsSign('+')) {
        Next();
    }
    std::optional<std::int64_t> sum = ReadProduct(resolve);
    if (sum && isNegative) {
        sum = -*sum;
    }
    while (sum && (IsSign('+') || IsSign('-'))) {
        const bool isMinus = IsSign('-');
        Next();
        const std::optional<std::int64_t> other = ReadProduct(resolve);
        sum = other ? Limited(isMinus ? *sum - *other : *sum + *other) : std::nullopt;
    }
    return sum;
}

std::optional<std::int64_t> Parser::ReadProduct(const Resolve& resolve) {
    std::optional<std::int64_t> product = ReadPower(resolve);
    while (product && (IsSign('*') || IsSign('/'))) {
        const bool isTimes = IsSign('*');
        Next();
        const std::optional<std::int64_t> other = ReadPower(resolve);
        if (!other || (*other == 0 && !isTimes)) {
            return std::nullopt;
        }
        product = Limited(isTimes ? *product * *other : *product / *other);
    }
    return product;
}

/// "2**3"
std::optional<std::int64_t> Parser::ReadPower(const Resolve& resolve) {
    const std::optional<std::int64_t> base = ReadOperand(resolve);
    if (!base || !IsSign(OtherOperator) || Get().text != "**") {
        return base;
    }
    Next();
    const std::optional<std::int64_t> exponent = ReadOperand(resolve);
    constexpr std::int64_t LargestExponent = 31;
    if (!exponent || *exponent < 0 || *exponent > LargestExponent) {
        return std::nullopt;
    }
    std::optional<std::int64_t> power = 1;
    for (std::int64_t i = 0; power && i < *exponent; ++i) {
        power = Limited(*power * *base);
    }
    return power;
}

std::optional<std::int64_t> Parser::ReadOperand(const Resolve& resolve) {
    std::optional<std::int64_t> value;
    if (Accept('(')) {
        value = ReadInteger(resolve);
        if (!value || !IsSign(')')) {
            // What follows is outside of the parentheses.
            SkipTo(')', ')');
            value.reset();
        }
        Accept(')');
    } else if (Get().kind == TokenKind::Number) {
        value = GetInteger(Get().text);
        if (value) {
            Next();
        }
    } else if (IsName() && GetKeyword() == Keyword::None) {
        value = resolve(Get().text);
        if (value) {
            Next();
        }
    }
    return value ? Limited(*value) : std::nullopt;
}

} // namespace Orn_Hdl::Readers::Vhdl
