// Destinations in memory for whole lines that another destination takes later.
#pragma once

#include "Streams/LineDst.h"

#include <cstddef>
#include <string_view>

namespace Orn_Hdl {

/// Formats text as a file does, for another destination that stands at the start of a line. Its
/// text consists of items, and it holds as many as its limit allows.
class BranchDst : public LineDst {
public:
    /// A branch for text that begins at that indent level.
    explicit BranchDst(int indentLevel);

    /// Begins with a new text, which gets no longer than `limit`.
    void Begin(std::size_t limit) noexcept;
    /// Ends an item. \return false if it was too long, or does not end with a line. The text is
    /// then that of the items before it.
    bool EndItem() noexcept;
    /// The text of the items.
    std::string_view GetText() const noexcept { return GetLines().substr(0, size_); }

protected:
    bool MakeRoom(std::size_t size) override;
    void WriteLongLine(std::string_view text) override;

private:
    /// Where the last item ends.
    std::size_t size_ = 0;
    std::size_t limit_ = 0;
};

/// Leaves text as it is.
class PlainBranchDst final : public BranchDst {
public:
    using BranchDst::BranchDst;

    bool IsLayingOut() const noexcept override { return false; }
    void WriteNewLine() override;
    void Write(const char* text) override;
    void Write(int number) override;
    void WriteView(std::string_view text) override;
    void WritePieces(const std::string_view* pieces, std::size_t count) override;
};

} // namespace Orn_Hdl
