// Texts that go straight into the current line of a stream's destination.
#pragma once

#include "Orn_Hdl/Streams.h"
#include "Streams/LineDst.h"
#include "Streams/StreamBranch.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace Orn_Hdl {

/// Writes texts to a stream. Most texts of a netlist fit into the line as they are: they are copied
/// there without a call, which would cost more than the copy. What is written is the same.
class DirectText {
public:
    /// \param out must outlive this object.
    explicit DirectText(OutStream& out) : out_(out), lines_(StreamBranch::FindLines(out)) {}

    /// Writes texts as separate pieces: lines are only broken between pieces.
    template <class... Texts> void Put(const Texts&... texts) {
        if (lines_ == nullptr || !lines_->AppendPlain(ViewOf(texts)...)) {
            out_.WritePieces({ViewOf(texts)...});
        }
    }
    /// Writes texts as separate pieces, and a line end.
    template <class... Texts> void PutLine(const Texts&... texts) {
        Put(texts...);
        EndLine();
    }
    /// Writes a text and a line end as one piece: the line is not broken in front of it.
    void EndLine(std::string_view text) {
        if (lines_ == nullptr || !lines_->EndLine(text)) {
            out_ << std::string(text).append("\n");
        }
    }
    /// Writes a line end.
    void EndLine() {
        if (lines_ == nullptr || !lines_->EndLine("")) {
            out_ << OutStream::NewLine;
        }
    }

private:
    static std::string_view ViewOf(std::string_view text) noexcept { return text; }
    /// A literal, whose length need not be counted.
    template <std::size_t Size> static std::string_view ViewOf(const char (&text)[Size]) noexcept {
        return std::string_view(text, Size - 1);
    }

    OutStream& out_;
    /// Null if the destination is of another kind.
    LineDst* const lines_;
};

} // namespace Orn_Hdl
