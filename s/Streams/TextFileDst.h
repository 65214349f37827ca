// The file destination: indentation, and lines broken after 80 columns.
#pragma once

#include "Orn_Hdl/Streams.h"
#include "Port/File.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string>
#include <string_view>

namespace Orn_Hdl {

class TextFileDst final : public StreamDst {
public:
    static constexpr std::size_t Width = 80;

    TextFileDst() = default;
    TextFileDst(const char* fileName, TextFileOutStream::Mode mode);
    /// Opens the file at `path` below a folder.
    TextFileDst(const Port::Folder& folder, const char* path, const char* fileName,
                TextFileOutStream::Mode mode);
    TextFileDst(const TextFileDst&) = delete;
    TextFileDst& operator=(const TextFileDst&) = delete;
    ~TextFileDst() override;

    bool Open(const char* fileName, TextFileOutStream::Mode mode);
    bool IsOpen() const noexcept { return file_.IsOpen(); }
    void Close();
    const Port::StringBase<char>& GetFileName() const noexcept { return fileName_; }
    int GetError() const noexcept { return file_.GetError(); }
    std::uint64_t GetLeftoverSize() const noexcept { return file_.GetLeftoverSize(); }
    /// The name under which the file can be read that is to replace another; empty if none is.
    std::string GetTemporaryName() const { return file_.GetTemporaryName(); }
    /// Writes the bytes of a file. \return 0, or the error number if it cannot be read.
    int CopyFile(const char* fileName);

    void Flush() override;
    void Write(const char* text) override;
    void Write(int number) override;
    void WriteView(std::string_view text) override;
    void WritePieces(const std::string_view* pieces, std::size_t count) override;

private:
    /// The state of the search for a position to break the line. The search continues where it
    /// stopped, so a line of any length is searched once.
    struct BreakSearch {
        std::size_t searched = 0;
        std::size_t afterSpace = 0;
        std::size_t afterComma = 0;
        /// Between double quotes, if a backslash does not escape a quote, as in VHDL.
        bool inLiteral = false;
        /// Between double quotes, if a backslash escapes a quote, as in Verilog.
        bool inEscapingLiteral = false;
        bool isEscaped = false;
        bool isComment = false;
    };

    std::string_view GetLine() const noexcept {
        return std::string_view(buffer_.get() + lineStart_, used_ - lineStart_);
    }
    void WritePiece(std::string_view text);
    void WriteToLineEnd(std::string_view text);
    void BeginLine();
    void AppendWrapping(std::string_view text);
    void Wrap();
    void SearchBreak();
    void BreakAt(std::size_t position);
    void AppendIndentation(int levels);
    void Append(std::string_view text) {
        if (text.size() > capacity_ - used_) {
            MakeRoom(text.size());
        }
        std::memcpy(buffer_.get() + used_, text.data(), text.size());
        used_ += text.size();
    }
    void MakeRoom(std::size_t size);
    /// Ends the current line, which will not change any more.
    void StartLine() noexcept {
        lineStart_ = used_;
        search_ = BreakSearch();
    }
    void Send(std::string_view text);
    void SendLines();

    Port::File file_;
    bool replaces_ = false;
    bool isGood_ = true;
    Port::StringBase<char> fileName_;
    /// Lines that are not written to the file yet, followed by the current line.
    std::unique_ptr<char[]> buffer_;
    std::size_t capacity_ = 0;
    std::size_t used_ = 0;
    std::size_t lineStart_ = 0;
    BreakSearch search_;
};

} // namespace Orn_Hdl
