// Looks up ahead of time what coming command lines name.
#pragma once

#include "HdlModel/Names/NameIndex.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Prefetch.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace Orn_Hdl {

/// In a large design the objects that a line names are rarely in the processor's cache, and waiting
/// for them takes longer than executing the line. While earlier lines are executed, the slots of
/// the names in the index are therefore prefetched, and some lines later the objects found there.
/// These are only hints: nothing goes wrong if the line turns out to name another object or none.
class Foresight {
public:
    static constexpr std::size_t Distance = 16;
    /// The hashes of what a line can name, which stands in its third and fourth word.
    using Hashes = std::array<std::uint32_t, 2>;

    static Hashes HashNames(const StringArray& words) noexcept {
        const std::string_view owner = words.GetView(3);
        return {HashName(words.GetView(2)), HashName(owner.substr(0, owner.find('.')))};
    }

    /// Whether hints are worth their time.
    template <class Index> static bool IsUseful(const Index& index) noexcept {
        return index.GetSize() >= LeastSize;
    }

    /// Takes note of a line that will be executed `Distance` lines later.
    template <class Index> void Note(const Index& index, const Hashes& names) noexcept {
        // Loops rather than a function that takes what to do: a compiler may find that a function
        // that only fetches has no effect, and drop the call.
        std::size_t place = noted_ % Distance;
        coming_[place] = names;
        ++noted_;
        for (std::size_t i = 0; i < CountNew(place); ++i) {
            index.PrefetchPlace(names[i]);
        }
        place = (place + Distance / 2) % Distance;
        for (std::size_t i = 0; i < CountNew(place); ++i) {
            if (const auto* const object = index.GuessObject(coming_[place][i])) {
                Port::Prefetch(object);
                Port::Prefetch(reinterpret_cast<const char*>(object) + Port::CacheLine);
            }
        }
    }

private:
    static constexpr int LeastSize = 10000;

    /// How many names of a line are to be fetched. Lines behind each other often have to do with
    /// one instance, which the last name is; the first of them has it fetched.
    std::size_t CountNew(std::size_t place) const noexcept {
        const std::size_t before = (place + Distance - 1) % Distance;
        return coming_[place].back() == coming_[before].back() ? 1 : 2;
    }

    std::array<Hashes, Distance> coming_{};
    std::size_t noted_ = 0;
};

} // namespace Orn_Hdl
