#include "Streams/LineDst.h"

#include "Port/Ascii.h"
#include "Streams/PlainText.h"

#include <algorithm>
#include <charconv>
#include <string>
#include <utility>

namespace Orn_Hdl {

namespace {

constexpr int ContinuationLevels = 2;
// The buffer grows with the text: small files need little memory, and large ones few calls of the
// system.
constexpr std::size_t FirstBuffer = std::size_t(1) << 10;

/// Most pieces of a netlist have a few characters: a loop over these is faster than a call.
std::size_t FindLineFeed(std::string_view text) noexcept {
    constexpr std::size_t Short = 16;
    if (text.size() > Short) {
        return text.find('\n');
    }
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] == '\n') {
            return i;
        }
    }
    return std::string_view::npos;
}

/// Whether a character, such as a letter or a digit, says nothing about where a line may be broken.
constexpr bool IsOrdinary(char c) noexcept {
    return c > '/' && c != '\\';
}

/// The first place from `place` on whose character is not ordinary, or the end of the text.
std::size_t FindOther(std::string_view text, std::size_t place) noexcept {
    while (place < text.size() && IsOrdinary(text[place])) {
        ++place;
    }
    return place;
}

} // namespace

LineDst::~LineDst() = default;

void LineDst::DropLines() noexcept {
    const std::string_view line = GetLine();
    std::copy(line.begin(), line.end(), buffer_.get());
    used_ = line.size();
    lineStart_ = 0;
}

void LineDst::DropAll() noexcept {
    used_ = 0;
    StartLine();
}

void LineDst::FreeBuffer() noexcept {
    buffer_.reset();
    capacity_ = 0;
    DropAll();
}

void LineDst::Grow(std::size_t size, std::size_t most) {
    const std::size_t capacity =
        std::min(std::max({FirstBuffer, capacity_ * 2, used_ + size}), most);
    std::unique_ptr<char[]> buffer(new char[capacity]);
    std::copy_n(buffer_.get(), used_, buffer.get());
    buffer_ = std::move(buffer);
    capacity_ = capacity;
}

void LineDst::Write(const char* text) {
    WriteView(Port::ViewOf(text));
}

void LineDst::Write(int number) {
    char digits[16];
    const auto result = std::to_chars(digits, digits + sizeof digits, number);
    if (isTaking_) {
        AppendWrapping(std::string_view(digits, static_cast<std::size_t>(result.ptr - digits)));
    }
}

void LineDst::WriteNewLine() {
    if (isTaking_ && !EndLine("")) {
        WriteToLineEnd("\n");
    }
}

void LineDst::WriteView(std::string_view text) {
    LineDst::WritePieces(&text, 1);
}

void LineDst::WritePieces(const std::string_view* pieces, std::size_t count) {
    if (isTaking_) {
        const std::string_view* const end = pieces + count;
        const std::string_view* const rest = AppendPlainly(pieces, end);
        if (rest != end) {
            WriteRest(rest, end);
        }
    }
}

/// Appends texts, one by one, while that needs no more than a copy.
/// \return the first text that is left.
inline const std::string_view* LineDst::AppendPlainly(const std::string_view* piece,
                                                      const std::string_view* end) noexcept {
    char* to = piece == end ? nullptr : FindPlace(piece->size());
    if (to == nullptr) {
        return piece;
    }
    const char* const limit = buffer_.get() + std::min(lineStart_ + Width, capacity_);
    for (; piece != end && piece->size() <= static_cast<std::size_t>(limit - to) &&
           PlainText::Copy(*piece, to);
         ++piece) {
        to += piece->size();
    }
    used_ = static_cast<std::size_t>(to - buffer_.get());
    return piece;
}

/// Writes texts, of which the first one cannot be appended as it is.
void LineDst::WriteRest(const std::string_view* piece, const std::string_view* end) {
    while (piece != end) {
        WritePiece(*piece);
        piece = AppendPlainly(piece + 1, end);
    }
}

void LineDst::WritePiece(std::string_view text) {
    for (std::size_t end = FindLineFeed(text); end != std::string_view::npos;
         end = FindLineFeed(text)) {
        WriteToLineEnd(text.substr(0, end + 1));
        text.remove_prefix(end + 1);
    }
    if (!text.empty()) {
        AppendWrapping(text);
    }
}

void LineDst::WriteToLineEnd(std::string_view text) {
    BeginLine();
    if (text.size() < std::max(FirstBuffer, capacity_)) {
        Append(text);
        StartLine();
        return;
    }
    WriteLongLine(text);
}

void LineDst::AppendIndentation(int levels) {
    for (; levels > 0; --levels) {
        Append(IndentStep);
    }
}

inline void LineDst::BeginLine() {
    if (GetLine().empty()) {
        AppendIndentation(GetIndentLevel());
    }
}

inline void LineDst::AppendWrapping(std::string_view text) {
    BeginLine();
    if (GetLine().size() + text.size() > Width) {
        Wrap();
    }
    Append(text);
}

/// Breaks the current line where it may be broken.
void LineDst::Wrap() {
    SearchBreak();
    if (search_.isComment) {
        return;
    }
    if (search_.afterSpace > 0) {
        BreakAt(search_.afterSpace);
    } else if (search_.afterComma > 0) {
        BreakAt(search_.afterComma);
    } else if (!search_.inLiteral && !search_.inEscapingLiteral) {
        BreakAt(GetLine().size());
    }
}

void LineDst::SearchBreak() {
    // A copy, which the compiler can keep in registers.
    BreakSearch found = search_;
    const std::string_view line = GetLine();
    for (std::size_t& i = found.searched; i < line.size() && !found.isComment; ++i) {
        if (IsOrdinary(line[i])) {
            found.isEscaped = false;
            i = FindOther(line, i + 1);
            if (i == line.size()) {
                break;
            }
        }
        const char c = line[i];
        const char before = i > 0 ? line[i - 1] : '\0';
        const bool isOutside = !found.inLiteral && !found.inEscapingLiteral;
        if (c == '"') {
            found.inLiteral = !found.inLiteral;
            found.inEscapingLiteral = found.inEscapingLiteral == found.isEscaped;
        } else if (c == ' ' && isOutside) {
            found.afterSpace = i + 1;
        } else if (c == ',' && isOutside) {
            found.afterComma = i + 1;
        }
        found.isEscaped = c == '\\' && !found.isEscaped;
        found.isComment = (c == '/' && before == '/') || (c == '-' && before == '-') ||
                          (c == '*' && before == '/');
    }
    search_ = found;
}

void LineDst::BreakAt(std::size_t position) {
    const std::string rest(GetLine().substr(position));
    used_ = lineStart_ + position;
    Append("\n");
    StartLine();
    AppendIndentation(GetIndentLevel() + ContinuationLevels);
    Append(rest);
}

} // namespace Orn_Hdl
