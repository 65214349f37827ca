#include "diff/Components.h"

#include "diff/Names.h"

#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <limits>
#include <unordered_map>
#include <utility>

namespace Tool::Diff {

namespace {

using Orn_Hdl::Component;
using Orn_Hdl::Pin;

std::uint32_t GetWidth(const Pin* pin) {
    if (pin == nullptr) {
        return 0;
    }
    return pin->GetPinType() == Orn_Hdl::PinTypeBus
               ? CountBits(static_cast<const Orn_Hdl::BusPin*>(pin)->GetWidth())
               : 1;
}

/// A hash of the names and directions of all pins.
std::uint64_t HashPins(const Component& component) {
    std::uint64_t hash = 0;
    for (const Pin* pin : component.GetPinIterator()) {
        const auto direction = static_cast<std::uint64_t>(pin->GetPolarity().GetValue() + 1);
        hash = Mix(hash, Mix(HashName(pin->GetNameView()), direction));
    }
    return hash;
}

bool HaveSamePins(const Component& a, const Component& b) {
    auto left = a.GetPinIterator();
    auto right = b.GetPinIterator();
    for (; !left.IsAtEnd() && !right.IsAtEnd(); left.Next(), right.Next()) {
        const Pin& inA = *left.GetCurrent();
        const Pin& inB = *right.GetCurrent();
        if (!Port::EqualIgnoringCase(inA.GetNameView(), inB.GetNameView()) ||
            inA.GetPolarity() != inB.GetPolarity()) {
            return false;
        }
    }
    return left.IsAtEnd() && right.IsAtEnd();
}

} // namespace

std::uint32_t CountBits(std::int64_t width) noexcept {
    return width >= 1 && width <= MostBits ? static_cast<std::uint32_t>(width) : 1;
}

Components::Components(const Orn_Hdl::Netlist& a, const Orn_Hdl::Netlist& b) {
    PairByName(a, b);
    PairByPins();
    for (PairedComponent& component : all_) {
        PairPins(component);
    }
    all_.emplace_back();
    Enter(A);
    Enter(B);
}

void Components::PairByName(const Orn_Hdl::Netlist& a, const Orn_Hdl::Netlist& b) {
    std::unordered_map<const Component*, std::uint32_t> taken;
    for (const Component* component : a.GetComponentIterator()) {
        PairedComponent pair;
        pair.components[A] = component;
        const Component* const other = b.GetComponent(component->GetNameView());
        if (other != nullptr && taken.emplace(other, 0).second) {
            pair.components[B] = other;
        }
        all_.push_back(std::move(pair));
    }
    for (const Component* component : b.GetComponentIterator()) {
        if (taken.find(component) == taken.end()) {
            all_.emplace_back().components[B] = component;
        }
    }
}

void Components::PairByPins() {
    std::unordered_map<std::uint64_t, std::vector<std::uint32_t>> left;
    for (std::uint32_t i = 0; i < all_.size(); ++i) {
        const PairedComponent& pair = all_[i];
        if (!pair.IsIn(B) && !pair.components[A]->GetPinIterator().IsAtEnd()) {
            left[HashPins(*pair.components[A])].push_back(i);
        }
    }
    std::unordered_map<std::uint64_t, std::size_t> next;
    for (PairedComponent& pair : all_) {
        if (pair.IsIn(A)) {
            continue;
        }
        const std::uint64_t hash = HashPins(*pair.components[B]);
        const auto found = left.find(hash);
        std::size_t& at = next[hash];
        if (found != left.end() && at < found->second.size()) {
            PairedComponent& former = all_[found->second[at]];
            if (HaveSamePins(*former.components[A], *pair.components[B])) {
                former.components[B] = std::exchange(pair.components[B], nullptr);
                former.isRenamed = true;
                ++at;
            }
        }
    }
    all_.erase(
        std::remove_if(all_.begin(), all_.end(),
                       [](const PairedComponent& pair) { return !pair.IsIn(A) && !pair.IsIn(B); }),
        all_.end());
}

/// Pins are paired by their whole names first, since there may be several of one base name, and
/// those that are left by their base names.
void Components::PairPins(PairedComponent& component) {
    std::unordered_map<const Pin*, std::uint32_t> rows;
    std::unordered_multimap<std::uint64_t, std::uint32_t> byBase;
    const auto hashBase = [](const Pin* pin) { return HashName(GetBase(pin->GetNameView())); };
    if (component.IsIn(A)) {
        for (const Pin* pin : component.components[A]->GetPinIterator()) {
            const Pin* const other =
                component.IsIn(B) ? component.components[B]->GetPin(pin->GetNameView()) : nullptr;
            PairedPin pair;
            pair.pins[A] = pin;
            if (other != nullptr && rows.emplace(other, 0).second) {
                pair.pins[B] = other;
            } else {
                byBase.emplace(hashBase(pin), static_cast<std::uint32_t>(component.pins.size()));
            }
            component.pins.push_back(pair);
        }
    }
    if (component.IsIn(B)) {
        for (const Pin* pin : component.components[B]->GetPinIterator()) {
            if (rows.find(pin) != rows.end()) {
                continue;
            }
            const auto [from, to] = byBase.equal_range(hashBase(pin));
            const auto found = std::find_if(from, to, [&](const auto& entry) {
                const PairedPin& pair = component.pins[entry.second];
                return pair.pins[B] == nullptr &&
                       Port::EqualIgnoringCase(GetBase(pair.pins[A]->GetNameView()),
                                               GetBase(pin->GetNameView()));
            });
            if (found != to) {
                component.pins[found->second].pins[B] = pin;
            } else {
                component.pins.emplace_back().pins[B] = pin;
            }
        }
    }
    for (PairedPin& pin : component.pins) {
        pin.first = component.width;
        pin.width = std::max(GetWidth(pin.pins[A]), GetWidth(pin.pins[B]));
        component.width += pin.width;
    }
}

void Components::Enter(Design design) {
    tables_[design] = IndexTable(all_.size());
    std::size_t pinCount = 0;
    for (const PairedComponent& pair : all_) {
        pinCount += pair.pins.size();
    }
    pinTables_[design] = IndexTable(pinCount);
    for (std::uint32_t i = 0; i < all_.size(); ++i) {
        const PairedComponent& pair = all_[i];
        if (!pair.IsIn(design)) {
            continue;
        }
        tables_[design].Add(HashPointer(pair.components[design]), i);
        for (std::uint32_t k = 0; k < pair.pins.size(); ++k) {
            if (const Pin* const pin = pair.pins[k].pins[design]) {
                pinTables_[design].Add(Mix(HashName(pin->GetNameView()), i),
                                       static_cast<std::uint32_t>(pinRows_[design].size()));
                pinRows_[design].emplace_back(i, k);
            }
        }
    }
}

std::uint32_t Components::Find(Design design, const Component* component) const noexcept {
    if (component == nullptr) {
        return GetNone();
    }
    const std::uint32_t found =
        tables_[design].Find(HashPointer(component), [&](std::uint32_t row) {
            return all_[row].components[design] == component;
        });
    return found == None ? GetNone() : found;
}

std::uint32_t Components::FindPin(std::uint32_t component, Design design, std::string_view name,
                                  std::uint32_t expected) const noexcept {
    const std::vector<PairedPin>& pins = all_[component].pins;
    const auto isNamed = [&](std::uint32_t pin) {
        return pins[pin].pins[design] != nullptr &&
               Port::EqualIgnoringCase(pins[pin].pins[design]->GetNameView(), name);
    };
    if (expected < pins.size() && isNamed(expected)) {
        return expected;
    }
    const std::uint32_t row =
        pinTables_[design].Find(Mix(HashName(name), component), [&](std::uint32_t at) {
            const auto& [owner, pin] = pinRows_[design][at];
            return owner == component && isNamed(pin);
        });
    return row == None ? None : pinRows_[design][row].second;
}

} // namespace Tool::Diff
