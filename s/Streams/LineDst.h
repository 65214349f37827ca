// Lines with indentation, broken after 80 columns, in a buffer.
#pragma once

#include "Orn_Hdl/Streams.h"

#include <cstddef>
#include <cstring>
#include <memory>
#include <string_view>

namespace Orn_Hdl {

/// Formats lines. What becomes of those that do not fit into the buffer is the derived class's
/// affair.
class LineDst : public StreamDst {
public:
    static constexpr std::size_t Width = 80;

    LineDst(const LineDst&) = delete;
    LineDst& operator=(const LineDst&) = delete;
    ~LineDst() override;

    void WriteNewLine() override;
    void Write(const char* text) override;
    void Write(int number) override;
    void WriteView(std::string_view text) override;
    void WritePieces(const std::string_view* pieces, std::size_t count) override;

protected:
    LineDst() noexcept = default;

    /// Whether text is taken, or dropped.
    void SetTaking(bool isTaking) noexcept { isTaking_ = isTaking; }
    bool IsTaking() const noexcept { return isTaking_; }

    /// The complete lines.
    std::string_view GetLines() const noexcept {
        return std::string_view(buffer_.get(), lineStart_);
    }
    /// The current line.
    std::string_view GetLine() const noexcept {
        return std::string_view(buffer_.get() + lineStart_, used_ - lineStart_);
    }
    /// Ends the current line, which will not change any more.
    void StartLine() noexcept {
        lineStart_ = used_;
        search_ = BreakSearch();
    }
    void Append(std::string_view text) {
        if (text.size() > capacity_ - used_ && !MakeRoom(text.size())) {
            return;
        }
        std::memcpy(buffer_.get() + used_, text.data(), text.size());
        used_ += text.size();
    }
    /// Drops the complete lines and moves the current line to the front of the buffer.
    void DropLines() noexcept;
    /// Drops the complete lines and the current one.
    void DropAll() noexcept;
    void FreeBuffer() noexcept;
    /// Makes the buffer larger, for `size` characters more at least, and `most` in all.
    void Grow(std::size_t size, std::size_t most = static_cast<std::size_t>(-1));
    std::size_t GetCapacity() const noexcept { return capacity_; }
    std::size_t GetRoom() const noexcept { return capacity_ - used_; }

    /// Makes room for as many characters behind the current line. \return false if there is none;
    /// then they are dropped.
    virtual bool MakeRoom(std::size_t size) = 0;
    /// Takes a text that is longer than the buffer and ends the current line.
    virtual void WriteLongLine(std::string_view text) = 0;

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

    const std::string_view* AppendPlain(const std::string_view* piece,
                                        const std::string_view* end) noexcept;
    void WriteRest(const std::string_view* piece, const std::string_view* end);
    void WritePiece(std::string_view text);
    void WriteToLineEnd(std::string_view text);
    void BeginLine();
    void AppendWrapping(std::string_view text);
    void Wrap();
    void SearchBreak();
    void BreakAt(std::size_t position);
    void AppendIndentation(int levels);

    bool isTaking_ = false;
    /// Complete lines, followed by the current line.
    std::unique_ptr<char[]> buffer_;
    std::size_t capacity_ = 0;
    std::size_t used_ = 0;
    std::size_t lineStart_ = 0;
    BreakSearch search_;
};

} // namespace Orn_Hdl
