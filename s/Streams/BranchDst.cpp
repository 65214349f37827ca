#include "Streams/BranchDst.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <string>

namespace Orn_Hdl {

BranchDst::BranchDst(int indentLevel) {
    for (; indentLevel > 0; --indentLevel) {
        Indent();
    }
}

void BranchDst::Begin(std::size_t limit) noexcept {
    DropAll();
    size_ = 0;
    limit_ = limit;
    SetTaking(true);
}

bool BranchDst::EndItem() noexcept {
    if (!IsTaking() || !GetLine().empty()) {
        return false;
    }
    size_ = GetLines().size();
    return true;
}

/// When the limit is reached, nothing more is taken.
bool BranchDst::MakeRoom(std::size_t size) {
    const std::size_t used = GetLines().size() + GetLine().size();
    if (!IsTaking() || used > limit_ || size > limit_ - used) {
        SetTaking(false);
        return false;
    }
    Grow(size, limit_);
    return true;
}

void BranchDst::WriteLongLine(std::string_view text) {
    Append(text);
    StartLine();
}

void PlainBranchDst::WriteNewLine() {
    WriteView("\n");
}

void PlainBranchDst::Write(const char* text) {
    WriteView(Port::ViewOf(text));
}

void PlainBranchDst::Write(int number) {
    WriteView(std::to_string(number));
}

void PlainBranchDst::WriteView(std::string_view text) {
    if (!text.empty()) {
        Append(text);
        StartLine();
    }
}

void PlainBranchDst::WritePieces(const std::string_view* pieces, std::size_t count) {
    std::for_each(pieces, pieces + count, [this](std::string_view text) { WriteView(text); });
}

} // namespace Orn_Hdl
