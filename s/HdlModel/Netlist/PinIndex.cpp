#include "HdlModel/Netlist/PinIndex.h"

namespace Orn_Hdl {

std::atomic<std::uint64_t> PinIndex::renamings{0};

Pin* PinIndex::Find(const PtrArray<Pin*>& pins, std::string_view name) {
    const std::uint64_t seen = renamings.load(std::memory_order_relaxed);
    if (seen != seenRenamings_ || pins.GetSize() < indexed_) {
        Forget();
    }
    if (indexed_ == 0) {
        byName_.Clear();
        seenRenamings_ = seen;
    }
    for (; indexed_ < pins.GetSize(); ++indexed_) {
        Pin* const pin = pins.GetAt(indexed_);
        if (byName_.Find(NameKey(pin->GetNameView())) == nullptr) {
            byName_.Add(pin);
        }
    }
    return byName_.Find(NameKey(name));
}

} // namespace Orn_Hdl
