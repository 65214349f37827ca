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
        coming_[noted_ % Distance] = names;
        ++noted_;
        for (const std::uint32_t hash : names) {
            index.PrefetchPlace(hash);
        }
        for (const std::uint32_t hash : coming_[(noted_ + Distance / 2) % Distance]) {
            if (const auto* const object = index.GuessObject(hash)) {
                Port::Prefetch(object);
                Port::Prefetch(reinterpret_cast<const char*>(object) + Port::CacheLine);
            }
        }
    }

private:
    static constexpr int LeastSize = 10000;

    std::array<Hashes, Distance> coming_{};
    std::size_t noted_ = 0;
};

} // namespace Orn_Hdl
