// What the readers of design units do alike with tokens.
#pragma once

#include "Readers/Vhdl/Keywords.h"
#include "Readers/Vhdl/Scanner.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace Orn_Hdl::Readers::Vhdl {

/// What to say of text that describes behaviour.
constexpr std::string_view SynthesiseFirst = " describes behaviour: synthesise the design first";

class Parser {
public:
    explicit Parser(Scanner& scanner) : scanner_(scanner) {}

    const Token& Get() const noexcept { return scanner_.Get(); }
    void Next() {
        if (IsEnd() && Get().place.line > 0) {
            FailExpected("more");
        }
        scanner_.Next();
    }
    [[noreturn]] void Fail(std::string_view text) const { scanner_.Fail(text); }
    [[noreturn]] void Fail(const Place& place, std::string_view text) const {
        scanner_.Fail(place, text);
    }

    bool IsSign(char sign) const noexcept {
        return Get().kind == TokenKind::Sign && Get().sign == sign;
    }
    bool IsName() const noexcept {
        return Get().kind == TokenKind::Name || Get().kind == TokenKind::ExtendedName;
    }
    bool IsEnd() const noexcept { return Get().kind == TokenKind::End; }
    /// The reserved word that the token is.
    Keyword GetKeyword() const noexcept {
        return Get().kind == TokenKind::Name ? FindKeyword(Get().text) : Keyword::None;
    }
    /// Whether the token is a word, in any letter case, that is no reserved word of all standards.
    bool IsWord(std::string_view word) const noexcept;
    /// Reads the next token if this one is the sign, or the reserved word.
    bool Accept(char sign);
    bool Accept(Keyword keyword);
    /// Reads the next token behind a sign, or a reserved word, that has to be there.
    void Expect(char sign);
    void Expect(Keyword keyword, std::string_view word);
    /// Throws for a token that is not what has to be there.
    [[noreturn]] void FailExpected(std::string_view what) const;
    /// The token as messages show it.
    std::string Show() const;
    /// Takes a name that is no reserved word.
    void TakeName(std::string& name, std::string_view what);
    /// Takes the names that stand between dots; the last one is left in `name`.
    /// \return whether there was a dot.
    bool TakeSelectedName(std::string& name, std::string_view what);

    /// Skips to one of two signs that is in no parentheses opened behind this place, or to a
    /// semicolon.
    void SkipTo(char sign, char other);
    /// The text of the tokens up to where `SkipTo` would stop, with blanks where the file has some.
    std::string TakeSource(char sign, char other);
    /// Skips a semicolon and everything in front of it.
    void SkipStatement();
    /// Reads what may stand between "end" and the semicolon: keywords, and the name of what ends.
    void SkipEnd(const std::string& name);

    /// What a name stands for in a constant expression.
    using Resolve = std::function<std::optional<std::int64_t>(std::string_view name)>;
    /// Reads a constant expression of integers.
    /// \return nothing when the expression holds anything else; the token is where that begins.
    std::optional<std::int64_t> ReadInteger(const Resolve& resolve);

private:
    std::optional<std::int64_t> ReadSum(const Resolve& resolve);
    std::optional<std::int64_t> ReadProduct(const Resolve& resolve);
    std::optional<std::int64_t> ReadPower(const Resolve& resolve);
    std::optional<std::int64_t> ReadOperand(const Resolve& resolve);

    Scanner& scanner_;
    std::size_t depth_ = 0;
};

} // namespace Orn_Hdl::Readers::Vhdl
