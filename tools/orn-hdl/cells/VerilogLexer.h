// Splits Verilog into tokens. Comments, attributes and compiler directives are passed over.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace Tool::Cells {

struct VerilogToken {
    enum Kind : std::uint8_t { End, Word, Escaped, Number, Text, Mark };

    Kind kind = End;
    /// As it stands in the file; an escaped name without its backslash, a text without its quotes.
    std::string_view text;
    std::size_t line = 0;

    bool Is(std::string_view what) const noexcept {
        return (kind == Word || kind == Mark) && text == what;
    }
    bool IsName() const noexcept { return kind == Word || kind == Escaped; }
};

class VerilogLexer {
public:
    /// \param text must outlive the lexer and its tokens.
    explicit VerilogLexer(std::string_view text) noexcept : text_(text) {}

    /// The next token; `End` at the end of the file. \throws Error
    VerilogToken Next();

private:
    /// One level of conditional compilation.
    struct Condition {
        bool isActive = false;
        /// Whether a branch was taken already, or none may be taken.
        bool isDone = false;
    };

    char Peek(std::size_t ahead = 0) const noexcept {
        return position_ + ahead < text_.size() ? text_[position_ + ahead] : '\0';
    }
    bool IsAtEnd() const noexcept { return position_ >= text_.size(); }
    bool StartsWith(std::string_view what) const noexcept {
        return text_.substr(position_, what.size()) == what;
    }
    bool IsSkipping() const noexcept {
        return !conditions_.empty() && !conditions_.back().isActive;
    }
    void Advance(std::size_t count) noexcept;
    void SkipBlanks() noexcept;
    bool SkipComment();
    bool SkipAttribute();
    void SkipLine() noexcept;
    void SkipArguments();
    std::string_view TakeWord() noexcept;
    void ReadDirective();
    bool ReadCondition(std::string_view directive);
    VerilogToken ReadToken();
    VerilogToken ReadNumber();
    VerilogToken ReadText();

    std::string_view text_;
    std::size_t position_ = 0;
    std::size_t line_ = 1;
    std::vector<Condition> conditions_;
    std::unordered_set<std::string_view> macros_;
};

} // namespace Tool::Cells
