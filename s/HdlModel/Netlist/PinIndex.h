// Finds the pins of a long list by name.
#pragma once

#include "Containers/HashSlots.h"
#include "HdlModel/Names/NameIndex.h"
#include "Orn_Hdl/Model/Component.h"
#include "Orn_Hdl/Model/Pins.h"
#include "Port/Pool.h"

#include <cstddef>
#include <cstdint>
#include <set>
#include <string_view>
#include <utility>

namespace Orn_Hdl {

/// The places of the pins by name. A component shares its index with its instances, whose pins have
/// the same names, until either has a pin renamed. It holds no names: it asks the pins of the list
/// that it is called for.
///
/// A look-up only reads, so that several threads may search a list at a time.
class PinIndex {
public:
    /// The first pin with that name; null if there is none.
    Pin* Find(const PinList& pins, std::string_view name) const noexcept;
    /// Enters the pin at a place of a list. If allocation fails, nothing changes.
    void Enter(const PinList& pins, std::uint32_t place);
    /// Removes a pin that is in the list. \return its position.
    std::uint32_t TakeOut(const PinList& pins, const Pin& pin) noexcept;

    void Join() noexcept { ++users_; }
    void Leave() noexcept {
        if (--users_ == 0) {
            delete this;
        }
    }
    bool IsShared() const noexcept { return users_ > 1; }
    /// A copy with one user.
    PinIndex* Clone() const { return new PinIndex(slots_, others_); }

    PinIndex() = default;

private:
    /// For each name the position of its pin, plus one.
    using Slots = HashSlots<std::uint32_t, Port::Pool::Allocator>;
    /// More pins with names that are already present, by hash and position. Only users of the
    /// classes give two pins of a list one name.
    using Others = std::set<std::pair<std::uint32_t, std::uint32_t>>;

    PinIndex(const Slots& slots, const Others& others) : slots_(slots), others_(others) {}

    std::uint32_t FindValue(const PinList& pins, const NameKey& key) const noexcept;

    Slots slots_;
    Others others_;
    std::size_t users_ = 1;
};

/// Keeps the index of a pin's list up to date while the pin is renamed.
class PinRenaming {
public:
    explicit PinRenaming(const Pin& pin) noexcept;
    PinRenaming(const PinRenaming&) = delete;
    PinRenaming& operator=(const PinRenaming&) = delete;
    /// Enters the pin under the name that it has now.
    ~PinRenaming();

private:
    PinList* list_;
    std::uint32_t place_ = 0;
};

} // namespace Orn_Hdl
