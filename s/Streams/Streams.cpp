#include "Orn_Hdl/Streams.h"

#include "Port/Ascii.h"
#include "Streams/BranchDst.h"
#include "Streams/TextFileDst.h"
#include "Streams/TextMemDst.h"

namespace Orn_Hdl {

StreamDst::~StreamDst() = default;

void StreamDst::Flush() {}

void StreamDst::WriteNewLine() {
    WriteView("\n");
}

void StreamDst::WriteView(std::string_view text) {
    Write(std::string(text).c_str());
}

void StreamDst::WritePieces(const std::string_view* pieces, std::size_t count) {
    for (std::size_t i = 0; i < count; ++i) {
        WriteView(pieces[i]);
    }
}

std::unique_ptr<BranchDst> StreamDst::MakeBranch() const {
    return nullptr;
}

bool StreamDst::TakeLines(std::string_view /*lines*/) {
    return false;
}

bool StreamDst::IsWriting() const noexcept {
    return true;
}

OutStream::OutStream(StreamDst* destination) : destination_(destination) {}

OutStream::~OutStream() = default;

OutStream& OutStream::operator<<(const char* text) {
    return *this << Port::ViewOf(text);
}

OutStream& OutStream::operator<<(std::string_view text) {
    if (destination_ != nullptr) {
        destination_->WriteView(text);
    }
    return *this;
}

OutStream& OutStream::WritePieces(std::initializer_list<std::string_view> pieces) {
    if (destination_ != nullptr) {
        destination_->WritePieces(pieces.begin(), pieces.size());
    }
    return *this;
}

OutStream& OutStream::operator<<(int number) {
    if (destination_ != nullptr) {
        destination_->Write(number);
    }
    return *this;
}

OutStream& OutStream::operator<<(Operand operand) {
    if (destination_ != nullptr && operand == NewLine) {
        destination_->WriteNewLine();
    } else if (destination_ != nullptr && operand == Flush) {
        destination_->Flush();
    }
    return *this;
}

void OutStream::Indent() noexcept {
    if (destination_ != nullptr) {
        destination_->Indent();
    }
}

void OutStream::Unindent() noexcept {
    if (destination_ != nullptr) {
        destination_->Unindent();
    }
}

void OutStream::WriteEmptyLine() {
    int levels = 0;
    while (destination_ != nullptr && destination_->GetIndentLevel() > 0) {
        Unindent();
        ++levels;
    }
    *this << NewLine;
    for (; levels > 0; --levels) {
        Indent();
    }
}

TextFileOutStream::TextFileOutStream()
    : OutStream(new TextFileDst()), file_(static_cast<TextFileDst&>(*GetDestination())) {}

TextFileOutStream::TextFileOutStream(const char* fileName, bool append)
    : TextFileOutStream(fileName, append ? Append : Overwrite) {}

TextFileOutStream::TextFileOutStream(const Port::StringBase<char>& fileName, bool append)
    : TextFileOutStream(fileName.CStr(), append) {}

TextFileOutStream::TextFileOutStream(const Port::StringBase<char>& fileName, Mode mode)
    : TextFileOutStream(fileName.CStr(), mode) {}

TextFileOutStream::TextFileOutStream(const char* fileName, Mode mode)
    : OutStream(new TextFileDst(fileName, mode)),
      file_(static_cast<TextFileDst&>(*GetDestination())) {}

TextFileOutStream::TextFileOutStream(const Port::Folder& folder, const char* path,
                                     const char* fileName, Mode mode)
    : OutStream(new TextFileDst(folder, path, fileName, mode)),
      file_(static_cast<TextFileDst&>(*GetDestination())) {}

TextFileOutStream::~TextFileOutStream() = default;

bool TextFileOutStream::Open(const char* fileName, bool append) {
    return Open(fileName, append ? Append : Overwrite);
}

bool TextFileOutStream::Open(const Port::StringBase<char>& fileName, bool append) {
    return Open(fileName.CStr(), append);
}

bool TextFileOutStream::Open(const char* fileName, Mode mode) {
    return file_.Open(fileName, mode);
}

bool TextFileOutStream::Open(const Port::StringBase<char>& fileName, Mode mode) {
    return Open(fileName.CStr(), mode);
}

bool TextFileOutStream::IsOpen() const noexcept {
    return file_.IsOpen();
}

void TextFileOutStream::Close() {
    file_.Close();
}

Port::StringBase<char> TextFileOutStream::GetFileName() const {
    return file_.GetFileName();
}

int TextFileOutStream::GetError() const noexcept {
    return file_.GetError();
}

std::uint64_t TextFileOutStream::GetLeftoverSize() const noexcept {
    return file_.GetLeftoverSize();
}

Port::StringBase<char> TextFileOutStream::FlushToRead() {
    file_.Flush();
    return file_.GetTemporaryName();
}

int TextFileOutStream::WriteFile(const char* fileName) {
    file_.Flush();
    return file_.CopyFile(fileName);
}

TextMemOutStream::TextMemOutStream(const char* initial) : TextMemOutStream(Port::ViewOf(initial)) {}

TextMemOutStream::TextMemOutStream(std::string_view initial)
    : OutStream(new TextMemDst(initial)), memory_(static_cast<TextMemDst&>(*GetDestination())) {}

TextMemOutStream::~TextMemOutStream() = default;

Port::StringBase<char> TextMemOutStream::GetValue() const {
    return memory_.GetText();
}

void TextMemOutStream::SetValue(const char* text) {
    SetValue(Port::ViewOf(text));
}

void TextMemOutStream::SetValue(std::string_view text) {
    memory_.SetText(text);
}

} // namespace Orn_Hdl
