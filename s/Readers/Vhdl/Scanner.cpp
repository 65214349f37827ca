#include "Readers/Vhdl/Scanner.h"

#include "Port/Ascii.h"

#include <array>
#include <cstring>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

/// A comment that is longer is not kept.
constexpr std::size_t LongestKeptComment = std::size_t(1) << 20;

/// The classes of characters.
constexpr unsigned char NamePart = 1;
constexpr unsigned char NameBegin = 2;
constexpr unsigned char Digit = 4;
constexpr unsigned char Special = 8;

constexpr std::array<unsigned char, 256> MakeTable() {
    std::array<unsigned char, 256> table{};
    for (int c = 0; c < 256; ++c) {
        const char character = static_cast<char>(c);
        auto& properties = table[static_cast<std::size_t>(c)];
        if (Port::IsDigit(character)) {
            properties = NamePart | Digit;
        }
        // The letters of ISO 8859-1 from A with grave on are letters of VHDL too.
        constexpr int FirstLetter = 0xC0;
        constexpr int Times = 0xD7;
        constexpr int DividedBy = 0xF7;
        if (Port::IsLetter(character) || (c >= FirstLetter && c != Times && c != DividedBy)) {
            properties = NamePart | NameBegin;
        }
    }
    table['_'] = NamePart;
    for (const char special : std::string_view("\0\n;\"\\-/'", 8)) {
        table[static_cast<unsigned char>(special)] |= Special;
    }
    return table;
}

bool Has(char c, unsigned char properties) noexcept {
    static constexpr std::array<unsigned char, 256> Table = MakeTable();
    return (Table[static_cast<unsigned char>(c)] & properties) != 0;
}

bool IsInName(char c) noexcept {
    return Has(c, NamePart);
}

/// Whether a word in front of a quote makes a bit string literal of it. IEEE 1076-2008 has signed
/// and unsigned ones and decimal digits.
bool IsBase(std::string_view word) noexcept {
    constexpr std::string_view Bases[] = {"b", "o", "x", "ub", "uo", "ux", "sb", "so", "sx", "d"};
    for (const std::string_view base : Bases) {
        if (Port::EqualIgnoringCase(base, word)) {
            return true;
        }
    }
    return false;
}

} // namespace

void Scanner::Open(const std::string& fileName) {
    file_ = files_.Add(fileName);
    token_ = Token();
    token_.place = Place{file_, 0, 0};
    if (!text_.Open(fileName)) {
        Fail("the file cannot be read: " + std::string(std::strerror(text_.GetError())));
    }
}

Place Scanner::GetPlace() const noexcept {
    constexpr std::uint64_t LastColumn = UINT32_MAX;
    const std::uint64_t column = text_.GetOffset(text_.current) - lineStart_ + 1;
    return Place{file_, line_,
                 static_cast<std::uint32_t>(column < LastColumn ? column : LastColumn)};
}

/// The character so many places behind the next one; NUL beyond the end.
char Scanner::Peek(std::size_t count) {
    while (static_cast<std::size_t>(text_.end - text_.current) <= count) {
        if (!text_.ReadOn()) {
            return '\0';
        }
    }
    return text_.current[count];
}

void Scanner::EndLine() noexcept {
    ++text_.current;
    ++line_;
    lineStart_ = text_.GetOffset(text_.current);
}

template <class IsPart> void Scanner::SkipWhile(IsPart isPart) {
    for (;;) {
        const char* p = text_.current;
        while (isPart(*p)) {
            ++p;
        }
        text_.current = p;
        if (p != text_.end || !text_.ReadOn()) {
            return;
        }
    }
}

/// The text from the mark on, which ends there.
std::string_view Scanner::EndMarked() {
    const std::string_view text(text_.mark, static_cast<std::size_t>(text_.current - text_.mark));
    text_.mark = nullptr;
    return text;
}

void Scanner::Next() {
    const TokenKind former = token_.kind;
    const char formerSign = token_.sign;
    formerPlace_ = token_.place;
    token_.text = {};
    if (!SkipBlanks()) {
        token_.kind = TokenKind::End;
        token_.place = GetPlace();
        return;
    }
    token_.place = GetPlace();
    const char c = *text_.current;
    if (Has(c, NameBegin)) {
        ScanName();
    } else if (Has(c, Digit)) {
        ScanNumber();
    } else if (c == '"') {
        token_.kind = TokenKind::String;
        ScanQuoted('"');
    } else if (c == '\\') {
        token_.kind = TokenKind::ExtendedName;
        ScanQuoted('\\');
    } else if (c == '\'' && IsCharacterLiteral() &&
               !(Peek(1) == '(' &&
                 (former == TokenKind::Name || former == TokenKind::ExtendedName ||
                  (former == TokenKind::Sign && formerSign == ')')))) {
        token_.kind = TokenKind::Character;
        text_.mark = text_.current + 1;
        text_.current += 2;
        token_.text = EndMarked();
        ++text_.current;
    } else {
        ScanSign(c);
    }
}

/// Whether an apostrophe begins a character literal, and not an attribute or a qualified
/// expression.
bool Scanner::IsCharacterLiteral() {
    return Peek(2) == '\'' && Peek(1) != '\n';
}

void Scanner::SkipToSemicolon() {
    if (token_.kind == TokenKind::Sign && token_.sign == ';') {
        return;
    }
    for (;;) {
        const char* p = text_.current;
        while (!Has(*p, Special)) {
            ++p;
        }
        text_.current = p;
        switch (*p) {
        case ';':
            token_.kind = TokenKind::Sign;
            Next();
            return;
        case '"':
        case '\\':
            ScanQuoted(*p);
            break;
        case '\'':
            text_.current += Has(Peek(1), Special) && IsCharacterLiteral() ? 3 : 1;
            break;
        default:
            // A line end, a comment, the end of the file, or a character alone.
            if (!SkipBlanks()) {
                Next();
                return;
            }
            if (*text_.current == '-' || *text_.current == '/' || *text_.current == '\0') {
                ++text_.current;
            }
        }
    }
}

/// Skips blanks and comments. \return false at the end of the file.
bool Scanner::SkipBlanks() {
    for (;;) {
        switch (*text_.current) {
        case ' ':
        case '\t':
        case '\r':
        case '\f':
        case '\v':
            ++text_.current;
            break;
        case '\n':
            EndLine();
            break;
        case '-':
            if (Peek(1) != '-') {
                return true;
            }
            SkipLineComment();
            break;
        case '/':
            if (Peek(1) != '*') {
                return true;
            }
            SkipBlockComment();
            break;
        case '\0':
            if (text_.current != text_.end) {
                return true;
            }
            if (!text_.ReadOn()) {
                return false;
            }
            break;
        default:
            return true;
        }
    }
}

/// Does not keep a comment that has become very long.
void Scanner::LimitComment() {
    if (text_.mark != nullptr && text_.current - text_.mark > std::ptrdiff_t(LongestKeptComment)) {
        text_.mark = nullptr;
    }
}

void Scanner::SkipLineComment() {
    const Place place = GetPlace();
    text_.mark = filter_ == nullptr ? nullptr : text_.current;
    for (;;) {
        const auto left = static_cast<std::size_t>(text_.end - text_.current);
        const void* const found = std::memchr(text_.current, '\n', left);
        if (found != nullptr) {
            text_.current = static_cast<const char*>(found);
            break;
        }
        text_.current = text_.end;
        if (!text_.ReadOn()) {
            break;
        }
        LimitComment();
    }
    KeepComment(false, place);
}

void Scanner::SkipBlockComment() {
    const Place place = GetPlace();
    text_.mark = filter_ == nullptr ? nullptr : text_.current;
    text_.current += 2;
    for (;;) {
        if (IsAtEnd()) {
            Fail(place, "this comment does not end");
        }
        const char c = *text_.current;
        if (c == '\n') {
            EndLine();
        } else if (c == '*' && Peek(1) == '/') {
            break;
        } else {
            ++text_.current;
        }
        LimitComment();
    }
    KeepComment(true, place);
    text_.current += 2;
}

/// Keeps the comment from the mark on, whose delimiter has two characters.
void Scanner::KeepComment(bool isBlock, const Place& place) {
    if (text_.mark == nullptr) {
        return;
    }
    const std::string_view text = EndMarked().substr(2);
    if (filter_(text)) {
        comments_.push_back(Comment{std::string(text), isBlock, place});
    }
}

void Scanner::ScanName() {
    text_.mark = text_.current;
    SkipWhile(IsInName);
    constexpr std::ptrdiff_t LongestBase = 2;
    if (*text_.current == '"' && text_.current - text_.mark <= LongestBase &&
        IsBase({text_.mark, static_cast<std::size_t>(text_.current - text_.mark)}) &&
        ScanBitStringDigits()) {
        token_.kind = TokenKind::BitString;
    } else {
        token_.kind = TokenKind::Name;
    }
    token_.text = EndMarked();
}

/// Steps over the quotes of a bit string literal and what stands between them.
bool Scanner::ScanBitStringDigits() {
    ++text_.current;
    SkipWhile([](char c) { return c != '"' && c != '\n' && c != '\0'; });
    if (*text_.current != '"') {
        Fail("this bit string literal does not end in its line");
    }
    ++text_.current;
    return true;
}

/// Scans a number: digits, a real or based number, or the length of a bit string literal.
void Scanner::ScanNumber() {
    token_.kind = TokenKind::Number;
    text_.mark = text_.current;
    const auto skipDigits = [this] { SkipWhile([](char c) { return Has(c, Digit) || c == '_'; }); };
    skipDigits();
    if (*text_.current == '#') {
        ++text_.current;
        SkipWhile([](char c) { return IsInName(c) || c == '.'; });
        if (*text_.current != '#') {
            Fail("a number with a base ends in \"#\"");
        }
        ++text_.current;
    } else if (*text_.current == '.' && Has(Peek(1), Digit)) {
        ++text_.current;
        skipDigits();
    }
    if ((*text_.current == 'e' || *text_.current == 'E') &&
        (Has(Peek(1), Digit) || ((Peek(1) == '+' || Peek(1) == '-') && Has(Peek(2), Digit)))) {
        text_.current += 2;
        skipDigits();
    }
    if (Has(*text_.current, NameBegin)) {
        // Only the length of a bit string literal can stand directly in front of a letter.
        SkipWhile(IsInName);
        if (*text_.current != '"' || !ScanBitStringDigits()) {
            Fail("a number that letters follow");
        }
        token_.kind = TokenKind::BitString;
    }
    token_.text = EndMarked();
}

/// Scans a string or an extended identifier. Two quotes inside stand for one.
void Scanner::ScanQuoted(char quote) {
    const Place place = GetPlace();
    text_.mark = text_.current;
    ++text_.current;
    for (;;) {
        SkipWhile([quote](char c) { return c != quote && c != '\n' && c != '\0'; });
        const char c = *text_.current;
        if (c == quote && Peek(1) == quote) {
            text_.current += 2;
        } else if (c == quote) {
            break;
        } else if (c == '\0' && text_.current != text_.end) {
            ++text_.current;
        } else {
            Fail(place, quote == '"' ? "this string does not end in its line"
                                     : "this extended identifier does not end in its line");
        }
    }
    ++text_.current;
    token_.text = EndMarked();
    if (quote == '"') {
        token_.text = token_.text.substr(1, token_.text.size() - 2);
    } else if (token_.text.size() == 2) {
        Fail(place, "an extended identifier without characters");
    }
}

void Scanner::ScanSign(char sign) {
    token_.kind = TokenKind::Sign;
    const char second = Peek(1);
    std::size_t length = 1;
    token_.sign = sign;
    if (sign == '=' && second == '>') {
        token_.sign = Arrow;
        length = 2;
    } else if (sign == '<' && second == '=') {
        token_.sign = LeftArrow;
        length = 2;
    } else if (sign == ':' && second == '=') {
        token_.sign = Becomes;
        length = 2;
    } else if ((sign == '*' && second == '*') || (sign == '/' && second == '=') ||
               (sign == '>' && (second == '=' || second == '>')) ||
               (sign == '<' && (second == '>' || second == '<'))) {
        token_.sign = OtherOperator;
        length = 2;
    } else if (sign == '?') {
        token_.sign = OtherOperator;
    }
    text_.mark = text_.current;
    text_.current += length;
    token_.text = EndMarked();
}

} // namespace Orn_Hdl::Readers::Vhdl
