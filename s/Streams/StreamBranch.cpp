#include "Streams/StreamBranch.h"

#include <utility>

namespace Orn_Hdl {

std::unique_ptr<StreamBranch> StreamBranch::Make(const OutStream& trunk) {
    const StreamDst* const destination = trunk.GetDestination();
    std::unique_ptr<BranchDst> branch =
        destination == nullptr ? nullptr : destination->MakeBranch();
    return branch == nullptr ? nullptr
                             : std::unique_ptr<StreamBranch>(new StreamBranch(std::move(branch)));
}

StreamBranch::StreamBranch(std::unique_ptr<BranchDst> branch)
    : branch_(*branch), indentLevel_(branch->GetIndentLevel()), stream_(branch.release()) {}

bool StreamBranch::IsWriting(const OutStream& trunk) noexcept {
    return trunk.GetDestination() != nullptr && trunk.GetDestination()->IsWriting();
}

LineDst* StreamBranch::FindLines(const OutStream& stream) noexcept {
    auto* const lines = dynamic_cast<LineDst*>(stream.GetDestination());
    return lines != nullptr && lines->IsLayingOut() ? lines : nullptr;
}

bool StreamBranch::Join(OutStream& trunk) const {
    return trunk.GetDestination()->GetIndentLevel() == indentLevel_ &&
           trunk.GetDestination()->TakeLines(branch_.GetText());
}

} // namespace Orn_Hdl
