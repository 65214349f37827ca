// What one design has that another one does not have, or has otherwise.
#pragma once

#include "Orn_Hdl/Check.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace Tool::Diff {

/// What became of an object of the first design in the second one.
enum class Change : std::uint8_t { Removed, Added, Renamed, Rewired, Retied, Changed };

inline constexpr std::size_t ChangeCount = 6;

/// "removed", "added", "renamed", "rewired", "retied" or "changed".
const char* GetName(Change change) noexcept;

/// The kind of an object.
enum class Thing : std::uint8_t {
    Module,
    Component,
    ComponentPin,
    Port,
    Signal,
    Instance,
    Pin,
    Alias,
    Attribute,
    Comment
};

/// The name of a kind, such as "component pin".
const char* GetName(Thing thing) noexcept;

/// How a design names an object, and what brought the object in there.
struct Side {
    /// Empty if the design does not have the object.
    std::string name;
    /// What differs, such as the net of a pin or the value of an attribute; empty for none.
    std::string text;
    /// The kind and the names of what has to be looked for in the file.
    Orn_Hdl::Check::Cause cause;
    /// The line of the file; 0 while it is not known.
    std::uint64_t line = 0;
};

struct Difference {
    Change change = Change::Changed;
    Thing thing = Thing::Module;
    /// What of the object differs, such as "direction"; empty where the change tells it.
    std::string what;
    Side a;
    Side b;
};

/// Collects differences by what changed. All are counted, and the first ones of each kind are kept.
class Differences {
public:
    /// \param most how many are kept of each kind; 0 for all.
    explicit Differences(std::size_t most) : most_(most) {}

    /// Counts a difference. \return whether it should be kept, so that it is worth describing.
    bool Count(Change change) {
        const std::size_t count = ++counts_[static_cast<std::size_t>(change)];
        return most_ == 0 || count <= most_;
    }
    void Keep(Difference difference) {
        kept_[static_cast<std::size_t>(difference.change)].push_back(std::move(difference));
    }

    std::size_t GetCount(Change change) const noexcept {
        return counts_[static_cast<std::size_t>(change)];
    }
    std::size_t GetTotal() const noexcept;
    /// Makes them the differences of the designs in the other order.
    void Flip();
    /// The kept differences: what was removed first, then what was added, as `Change` has them.
    /// At most as many as are kept of each kind.
    std::vector<Difference> Take();

private:
    std::size_t most_;
    std::array<std::size_t, ChangeCount> counts_ = {};
    std::array<std::vector<Difference>, ChangeCount> kept_;
};

} // namespace Tool::Diff
