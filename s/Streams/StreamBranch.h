// A stream in memory for lines that another stream takes later.
#pragma once

#include "Orn_Hdl/Streams.h"
#include "Streams/BranchDst.h"

#include <cstddef>
#include <memory>
#include <string_view>

namespace Orn_Hdl {

/// Formats items of a stream's text apart from it, in another thread if need be. An item consists
/// of whole lines, written at the indent level that the stream has when the branch is made.
class StreamBranch {
public:
    /// \return null if the stream's destination has no branches.
    static std::unique_ptr<StreamBranch> Make(const OutStream& trunk);
    /// Whether text of the stream goes anywhere; false after a failure.
    static bool IsWriting(const OutStream& trunk) noexcept;
    /// The destination of a stream if it lays texts out in lines; otherwise null.
    static LineDst* FindLines(const OutStream& stream) noexcept;

    OutStream& GetStream() noexcept { return stream_; }
    /// Begins with a new text, which gets no longer than `limit`.
    void Begin(std::size_t limit) noexcept { branch_.Begin(limit); }
    /// Ends an item. \return false if it does not belong to the text, because it was too long or
    /// does not end with a line.
    bool EndItem() noexcept { return branch_.EndItem(); }
    /// Writes the text to the stream. \return false, nothing written, if that does not stand at the
    /// start of a line of the same indent level.
    bool Join(OutStream& trunk) const;

private:
    explicit StreamBranch(std::unique_ptr<BranchDst> branch);

    BranchDst& branch_;
    const int indentLevel_;
    OutStream stream_;
};

} // namespace Orn_Hdl
