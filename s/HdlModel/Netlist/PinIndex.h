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

/// Leads from a pin to the list of its component or instance, so that the list's index learns of a
/// new name. The pins of components and those of long lists have such a home: it stands behind the
/// pin in memory, and a spare value of the pin's type bits tells that it is there.
struct PinHome {
    static constexpr std::size_t Size = sizeof(PinList*);

    /// The list; null when the pin has no home.
    static PinList* Get(const Pin& pin) noexcept;
    /// Gives a home to a pin that has room for it behind it.
    static void Set(Pin& pin, PinList* list) noexcept;
};

/// The places of the pins by name. A component shares its index with its instances, whose pins have
/// the same names, until either has a pin renamed. It holds no names: it asks the pins of the list
/// that it is called for.
///
/// A look-up only reads, so that several threads may search a list at a time.
class PinIndex {
public:
    /// The first pin of that name; null when there is none.
    Pin* Find(const PinList& pins, std::string_view name) const noexcept;
    /// Enters the pin at a place of a list. If allocation fails, nothing changes.
    void Enter(const PinList& pins, std::uint32_t place);
    /// Takes a pin out that stands in the list. \return its place.
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
    /// The place of each name's pin, plus one.
    using Slots = HashSlots<std::uint32_t, Port::Pool::Allocator>;
    /// Further pins of names that are there already, by hash and place. Only callers of the classes
    /// give two pins of a list one name.
    using Others = std::set<std::pair<std::uint32_t, std::uint32_t>>;

    PinIndex(const Slots& slots, const Others& others) : slots_(slots), others_(others) {}

    std::uint32_t FindValue(const PinList& pins, const NameKey& key) const noexcept;

    Slots slots_;
    Others others_;
    std::size_t users_ = 1;
};

/// Keeps the index of a pin's list right while the pin gets another name.
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
