// Lines with indentation, broken after 80 columns, in a buffer.
#pragma once

#include "Orn_Hdl/Streams.h"
#include "Streams/PlainText.h"

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

    /// Whether texts are laid out in lines; otherwise they stay as they are.
    virtual bool IsLayingOut() const noexcept { return true; }
    /// Does what `WritePieces` does if that means to copy the texts: they stay within the line and
    /// the buffer, and have no control characters. \return false, nothing written, otherwise.
    template <class... Texts> bool AppendPlain(Texts... texts) noexcept {
        char* to = isTaking_ ? FindPlace((texts.size() + ...)) : nullptr;
        const auto append = [&to](std::string_view text) {
            const bool isPlain = PlainText::Copy(text, to);
            to += text.size();
            return isPlain;
        };
        if (to == nullptr || !(append(texts) && ...)) {
            return false;
        }
        used_ = static_cast<std::size_t>(to - buffer_.get());
        return true;
    }
    /// Writes a text and a line end as one piece, if the line has begun and there is room in the
    /// buffer. \return false, nothing written, otherwise.
    bool EndLine(std::string_view text) noexcept {
        char* const to = buffer_.get() + used_;
        if (!isTaking_ || used_ == lineStart_ || text.size() >= capacity_ - used_ ||
            !PlainText::Copy(text, to)) {
            return false;
        }
        to[text.size()] = '\n';
        used_ += text.size() + 1;
        StartLine();
        return true;
    }

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
    static constexpr std::string_view IndentStep = "   ";

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

    /// Where a text can be copied to: behind the line, or behind the indentation of an empty one,
    /// which is written there but is no part of the line yet.
    /// \return null if the line may have to be broken or the buffer is full, and for no text in an
    /// empty line.
    char* FindPlace(std::size_t size) const noexcept {
        const std::size_t length = used_ - lineStart_;
        const std::size_t levels = length > 0 ? 0 : static_cast<std::size_t>(GetIndentLevel());
        const std::size_t needed = levels * IndentStep.size() + size;
        if (length + needed > Width || needed > capacity_ - used_ || length + size == 0) {
            return nullptr;
        }
        char* place = buffer_.get() + used_;
        for (std::size_t i = 0; i < levels; ++i) {
            std::memcpy(place, IndentStep.data(), IndentStep.size());
            place += IndentStep.size();
        }
        return place;
    }
    const std::string_view* AppendPlainly(const std::string_view* piece,
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
