#include "Streams/TextFileDst.h"

#include "Port/Ascii.h"

#include <charconv>

namespace Orn_Hdl {

namespace {

constexpr std::string_view IndentStep = "   ";
constexpr int ContinuationLevels = 2;

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

/// Most pieces of a netlist are a few characters long: looking at these one by one beats a call.
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

TextFileDst::~TextFileDst() {
    if (!replaces_) {
        Close();
    }
}

bool TextFileDst::Open(const char* fileName, TextFileOutStream::Mode mode) {
    Close();
    replaces_ = mode == TextFileOutStream::Replace;
    if (file_.open(fileName, FileMode(mode), mode != TextFileOutStream::Append)) {
        stream_.emplace(file_);
    }
    return IsOpen();
}

void TextFileDst::Close() {
    if (IsOpen()) {
        Flush();
        file_.close();
    }
    stream_.reset();
    EndBuffer();
}

void TextFileDst::EndBuffer() {
    line_.clear();
    search_ = BreakSearch();
}

void TextFileDst::Flush() {
    if (!IsOpen()) {
        return;
    }
    if (!line_.empty()) {
        // The text goes on in a new line, which begins when something is written into it.
        *stream_ << line_ << "\n";
        EndBuffer();
    }
    stream_->flush();
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
    if (!IsOpen()) {
        return;
    }
    for (std::size_t end = FindLineFeed(text); end != std::string_view::npos;
         end = FindLineFeed(text)) {
        BeginLine();
        *stream_ << line_ << text.substr(0, end + 1);
        EndBuffer();
        text.remove_prefix(end + 1);
    }
    if (!text.empty()) {
        AppendWrapping(text);
    }
}

void TextFileDst::AppendIndentation(int extraLevels) {
    for (int level = GetIndentLevel() + extraLevels; level > 0; --level) {
        line_ += IndentStep;
    }
}

void TextFileDst::BeginLine() {
    if (line_.empty()) {
        AppendIndentation(0);
    }
}

void TextFileDst::AppendWrapping(std::string_view text) {
    BeginLine();
    if (line_.size() + text.size() > Width) {
        SearchBreak();
        if (!search_.isComment) {
            if (search_.afterSpace > 0) {
                BreakAt(search_.afterSpace);
            } else if (search_.afterComma > 0) {
                BreakAt(search_.afterComma);
            } else if (!search_.inLiteral) {
                BreakAt(line_.size());
            }
        }
    }
    line_ += text;
}

void TextFileDst::SearchBreak() {
    BreakSearch& found = search_;
    for (std::size_t& i = found.searched; i < line_.size() && !found.isComment; ++i) {
        const char c = line_[i];
        const char before = i > 0 ? line_[i - 1] : '\0';
        if (c == '"') {
            found.inLiteral = !found.inLiteral;
        } else if (c == ' ' && !found.inLiteral) {
            found.afterSpace = i + 1;
        } else if (c == ',' && !found.inLiteral) {
            found.afterComma = i + 1;
        }
        found.isComment = (c == '/' && before == '/') || (c == '-' && before == '-') ||
                          (c == '*' && before == '/');
    }
}

void TextFileDst::BreakAt(std::size_t position) {
    *stream_ << std::string_view(line_).substr(0, position) << "\n";
    const std::string rest = line_.substr(position);
    EndBuffer();
    AppendIndentation(ContinuationLevels);
    line_ += rest;
}

} // namespace Orn_Hdl
