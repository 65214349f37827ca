#include "Streams/TextFileDst.h"

#include "Streams/BranchDst.h"

#include <algorithm>
#include <string>

namespace Orn_Hdl {

namespace {

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
    SetTaking(IsOpen());
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
    SetTaking(IsOpen());
    return IsOpen();
}

void TextFileDst::Close() {
    if (IsOpen()) {
        Flush();
        file_.close();
    }
    SetTaking(false);
    FreeBuffer();
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
    Send(GetLines());
    DropLines();
}

bool TextFileDst::MakeRoom(std::size_t size) {
    SendLines();
    if (size > GetRoom() || GetCapacity() < LargeBuffer) {
        Grow(size);
    }
    return true;
}

std::unique_ptr<BranchDst> TextFileDst::MakeBranch() const {
    return IsOpen() ? std::make_unique<BranchDst>(GetIndentLevel()) : nullptr;
}

bool TextFileDst::TakeLines(std::string_view lines) {
    if (!GetLine().empty()) {
        return false;
    }
    SendLines();
    Send(lines);
    return true;
}

/// A long text is not copied to the buffer.
void TextFileDst::WriteLongLine(std::string_view text) {
    StartLine();
    SendLines();
    Send(text);
}

} // namespace Orn_Hdl
