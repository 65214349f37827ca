// The pins of a component or an instance, and how they are created and destroyed.
#pragma once

#include "Orn_Hdl/Model/Component.h"

#include <cstddef>
#include <cstdint>
#include <memory>

namespace Orn_Hdl {

/// A component creates its pins one by one. The pins of an instance are in one block of memory, in
/// the order of the component's pins, followed by the array of pointers to them. In both cases a
/// pin knows its list, and leaves it when it is destroyed.
class PinBlock {
public:
    /// Appends a pin to a component's list, which owns it.
    static void Add(PinList& pins, std::unique_ptr<Pin> pin);
    /// Removes a pin from its list without destroying it.
    static void LetGo(PinList& pins, Pin& pin) noexcept;
    /// Whether a component owns a pin.
    static bool Owns(const Component& component, const Pin& pin) noexcept;
    /// Destroys a pin of a list; null, and a pin of another list, are ignored.
    static void Remove(PinList& pins, Pin* pin) noexcept;
    /// Destroys the pins of a component.
    static void DeleteAll(PinList& pins) noexcept;

    /// Creates a block with clones of all pins of a list.
    static void CloneAll(const PinList& from, PinList& to);
    /// Destroys the pins of an instance and frees their block.
    static void DestroyAll(PinList& pins) noexcept;
    /// The pin that was created at a position of an instance's list, unless it has been removed,
    /// which the list's index records; null for a position that the list does not have.
    static Pin* GetAtPlace(const PinList& pins, std::uint32_t place) noexcept;

private:
    static constexpr std::size_t PlaceSize = sizeof(ScalarPin);
    static_assert(sizeof(BusPin) == PlaceSize && sizeof(BusIndexPin) == PlaceSize);
    static_assert(alignof(ScalarPin) <= 8);

    static Pin* TakeLast(PinList& pins) noexcept;
    static void Destroy(PinList& pins, void* block) noexcept;
};

} // namespace Orn_Hdl
