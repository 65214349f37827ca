// What the readers of module heads and of modules do alike with tokens.
#pragma once

#include "Readers/Verilog/Keywords.h"
#include "Readers/Verilog/Scanner.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace Orn_Hdl::Readers {

class Parser {
public:
    explicit Parser(Scanner& scanner) : scanner_(scanner) {}

    const Token& Get() const noexcept { return scanner_.Get(); }
    void Next() { scanner_.Next(); }
    [[noreturn]] void Fail(std::string_view text) const { scanner_.Fail(text); }
    [[noreturn]] void Fail(const Place& place, std::string_view text) const {
        scanner_.Fail(place, text);
    }

    bool IsSign(char sign) const noexcept {
        return Get().kind == TokenKind::Sign && Get().sign == sign;
    }
    bool IsName() const noexcept {
        return Get().kind == TokenKind::Name || Get().kind == TokenKind::EscapedName;
    }
    /// The keyword that the token is.
    Keyword GetKeyword() const noexcept {
        return Get().kind == TokenKind::Name ? FindKeyword(Get().text) : Keyword::None;
    }
    bool IsWord(std::string_view word) const noexcept {
        return Get().kind == TokenKind::Name && Get().text == word;
    }
    /// Reads the next token if this one is the sign.
    bool Accept(char sign) {
        if (!IsSign(sign)) {
            return false;
        }
        Next();
        return true;
    }
    /// Reads the next token behind a sign that has to be there.
    void Expect(char sign);
    /// Throws for a token that is not what has to be there.
    [[noreturn]] void FailExpected(std::string_view what) const;
    /// The token as messages show it.
    std::string Show() const;
    /// Takes a name that is no keyword.
    void TakeName(std::string& name, std::string_view what);

    /// Skips to a word.
    void SkipToWord(std::string_view word, const Place& begin);
    /// Skips to a word, and over it.
    void SkipBehind(std::string_view word, const Place& begin);
    /// Skips to a sign that is in no parentheses, brackets or braces opened behind this place, or
    /// to a semicolon.
    void SkipTo(char sign, char other);
    /// Skips attributes in "(*" and "*)".
    void SkipAttributes();

    /// What a name stands for in a constant expression.
    using Resolve = std::function<std::optional<std::int64_t>(std::string_view name)>;
    /// Reads a constant expression of integers.
    /// \param isNegated whether a minus sign is in front, which was read.
    /// \return nothing when the expression holds anything else; the token is where that begins.
    std::optional<std::int64_t> ReadInteger(const Resolve& resolve, bool isNegated = false);

private:
    std::optional<std::int64_t> ReadSum(const Resolve& resolve, bool isNegated = false);
    std::optional<std::int64_t> ReadProduct(const Resolve& resolve, bool isNegated = false);
    std::optional<std::int64_t> ReadOperand(const Resolve& resolve, bool isNegated = false);

    Scanner& scanner_;
    std::size_t depth_ = 0;
};

} // namespace Orn_Hdl::Readers
