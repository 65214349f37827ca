// Finds the pins of a long list by name.
#pragma once

#include "HdlModel/Names/NameIndex.h"
#include "Orn_Hdl/Model/Pins.h"

#include <atomic>
#include <cstdint>
#include <string_view>

namespace Orn_Hdl {

class PinList;

/// Holds the first pin of each name. It notices when its list has grown and when any pin anywhere
/// was renamed, which happens so seldom that building it anew is cheap.
class PinIndex {
public:
    /// Brings the index up to date with a list and looks a name up.
    Pin* Find(const PtrArray<Pin*>& pins, std::string_view name);
    /// Makes the next look-up build the index anew.
    void Forget() noexcept { indexed_ = 0; }

    static void NoteRenaming() noexcept { renamings.fetch_add(1, std::memory_order_relaxed); }

private:
    struct PinName {
        std::string_view operator()(const Pin* pin) const noexcept { return pin->GetNameView(); }
    };

    static std::atomic<std::uint64_t> renamings;

    NameIndex<Pin, PinName> byName_;
    int indexed_ = 0;
    std::uint64_t seenRenamings_ = 0;
};

} // namespace Orn_Hdl
