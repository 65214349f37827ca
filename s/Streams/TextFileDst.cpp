#include "Streams/TextFileDst.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <charconv>
#include <string>
#include <utility>

namespace Orn_Hdl {

namespace {

constexpr std::string_view IndentStep = "   ";
constexpr int ContinuationLevels = 2;
// The buffer grows with the file: small files need little memory, and large ones few calls of the
// system.
constexpr std::size_t FirstBuffer = std::size_t(1) << 10;
constexpr std::size_t LargeBuffer = std::size_t(1) << 18;

Port::File::Mode FileMode(TextFileOutStream::Mode mode) noexcept {
    switch (mode) {
    case TextFileOutStream::Append:
        return Port::File::Append;
    case TextFileOutStream::Replace:
        return Port::File::Replace;
    case TextFileOutStream::Overwrite:
        break;
    }
    return Port::File::Overwrite;
}

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

} // namespace

TextFileDst::TextFileDst(const char* fileName, TextFileOutStream::Mode mode) : fileName_(fileName) {
    if (fileName != nullptr) {
        Open(fileName, mode);
    }
}

TextFileDst::TextFileDst(const Port::Folder& folder, const char* path, const char* fileName,
                         TextFileOutStream::Mode mode)
    : replaces_(mode == TextFileOutStream::Replace), fileName_(fileName) {
    file_.OpenBelow(folder, path, FileMode(mode), mode != TextFileOutStream::Append);
}

TextFileDst::~TextFileDst() {
    if (!replaces_) {
        Close();
    }
}

bool TextFileDst::Open(const char* fileName, TextFileOutStream::Mode mode) {
    Close();
    replaces_ = mode == TextFileOutStream::Replace;
    if (file_.open(fileName, FileMode(mode), mode != TextFileOutStream::Append)) {
        isGood_ = true;
    }
    return IsOpen();
}

void TextFileDst::Close() {
    if (IsOpen()) {
        Flush();
        file_.close();
    }
    buffer_.reset();
    capacity_ = 0;
    used_ = 0;
    StartLine();
}

void TextFileDst::Flush() {
    if (!IsOpen()) {
        return;
    }
    // The text continues in a new line, which begins with its first character. The line end is not
    // added to the buffer, which might have to grow: this also runs in the destructor.
    const bool endsLine = !GetLine().empty();
    StartLine();
    SendLines();
    Send(endsLine ? "\n" : "");
}

/// After a failure nothing more is written: a file with a gap would be worse than a short one.
void TextFileDst::Send(std::string_view text) {
    isGood_ = isGood_ && (text.empty() || file_.write(text.data(), text.size()));
}

int TextFileDst::CopyFile(const char* fileName) {
    Port::File from;
    if (!from.open(fileName, Port::File::Read, true)) {
        return from.GetError();
    }
    const std::unique_ptr<char[]> piece(new char[LargeBuffer]);
    while (const std::size_t count = from.read(piece.get(), LargeBuffer)) {
        Send(std::string_view(piece.get(), count));
    }
    return from.GetError();
}

/// Writes the complete lines and moves the current line to the front of the buffer.
void TextFileDst::SendLines() {
    Send(std::string_view(buffer_.get(), lineStart_));
    const std::string_view line = GetLine();
    std::copy(line.begin(), line.end(), buffer_.get());
    used_ = line.size();
    lineStart_ = 0;
}

void TextFileDst::MakeRoom(std::size_t size) {
    SendLines();
    if (size <= capacity_ - used_ && capacity_ >= LargeBuffer) {
        return;
    }
    const std::size_t capacity = std::max({FirstBuffer, capacity_ * 2, used_ + size});
    std::unique_ptr<char[]> buffer(new char[capacity]);
    std::copy_n(buffer_.get(), used_, buffer.get());
    buffer_ = std::move(buffer);
    capacity_ = capacity;
}

void TextFileDst::Write(const char* text) {
    WriteView(Port::ViewOf(text));
}

void TextFileDst::Write(int number) {
    char digits[16];
    const auto result = std::to_chars(digits, digits + sizeof digits, number);
    if (IsOpen()) {
        AppendWrapping(std::string_view(digits, static_cast<std::size_t>(result.ptr - digits)));
    }
}

void TextFileDst::WriteView(std::string_view text) {
    if (IsOpen()) {
        WritePiece(text);
    }
}

void TextFileDst::WritePieces(const std::string_view* pieces, std::size_t count) {
    if (IsOpen()) {
        std::for_each(pieces, pieces + count, [this](std::string_view text) { WritePiece(text); });
    }
}

inline void TextFileDst::WritePiece(std::string_view text) {
    for (std::size_t end = FindLineFeed(text); end != std::string_view::npos;
         end = FindLineFeed(text)) {
        WriteToLineEnd(text.substr(0, end + 1));
        text.remove_prefix(end + 1);
    }
    if (!text.empty()) {
        AppendWrapping(text);
    }
}

void TextFileDst::WriteToLineEnd(std::string_view text) {
    BeginLine();
    if (text.size() < std::max(FirstBuffer, capacity_)) {
        Append(text);
        StartLine();
        return;
    }
    // A long text is not copied to the buffer.
    StartLine();
    SendLines();
    Send(text);
}

void TextFileDst::AppendIndentation(int levels) {
    for (; levels > 0; --levels) {
        Append(IndentStep);
    }
}

inline void TextFileDst::BeginLine() {
    if (GetLine().empty()) {
        AppendIndentation(GetIndentLevel());
    }
}

inline void TextFileDst::AppendWrapping(std::string_view text) {
    BeginLine();
    if (GetLine().size() + text.size() > Width) {
        Wrap();
    }
    Append(text);
}

/// Breaks the current line where it may be broken.
void TextFileDst::Wrap() {
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

void TextFileDst::SearchBreak() {
    BreakSearch& found = search_;
    const std::string_view line = GetLine();
    for (std::size_t& i = found.searched; i < line.size() && !found.isComment; ++i) {
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
}

void TextFileDst::BreakAt(std::size_t position) {
    const std::string rest(GetLine().substr(position));
    used_ = lineStart_ + position;
    Append("\n");
    StartLine();
    AppendIndentation(GetIndentLevel() + ContinuationLevels);
    Append(rest);
}

} // namespace Orn_Hdl
