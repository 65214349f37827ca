#include "cells/VerilogLexer.h"

#include "cells/CellDeclaration.h"

#include "Port/Ascii.h"

#include <algorithm>

namespace Tool::Cells {

namespace {

using Port::IsDigit;
using Port::IsLetter;

bool IsBlank(char c) noexcept {
    return c == ' ' || (c >= '\t' && c <= '\r') || c == '\0';
}

bool IsWordStart(char c) noexcept {
    return IsLetter(c) || c == '_' || c == '$';
}

bool IsWordPart(char c) noexcept {
    return IsWordStart(c) || IsDigit(c);
}

/// The digits of a based number.
bool IsDigitOfBase(char c) noexcept {
    return IsWordPart(c) || c == '?';
}

bool IsListed(std::string_view words, std::string_view word) {
    return words.find(std::string(" ").append(word).append(" ")) != std::string_view::npos;
}

/// Directives without arguments.
constexpr std::string_view BareDirectives =
    " celldefine endcelldefine resetall nounconnected_drive end_keywords undefineall ";
/// Directives whose arguments end with the line.
constexpr std::string_view LineDirectives =
    " timescale default_nettype include line pragma unconnected_drive begin_keywords "
    "default_decay_time default_trireg_strength delay_mode_path delay_mode_distributed "
    "delay_mode_unit delay_mode_zero protect endprotect suppress_faults nosuppress_faults "
    "enable_portfaults disable_portfaults ";

} // namespace

void VerilogLexer::Advance(std::size_t count) noexcept {
    const std::size_t end = std::min(position_ + count, text_.size());
    line_ += static_cast<std::size_t>(
        std::count(text_.begin() + static_cast<std::ptrdiff_t>(position_),
                   text_.begin() + static_cast<std::ptrdiff_t>(end), '\n'));
    position_ = end;
}

void VerilogLexer::SkipBlanks() noexcept {
    while (!IsAtEnd() && IsBlank(Peek())) {
        Advance(1);
    }
}

void VerilogLexer::SkipLine() noexcept {
    while (!IsAtEnd() && Peek() != '\n') {
        // A backslash at the line's end continues the line.
        Advance(Peek() == '\\' ? (Peek(1) == '\r' ? 3 : 2) : 1);
    }
}

bool VerilogLexer::SkipComment() {
    if (StartsWith("//")) {
        const std::size_t end = std::min(text_.find('\n', position_), text_.size());
        Advance(end - position_);
        return true;
    }
    if (StartsWith("/*")) {
        const std::size_t start = line_;
        const std::size_t end = text_.find("*/", position_ + 2);
        if (end == std::string_view::npos) {
            throw Error(start, "the end of the comment is missing");
        }
        Advance(end + 2 - position_);
        return true;
    }
    return false;
}

bool VerilogLexer::SkipAttribute() {
    if (!StartsWith("(*")) {
        return false;
    }
    std::size_t next = position_ + 2;
    while (next < text_.size() && IsBlank(text_[next])) {
        ++next;
    }
    // The sensitivity list @(*) is no attribute.
    if (next < text_.size() && text_[next] == ')') {
        return false;
    }
    Advance(2);
    while (!StartsWith("*)")) {
        if (IsAtEnd()) {
            throw Error(line_, "the end of the attribute is missing");
        }
        if (Peek() == '"') {
            ReadText();
        } else {
            Advance(1);
        }
    }
    Advance(2);
    return true;
}

std::string_view VerilogLexer::TakeWord() noexcept {
    const std::size_t start = position_;
    while (IsWordPart(Peek())) {
        ++position_;
    }
    return text_.substr(start, position_ - start);
}

/// The arguments of a macro, up to the closing parenthesis.
void VerilogLexer::SkipArguments() {
    const std::size_t start = line_;
    std::size_t depth = 0;
    do {
        if (IsAtEnd()) {
            throw Error(start, "the end of the macro's arguments is missing");
        }
        if (Peek() == '"') {
            ReadText();
            continue;
        }
        if (Peek() == '(') {
            ++depth;
        } else if (Peek() == ')') {
            --depth;
        }
        Advance(1);
    } while (depth > 0);
}

bool VerilogLexer::ReadCondition(std::string_view directive) {
    if (directive == "ifdef" || directive == "ifndef") {
        SkipBlanks();
        const bool isDefined = macros_.count(TakeWord()) != 0;
        const bool isActive = !IsSkipping() && isDefined == (directive == "ifdef");
        conditions_.push_back(Condition{isActive, isActive || IsSkipping()});
        return true;
    }
    const bool isBranch = directive == "else" || directive == "elsif";
    if (!isBranch && directive != "endif") {
        return false;
    }
    if (conditions_.empty()) {
        throw Error(line_, "`" + std::string(directive) + " without `ifdef");
    }
    if (!isBranch) {
        conditions_.pop_back();
        return true;
    }
    bool isMet = true;
    if (directive == "elsif") {
        SkipBlanks();
        isMet = macros_.count(TakeWord()) != 0;
    }
    Condition& condition = conditions_.back();
    condition.isActive = isMet && !condition.isDone;
    condition.isDone = condition.isDone || condition.isActive;
    return true;
}

void VerilogLexer::ReadDirective() {
    Advance(1);
    const std::string_view directive = TakeWord();
    if (ReadCondition(directive) || IsSkipping() || IsListed(BareDirectives, directive)) {
        return;
    }
    if (directive == "define" || directive == "undef") {
        SkipBlanks();
        const std::string_view macro = TakeWord();
        if (directive == "define") {
            macros_.insert(macro);
            SkipLine();
        } else {
            macros_.erase(macro);
        }
    } else if (IsListed(LineDirectives, directive)) {
        SkipLine();
    } else if (Peek() == '(') {
        SkipArguments();
    }
}

VerilogToken VerilogLexer::Next() {
    for (;;) {
        SkipBlanks();
        if (IsAtEnd()) {
            if (!conditions_.empty()) {
                throw Error(line_, "`endif is missing");
            }
            return VerilogToken{VerilogToken::End, std::string_view(), line_};
        }
        if (SkipComment() || SkipAttribute()) {
            continue;
        }
        if (Peek() == '`') {
            ReadDirective();
            continue;
        }
        const VerilogToken token = ReadToken();
        if (!IsSkipping()) {
            return token;
        }
    }
}

VerilogToken VerilogLexer::ReadToken() {
    VerilogToken token{VerilogToken::Mark, text_.substr(position_, 1), line_};
    const char c = Peek();
    if (IsWordStart(c)) {
        token.kind = VerilogToken::Word;
        token.text = TakeWord();
    } else if (c == '\\') {
        const std::size_t start = ++position_;
        while (!IsAtEnd() && !IsBlank(Peek())) {
            ++position_;
        }
        token.kind = VerilogToken::Escaped;
        token.text = text_.substr(start, position_ - start);
    } else if (IsDigit(c) || c == '\'') {
        token = ReadNumber();
    } else if (c == '"') {
        token = ReadText();
    } else {
        Advance(1);
    }
    return token;
}

/// A number, with its size and base if it has them. Blanks may stand before the base and before
/// the digits.
VerilogToken VerilogLexer::ReadNumber() {
    const std::size_t start = position_;
    const std::size_t line = line_;
    while (IsDigit(Peek()) || Peek() == '_') {
        ++position_;
    }
    std::size_t end = position_;
    SkipBlanks();
    if (Peek() == '\'') {
        Advance(1);
        position_ += Peek() == 's' || Peek() == 'S' ? 1 : 0;
        if (IsLetter(Peek())) {
            ++position_;
            SkipBlanks();
        }
        while (IsDigitOfBase(Peek())) {
            ++position_;
        }
        end = position_;
    } else if (end == position_) {
        // A fraction or an exponent.
        while (IsWordPart(Peek()) || Peek() == '.' ||
               ((Peek() == '-' || Peek() == '+') && (text_[position_ - 1] | 0x20) == 'e')) {
            ++position_;
        }
        end = position_;
    }
    return VerilogToken{VerilogToken::Number, text_.substr(start, end - start), line};
}

VerilogToken VerilogLexer::ReadText() {
    const std::size_t line = line_;
    Advance(1);
    const std::size_t start = position_;
    while (Peek() != '"') {
        if (IsAtEnd() || Peek() == '\n') {
            throw Error(line, "the end of the string is missing");
        }
        Advance(Peek() == '\\' ? 2 : 1);
    }
    const std::string_view text = text_.substr(start, position_ - start);
    Advance(1);
    return VerilogToken{VerilogToken::Text, text, line};
}

} // namespace Tool::Cells
