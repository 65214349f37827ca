#include "Readers/Verilog/Parser.h"

#include "Readers/Limits.h"
#include "Readers/Verilog/Literals.h"

namespace Orn_Hdl::Readers {

namespace {

/// Keeps sums and products within 64 bits.
constexpr std::int64_t LargestInteger = std::int64_t(1) << 31;

std::optional<std::int64_t> Limited(std::int64_t value) {
    return value > LargestInteger || value < -LargestInteger ? std::nullopt
                                                             : std::optional<std::int64_t>(value);
}

} // namespace

std::string Parser::Show() const {
    const Token& token = Get();
    switch (token.kind) {
    case TokenKind::End:
        return "the end of the file";
    case TokenKind::String:
        return "a string";
    case TokenKind::AttributesBegin:
        return "\"(*\"";
    case TokenKind::AttributesEnd:
        return "\"*)\"";
    case TokenKind::Sign:
        if (token.sign == PlusColon || token.sign == MinusColon) {
            return token.sign == PlusColon ? "\"+:\"" : "\"-:\"";
        }
        return std::string("\"") + token.sign + "\"";
    default:
        return Quoted(token.text);
    }
}

void Parser::FailExpected(std::string_view what) const {
    Fail(std::string(what) + " is expected here, not " + Show());
}

void Parser::Expect(char sign) {
    if (!Accept(sign)) {
        FailExpected(std::string("\"") + sign + "\"");
    }
}

void Parser::TakeName(std::string& name, std::string_view what) {
    if (!IsName()) {
        FailExpected(what);
    }
    if (GetKeyword() != Keyword::None) {
        Fail(Quoted(Get().text) + " is a keyword and no " + std::string(what) +
             " unless a backslash stands before it");
    }
    name = Get().text;
    Next();
}

void Parser::SkipToWord(std::string_view word, const Place& begin) {
    while (!IsWord(word)) {
        if (Get().kind == TokenKind::End) {
            Fail(begin, "\"" + std::string(word) + "\" does not follow this");
        }
        Next();
    }
}

void Parser::SkipBehind(std::string_view word, const Place& begin) {
    SkipToWord(word, begin);
    Next();
}

void Parser::SkipTo(char sign, char other) {
    std::size_t depth = 0;
    for (; Get().kind != TokenKind::End && !IsSign(';'); Next()) {
        if (depth == 0 && (IsSign(sign) || IsSign(other))) {
            return;
        }
        if (IsSign('(') || IsSign('[') || IsSign('{')) {
            ++depth;
        } else if (depth > 0 && (IsSign(')') || IsSign(']') || IsSign('}'))) {
            --depth;
        }
    }
}

void Parser::SkipAttributes() {
    while (Get().kind == TokenKind::AttributesBegin) {
        const Place begin = Get().place;
        while (Get().kind != TokenKind::AttributesEnd) {
            if (Get().kind == TokenKind::End) {
                Fail(begin, "\"*)\" does not follow this");
            }
            Next();
        }
        Next();
    }
}

std::optional<std::int64_t> Parser::ReadInteger(const Resolve& resolve, bool isNegated) {
    if (depth_ >= DeepestExpression) {
        Fail("an expression that is nested too deeply");
    }
    ++depth_;
    const std::optional<std::int64_t> value = ReadSum(resolve, isNegated);
    --depth_;
    return value;
}

std::optional<std::int64_t> Parser::ReadSum(const Resolve& resolve, bool isNegated) {
    std::optional<std::int64_t> sum = ReadProduct(resolve, isNegated);
    while (sum && (IsSign('+') || IsSign('-'))) {
        const bool isMinus = IsSign('-');
        Next();
        const std::optional<std::int64_t> other = ReadProduct(resolve);
        sum = other ? Limited(isMinus ? *sum - *other : *sum + *other) : std::nullopt;
    }
    return sum;
}

std::optional<std::int64_t> Parser::ReadProduct(const Resolve& resolve, bool isNegated) {
    std::optional<std::int64_t> product = ReadOperand(resolve, isNegated);
    while (product && (IsSign('*') || IsSign('/') || IsSign('%'))) {
        const char sign = Get().sign;
        Next();
        const std::optional<std::int64_t> other = ReadOperand(resolve);
        if (!other || (*other == 0 && sign != '*')) {
            return std::nullopt;
        }
        product = Limited(sign == '*'   ? *product * *other
                          : sign == '/' ? *product / *other
                                        : *product % *other);
    }
    return product;
}

std::optional<std::int64_t> Parser::ReadOperand(const Resolve& resolve, bool isNegated) {
    bool isNegative = isNegated;
    while (IsSign('-') || IsSign('+')) {
        isNegative = isNegative != IsSign('-');
        Next();
    }
    std::optional<std::int64_t> value;
    if (Accept('(')) {
        value = ReadInteger(resolve);
        if (!value || !Accept(')')) {
            return std::nullopt;
        }
    } else if (Get().kind == TokenKind::Number) {
        try {
            value = Number::Read(Get().text).GetValue();
        } catch (const LiteralProblem& problem) {
            Fail(problem.text);
        }
        Next();
    } else if (IsName() && GetKeyword() == Keyword::None) {
        value = resolve(Get().text);
        if (value) {
            Next();
        }
    }
    if (!value) {
        return std::nullopt;
    }
    return Limited(isNegative ? -*value : *value);
}

} // namespace Orn_Hdl::Readers
