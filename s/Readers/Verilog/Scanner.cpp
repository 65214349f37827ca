#include "Readers/Verilog/Scanner.h"

#include "Readers/Verilog/Characters.h"
#include "Readers/Verilog/Source.h"

#include <cstring>

namespace Orn_Hdl::Readers {

namespace {

/// A comment that is longer is not kept.
constexpr std::size_t LongestKeptComment = std::size_t(1) << 20;

} // namespace

Scanner::Scanner(Files& files, const VerilogSetup& setup) : files_(files), setup_(setup) {
    for (const auto& [name, text] : setup.macros) {
        macros_.insert_or_assign(name, Macro{text, false});
    }
}

Scanner::~Scanner() = default;

void Scanner::Open(const std::string& fileName) {
    const Place whole{files_.Add(fileName), 0, 0};
    PushFile(fileName, whole);
    token_ = Token();
    token_.place = whole;
}

void Scanner::Next() {
    token_.text = {};
    if (!SkipBlanks()) {
        token_.kind = TokenKind::End;
        token_.place = GetPlace();
        if (!conditions_.empty()) {
            Fail(conditions_.back().place, "this directive has no `endif");
        }
        return;
    }
    token_.place = GetPlace();
    const char c = *input_->current;
    if (Characters::BeginsName(c)) {
        token_.kind = TokenKind::Name;
        token_.text = TakeWhile(Characters::IsInName);
    } else if (Characters::IsDigit(c) || c == '\'') {
        ScanNumber();
    } else if (c == '\\') {
        ScanEscapedName();
    } else if (c == '"') {
        ScanString();
    } else if (c == '$') {
        token_.kind = TokenKind::SystemName;
        token_.text = TakeWhile(Characters::IsInName);
    } else {
        ScanSign(c);
    }
}

void Scanner::SkipToSemicolon() {
    if (token_.kind == TokenKind::Sign && token_.sign == ';') {
        return;
    }
    for (;;) {
        const char* p = input_->current;
        while (Characters::IsPlain(*p)) {
            ++p;
        }
        input_->current = p;
        switch (*p) {
        case '"':
        case '\\':
            SkipEscapedOrString();
            break;
        case ';':
            Next();
            return;
        default:
            // A line end, comment, directive, the end of a source, or a slash alone.
            if (!SkipBlanks()) {
                Next();
                return;
            }
            if (*input_->current == '/' || *input_->current == '\0') {
                ++input_->current;
            }
        }
    }
}

/// Skips blanks, comments and directives, and ends sources. \return false at the end of the file.
bool Scanner::SkipBlanks() {
    for (;;) {
        while (*input_->current == ' ') {
            ++input_->current;
        }
        switch (*input_->current) {
        case '\t':
        case '\r':
        case '\f':
        case '\v':
            ++input_->current;
            break;
        case '\n':
            EndLine();
            break;
        case '/': {
            const char second = PeekSecond();
            if (second == '/') {
                SkipLineComment();
            } else if (second == '*') {
                SkipBlockComment();
            } else {
                return true;
            }
            break;
        }
        case '`':
            ReadDirective();
            break;
        case '\0':
            if (input_->current != input_->end) {
                return true;
            }
            if (IsAtEnd() && !Pop()) {
                return false;
            }
            break;
        default:
            return true;
        }
    }
}

void Scanner::SkipRestOfLine() {
    InputText& input = *input_;
    for (;;) {
        const auto left = static_cast<std::size_t>(input.end - input.current);
        const void* const found = std::memchr(input.current, '\n', left);
        if (found != nullptr) {
            input.current = static_cast<const char*>(found);
            return;
        }
        input.current = input.end;
        if (!input.ReadOn()) {
            return;
        }
        if (input.mark != nullptr &&
            input.current - input.mark > std::ptrdiff_t(LongestKeptComment)) {
            input.mark = nullptr;
        }
    }
}

void Scanner::SkipLineComment() {
    const Place place = GetPlace();
    InputText& input = *input_;
    input.mark = filter_ == nullptr ? nullptr : input.current;
    SkipRestOfLine();
    if (input.mark != nullptr) {
        KeepComment({input.mark + 2, static_cast<std::size_t>(input.current - input.mark) - 2},
                    false, place);
        input.mark = nullptr;
    }
}

void Scanner::SkipBlockComment() {
    const Place place = GetPlace();
    InputText& input = *input_;
    input.mark = filter_ == nullptr ? nullptr : input.current;
    input.current += 2;
    for (;;) {
        if (IsAtEnd()) {
            Fail(place, "this comment does not end");
        }
        const char c = *input.current;
        if (c == '\n') {
            EndLine();
        } else if (c == '*' && PeekSecond() == '/') {
            break;
        } else {
            ++input.current;
        }
        if (input.mark != nullptr &&
            input.current - input.mark > std::ptrdiff_t(LongestKeptComment)) {
            input.mark = nullptr;
        }
    }
    if (input.mark != nullptr) {
        KeepComment({input.mark + 2, static_cast<std::size_t>(input.current - input.mark) - 2},
                    true, place);
        input.mark = nullptr;
    }
    input.current += 2;
}

void Scanner::KeepComment(std::string_view text, bool isBlock, const Place& place) {
    if (filter_(text)) {
        comments_.push_back(Comment{std::string(text), isBlock, place});
    }
}

void Scanner::ScanEscapedName() {
    ++input_->current;
    token_.kind = TokenKind::EscapedName;
    token_.text = TakeWhile([](char c) { return c > ' ' || static_cast<signed char>(c) < 0; });
    if (token_.text.empty()) {
        Fail("a backslash that no name follows");
    }
}

/// Steps over blanks that are not the end of the line.
void Scanner::SkipInLine() {
    while (!IsAtEnd() && (*input_->current == ' ' || *input_->current == '\t')) {
        ++input_->current;
    }
}

/// Scans a number: digits, a real number, or a size, a base and digits.
void Scanner::ScanNumber() {
    InputText& input = *input_;
    input.mark = input.current;
    const auto skipDigits = [this, &input] {
        while (!IsAtEnd() && (Characters::IsDigit(*input.current) || *input.current == '_')) {
            ++input.current;
        }
    };
    skipDigits();
    std::size_t length = static_cast<std::size_t>(input.current - input.mark);
    if (length > 0 && !IsAtEnd()) {
        if (*input.current == '.' && Characters::IsDigit(PeekSecond())) {
            ++input.current;
            skipDigits();
        }
        if (!IsAtEnd() && (*input.current == 'e' || *input.current == 'E')) {
            ++input.current;
            if (!IsAtEnd() && (*input.current == '+' || *input.current == '-')) {
                ++input.current;
            }
            skipDigits();
        }
        length = static_cast<std::size_t>(input.current - input.mark);
        SkipInLine();
    }
    if (!IsAtEnd() && *input.current == '\'') {
        ScanBasedDigits();
        length = static_cast<std::size_t>(input.current - input.mark);
    }
    input.current = input.mark + length;
    token_.kind = TokenKind::Number;
    token_.text = {input.mark, length};
    input.mark = nullptr;
}

/// Scans an apostrophe, the letter of a base, and digits.
void Scanner::ScanBasedDigits() {
    InputText& input = *input_;
    const auto isLetter = [this, &input](std::string_view letters) {
        return !IsAtEnd() && letters.find(*input.current) != std::string_view::npos;
    };
    ++input.current;
    if (isLetter("01xXzZ")) {
        ++input.current;
        return;
    }
    if (isLetter("sS")) {
        ++input.current;
    }
    if (!isLetter("bBoOdDhH")) {
        Fail("an apostrophe that no base of a number follows");
    }
    ++input.current;
    SkipInLine();
    const auto digits = input.GetOffset(input.current);
    while (!IsAtEnd() && Characters::IsInNumber(*input.current)) {
        ++input.current;
    }
    if (input.GetOffset(input.current) == digits) {
        Fail("a base without digits");
    }
}

void Scanner::ScanString() {
    InputText& input = *input_;
    input.mark = input.current;
    for (++input.current;; ++input.current) {
        if (IsAtEnd() || *input.current == '\n') {
            Fail("this string does not end in its line");
        }
        if (*input.current == '"') {
            break;
        }
        if (*input.current == '\\') {
            ++input.current;
            if (IsAtEnd() || *input.current == '\n') {
                Fail("this string does not end in its line");
            }
        }
    }
    token_.kind = TokenKind::String;
    token_.text = {input.mark + 1, static_cast<std::size_t>(input.current - input.mark) - 1};
    ++input.current;
    input.mark = nullptr;
}

void Scanner::ScanSign(char sign) {
    token_.kind = TokenKind::Sign;
    token_.sign = sign;
    if (sign == '(' && PeekSecond() == '*') {
        // "(*)" is a list of events.
        input_->mark = input_->current;
        input_->current += 2;
        const bool isEvents = !IsAtEnd() && *input_->current == ')';
        input_->current = input_->mark + (isEvents ? 1 : 2);
        input_->mark = nullptr;
        token_.kind = isEvents ? TokenKind::Sign : TokenKind::AttributesBegin;
        return;
    }
    if (sign == '*' && PeekSecond() == ')') {
        token_.kind = TokenKind::AttributesEnd;
        input_->current += 2;
        return;
    }
    if (static_cast<unsigned char>(sign) <= ' ' || static_cast<unsigned char>(sign) >= 0x7f) {
        Fail("a character that Verilog has outside of comments and strings only: code " +
             std::to_string(static_cast<unsigned char>(sign)));
    }
    if ((sign == '+' || sign == '-') && PeekSecond() == ':') {
        token_.sign = sign == '+' ? PlusColon : MinusColon;
        ++input_->current;
    }
    ++input_->current;
}

} // namespace Orn_Hdl::Readers
