#include "import/JsonScanner.h"

#include "Port/Ascii.h"
#include "diagnostics/Utf8.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstring>
#include <system_error>

namespace Tool::Import {

namespace {

constexpr std::size_t PieceSize = std::size_t(1) << 18;
/// How much of the text before the present place stays, for messages.
constexpr std::size_t History = 4096;
/// How many bytes behind the text can be looked at.
constexpr std::size_t Padding = 8;

constexpr const char* Structure = "a comma, colon, quote or bracket is missing or superfluous";
constexpr const char* EndsEarly = "the file ends too early";
constexpr const char* WrongEscape = "a backslash in a text is followed by a wrong character";
constexpr const char* WrongNumber = "a malformed number";

constexpr bool IsBlank(char c) noexcept {
    return c == ' ' || c == '\n' || c == '\r' || c == '\t';
}
constexpr bool IsWordPart(char c) noexcept {
    return c >= 'a' && c <= 'z';
}
constexpr bool IsNumberPart(char c) noexcept {
    return Port::IsDigit(c) || c == '-' || c == '+' || c == '.' || c == 'e' || c == 'E';
}

/// What a character in a text is; `Stop` ends the search for the end of the text.
enum TextClass : std::uint8_t { Plain, NotAscii, Stop };

constexpr std::array<std::uint8_t, 256> MakeTextClasses() noexcept {
    std::array<std::uint8_t, 256> classes{};
    for (std::size_t c = 0; c < classes.size(); ++c) {
        const bool isStop = c < 0x20 || c == '"' || c == '\\';
        classes[c] = isStop ? Stop : c >= 0x80 ? NotAscii : Plain;
    }
    return classes;
}

constexpr std::array<std::uint8_t, 256> TextClasses = MakeTextClasses();

std::size_t CountDigits(std::string_view text) noexcept {
    return static_cast<std::size_t>(std::find_if_not(text.begin(), text.end(), Port::IsDigit) -
                                    text.begin());
}

/// Takes the digits at the start of a text. \return whether there is one.
bool TakeDigits(std::string_view& text) noexcept {
    const std::size_t count = CountDigits(text);
    text.remove_prefix(count);
    return count > 0;
}

bool TakeOneOf(std::string_view& text, std::string_view marks) noexcept {
    const bool isThere = !text.empty() && marks.find(text.front()) != std::string_view::npos;
    text.remove_prefix(isThere ? 1 : 0);
    return isThere;
}

bool IsJsonNumber(std::string_view text) noexcept {
    TakeOneOf(text, "-");
    const bool isWhole = TakeOneOf(text, "0") || TakeDigits(text);
    const bool hasFraction = !TakeOneOf(text, ".") || TakeDigits(text);
    bool hasExponent = true;
    if (TakeOneOf(text, "eE")) {
        TakeOneOf(text, "+-");
        hasExponent = TakeDigits(text);
    }
    return isWhole && hasFraction && hasExponent && text.empty();
}

void AppendUtf8(std::string& text, std::uint32_t character) {
    const auto add = [&text](std::uint32_t byte) { text += static_cast<char>(byte); };
    if (character < 0x80) {
        add(character);
        return;
    }
    if (character < 0x800) {
        add(0xC0 | (character >> 6U));
    } else {
        if (character < 0x10000) {
            add(0xE0 | (character >> 12U));
        } else {
            add(0xF0 | (character >> 18U));
            add(0x80 | ((character >> 12U) & 0x3FU));
        }
        add(0x80 | ((character >> 6U) & 0x3FU));
    }
    add(0x80 | (character & 0x3FU));
}

/// The four hexadecimal digits behind "\u" at a place of a text.
std::uint32_t ReadFourDigits(std::string_view text, std::size_t at) {
    constexpr std::size_t Mark = 2;
    constexpr std::size_t Digits = 4;
    std::uint32_t number = 0;
    const std::string_view digits =
        text.substr(at, Mark) == "\\u" ? text.substr(at + Mark, Digits) : std::string_view();
    const auto read = std::from_chars(digits.data(), digits.data() + digits.size(), number, 16);
    if (digits.size() != Digits || read.ec != std::errc() ||
        read.ptr != digits.data() + digits.size()) {
        throw JsonSyntaxError{WrongEscape};
    }
    return number;
}

} // namespace

JsonScanner::JsonScanner(TextSource& source)
    : source_(source), buffer_(History + PieceSize + Padding) {
    at_ = buffer_.data();
    end_ = at_;
}

void JsonScanner::FailStructure() {
    throw JsonSyntaxError{IsAtEnd() ? EndsEarly : Structure};
}

bool JsonScanner::Fill() {
    if (isEnd_) {
        return false;
    }
    const char* const begin = buffer_.data();
    const std::size_t history = std::min(static_cast<std::size_t>(at_ - begin), History);
    const char* const kept = at_ - history;
    const std::string_view dropped(begin, static_cast<std::size_t>(kept - begin));
    droppedLines_ += static_cast<std::uint64_t>(std::count(dropped.begin(), dropped.end(), '\n'));
    if (const std::size_t newLine = dropped.rfind('\n'); newLine != std::string_view::npos) {
        lineStart_ = dropped_ + newLine + 1;
    }
    dropped_ += dropped.size();
    const auto left = static_cast<std::size_t>(end_ - kept);
    std::memmove(buffer_.data(), kept, left);
    // A long text needs a larger buffer.
    if (left + PieceSize + Padding > buffer_.size()) {
        buffer_.resize(std::max(left + PieceSize + Padding, buffer_.size() * 2));
    }
    at_ = buffer_.data() + history;
    end_ = buffer_.data() + left;
    const std::size_t count = source_.Read(buffer_.data() + left, buffer_.size() - Padding - left);
    std::memset(buffer_.data() + left + count, 0, Padding);
    end_ += count;
    isEnd_ = count == 0;
    return count > 0;
}

void JsonScanner::SkipBlanks() {
    constexpr std::string_view Indentation = "        ";
    do {
        while (IsBlank(*at_)) {
            at_ += std::memcmp(at_, Indentation.data(), Indentation.size()) == 0
                       ? Indentation.size()
                       : 1;
        }
    } while (at_ == end_ && Fill());
}

bool JsonScanner::IsAtEnd() {
    SkipBlanks();
    return at_ == end_;
}

void JsonScanner::CheckBeginning() {
    if (IsAtEnd()) {
        throw JsonSyntaxError{"the file is empty", false, false};
    }
    if (*at_ != '{' && *at_ != '[') {
        throw JsonSyntaxError{"the file does not begin with \"{\""};
    }
}

TextPlace JsonScanner::FindPlace() {
    const bool isAtEnd = at_ == end_;
    while (isAtEnd && at_ != buffer_.data() && IsBlank(at_[-1])) {
        --at_;
    }
    std::size_t size = 0;
    while (!isAtEnd && size < History && (at_ + size != end_ || Fill()) && at_[size] != '\n') {
        ++size;
    }
    const char* const begin = buffer_.data();
    const std::string_view before(begin, static_cast<std::size_t>(at_ - begin));
    const std::size_t newLine = before.rfind('\n');
    TextPlace place;
    place.line = droppedLines_ + 1 +
                 static_cast<std::uint64_t>(std::count(before.begin(), before.end(), '\n'));
    const std::size_t start =
        newLine == std::string_view::npos ? lineStart_ : dropped_ + newLine + 1;
    place.column = dropped_ + before.size() - start;
    if (start < dropped_) {
        // The start of the line was dropped, so there is nothing to count columns in.
        return place;
    }
    place.source = std::string(before.substr(start - dropped_)).append(at_, size);
    if (!place.source.empty() && place.source.back() == '\r') {
        place.source.pop_back();
    }
    return place;
}

JsonScanner::Kind JsonScanner::GetKind() {
    SkipBlanks();
    switch (*at_) {
    case '{':
        return Kind::Object;
    case '[':
        return Kind::Array;
    case '"':
        return Kind::Text;
    default:
        if (Port::IsDigit(*at_) || *at_ == '-') {
            return Kind::Number;
        }
        if (!IsWordPart(*at_)) {
            FailStructure();
        }
        return Kind::Word;
    }
}

void JsonScanner::Take(char mark) {
    SkipBlanks();
    if (*at_ != mark) {
        FailStructure();
    }
    ++at_;
}

bool JsonScanner::TakeOpening(char close) {
    ++at_;
    SkipBlanks();
    const bool isEmpty = *at_ == close;
    at_ += isEmpty ? 1 : 0;
    return !isEmpty;
}

bool JsonScanner::TakeSeparator(char close) {
    SkipBlanks();
    if (*at_ != ',' && *at_ != close) {
        FailStructure();
    }
    return *at_++ == ',';
}

std::string_view JsonScanner::TakeKey() {
    SkipBlanks();
    if (*at_ != '"') {
        FailStructure();
    }
    return TakeText();
}

std::string_view JsonScanner::TakeText() {
    ++at_;
    std::size_t size = 0;
    bool isAscii = true;
    bool hasEscapes = false;
    while (true) {
        std::uint8_t kind = Plain;
        while ((kind = TextClasses[static_cast<unsigned char>(at_[size])]) != Stop) {
            isAscii = isAscii && kind == Plain;
            ++size;
        }
        if (at_[size] == '"') {
            break;
        }
        if (at_ + size + 1 >= end_ && Fill()) {
            continue; // The last character may be the sentinel, or one half of an escape.
        }
        if (at_ + size == end_) {
            at_ = end_;
            throw JsonSyntaxError{"a text is not closed by a double quote"};
        }
        if (at_[size] != '\\') {
            at_ += size;
            throw JsonSyntaxError{"a line end or another control character in a text"};
        }
        hasEscapes = true;
        size += at_ + size + 1 == end_ ? 1 : 2;
    }
    const std::string_view text(at_, size);
    if (!isAscii) {
        CheckUtf8(text);
    }
    const std::string_view result = hasEscapes ? Unescape(text) : text;
    at_ += size + 1;
    return result;
}

void JsonScanner::CheckUtf8(std::string_view text) {
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t size = GetCharacterSize(text.substr(at));
        if (size == 1 && static_cast<unsigned char>(text[at]) >= 0x80) {
            at_ += at;
            throw JsonSyntaxError{"a byte that is not UTF-8", false};
        }
        at += size;
    }
}

std::string_view JsonScanner::Unescape(std::string_view text) {
    constexpr std::string_view Escapes = "\"\\/bfnrt";
    constexpr std::string_view Meanings = "\"\\/\b\f\n\r\t";
    unescaped_.clear();
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t end = std::min(text.find('\\', at), text.size());
        unescaped_.append(text, at, end - at);
        at = end;
        if (at == text.size()) {
            break;
        }
        const std::size_t escape = Escapes.find(text[at + 1]);
        if (escape != std::string_view::npos) {
            unescaped_ += Meanings[escape];
            at += 2;
        } else {
            at = UnescapeUnicode(text, at);
        }
    }
    return unescaped_;
}

/// \param at the place of the backslash. \return the place behind the escape.
std::size_t JsonScanner::UnescapeUnicode(std::string_view text, std::size_t at) {
    constexpr std::size_t EscapeSize = 6;
    constexpr std::uint32_t HighStart = 0xD800;
    constexpr std::uint32_t LowStart = 0xDC00;
    constexpr std::uint32_t LowEnd = 0xE000;
    std::uint32_t character = ReadFourDigits(text, at);
    at += EscapeSize;
    if (character >= HighStart && character < LowEnd) {
        // Two escapes stand for a character beyond 16 bits.
        const std::uint32_t low = character < LowStart ? ReadFourDigits(text, at) : 0;
        if (low < LowStart || low >= LowEnd) {
            throw JsonSyntaxError{WrongEscape};
        }
        character = 0x10000 + ((character - HighStart) << 10U) + (low - LowStart);
        at += EscapeSize;
    }
    AppendUtf8(unescaped_, character);
    return at;
}

template <class Accept> std::size_t JsonScanner::Measure(const Accept& accept) {
    std::size_t size = 0;
    do {
        while (accept(at_[size])) {
            ++size;
        }
    } while (at_ + size == end_ && Fill());
    return size;
}

JsonScanner::Number JsonScanner::TakeNumber() {
    const std::size_t size = Measure(IsNumberPart);
    const std::string_view text(at_, size);
    if (!IsJsonNumber(text)) {
        throw JsonSyntaxError{WrongNumber};
    }
    Number number;
    const auto read = std::from_chars(text.data(), text.data() + size, number.value);
    number.isInteger = read.ec == std::errc() && read.ptr == text.data() + size;
    at_ += size;
    return number;
}

void JsonScanner::TakeWord() {
    const std::size_t size = Measure(IsWordPart);
    const std::string_view word(at_, size);
    if (word != "true" && word != "false" && word != "null") {
        throw JsonSyntaxError{"a word that is not true, false or null"};
    }
    at_ += size;
}

} // namespace Tool::Import
