// The pins of a component or an instance, and how they are made and destroyed.
#pragma once

#include "Orn_Hdl/Model/Component.h"

#include <cstddef>
#include <cstdint>
#include <memory>

namespace Orn_Hdl {

/// A component makes its pins one by one. The pins of an instance stand in one block of memory, in
/// the order of the component's pins, and behind them the array of pointers to them. In both cases
/// a pin leads to its list, and leaves it when it is destroyed.
class PinBlock {
public:
    /// Appends a pin to a component's list, which owns it.
    static void Add(PinList& pins, std::unique_ptr<Pin> pin);
    /// Takes a pin out of its list without destroying it.
    static void LetGo(PinList& pins, Pin& pin) noexcept;
    /// Whether a component owns a pin.
    static bool Owns(const Component& component, const Pin& pin) noexcept;
    /// Destroys a pin of a list; null, and a pin of another list, are ignored.
    static void Remove(PinList& pins, Pin* pin) noexcept;
    /// Destroys the pins of a component.
    static void DeleteAll(PinList& pins) noexcept;

    /// Makes a block with clones of all pins of a list.
    static void CloneAll(const PinList& from, PinList& to);
    /// Destroys the pins of an instance and frees their block.
    static void DestroyAll(PinList& pins) noexcept;
    /// The pin that was made at a place of an instance's list, unless it has been removed, which
    /// the list's index knows; null for a place that the list does not have.
    static Pin* GetAtPlace(const PinList& pins, std::uint32_t place) noexcept;

private:
    static constexpr std::size_t PlaceSize = sizeof(ScalarPin);
    static_assert(sizeof(BusPin) == PlaceSize && sizeof(BusIndexPin) == PlaceSize);
    static_assert(alignof(ScalarPin) <= 8);

    static Pin* TakeLast(PinList& pins) noexcept;
    static void Destroy(PinList& pins, void* block) noexcept;
};

} // namespace Orn_Hdl
