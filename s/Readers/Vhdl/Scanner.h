// The words and signs of VHDL source text, as IEEE 1076-1993 clause 13 and IEEE 1076-2008 clause 15
// define them.
#pragma once

#include "Readers/Comments.h"
#include "Readers/InputText.h"
#include "Readers/Place.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

enum class TokenKind : std::uint8_t {
    End,
    /// A basic identifier or a reserved word.
    Name,
    /// An extended identifier with its backslashes.
    ExtendedName,
    /// A number as it stands in the file.
    Number,
    /// A bit string literal as it stands in the file, such as X"0F".
    BitString,
    /// A string; the text is what stands between the quotes.
    String,
    /// A character literal; the text is the character.
    Character,
    /// Any other character, or one of the signs of several characters.
    Sign
};

/// The signs of several characters.
constexpr char Arrow = 'A';         // =>
constexpr char LeftArrow = 'L';     // <=
constexpr char Becomes = 'B';       // :=
constexpr char OtherOperator = 'O'; // ** /= >= <> ?? ?= ?/= ?< ?<= ?> ?>= << >>

struct Token {
    TokenKind kind = TokenKind::End;
    /// The character of a sign.
    char sign = '\0';
    /// Valid until the next token is read.
    std::string_view text;
    Place place;
};

class Scanner {
public:
    /// Which comments are kept, by their texts; null for none.
    using CommentFilter = bool (*)(std::string_view text);

    /// \param files must outlive the scanner.
    explicit Scanner(Files& files) : files_(files) {}
    Scanner(const Scanner&) = delete;
    Scanner& operator=(const Scanner&) = delete;

    /// Starts reading a file; the first token is read by `Next`.
    void Open(const std::string& fileName);
    /// Reads the next token.
    void Next();
    /// Reads on to the next semicolon, which is the token then, without looking at the tokens
    /// before it. Nothing happens when the token is one.
    void SkipToSemicolon();
    /// The token that was read last.
    const Token& Get() const noexcept { return token_; }
    /// The place of the token in front of it.
    const Place& GetFormerPlace() const noexcept { return formerPlace_; }
    /// The place behind the last character that was read.
    Place GetPlace() const noexcept;

    void SetCommentFilter(CommentFilter filter) noexcept { filter_ = filter; }
    /// The comments that were kept since the list was emptied.
    std::vector<Comment>& GetComments() noexcept { return comments_; }

    /// Throws for an error at the token that was read last.
    [[noreturn]] void Fail(std::string_view text) const { FailAt(files_, token_.place, text); }
    [[noreturn]] void Fail(const Place& place, std::string_view text) const {
        FailAt(files_, place, text);
    }
    const Files& GetFiles() const noexcept { return files_; }

private:
    char Peek(std::size_t count);
    bool IsAtEnd() { return text_.current == text_.end && !text_.ReadOn(); }
    void EndLine() noexcept;
    bool SkipBlanks();
    void SkipLineComment();
    void SkipBlockComment();
    void LimitComment();
    void KeepComment(bool isBlock, const Place& place);
    template <class IsPart> void SkipWhile(IsPart isPart);
    std::string_view EndMarked();

    void ScanName();
    void ScanNumber();
    bool ScanBitStringDigits();
    void ScanQuoted(char quote);
    void ScanSign(char sign);
    bool IsCharacterLiteral();
    void SkipCharacterLiteral();

    Files& files_;
    InputText text_;
    std::uint32_t file_ = 0;
    std::uint32_t line_ = 1;
    /// How many characters stand in front of the line.
    std::uint64_t lineStart_ = 0;
    Token token_;
    Place formerPlace_;
    CommentFilter filter_ = nullptr;
    std::vector<Comment> comments_;
};

} // namespace Orn_Hdl::Readers::Vhdl
