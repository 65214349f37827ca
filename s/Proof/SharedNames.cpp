#include "Proof/SharedNames.h"

#include "Containers/HashByEights.h"
#include "Port/Ascii.h"
#include "Port/Prefetch.h"
#include "Proof/Bits.h"
#include "Proof/Meaning.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace Orn_Hdl::Proving {

using std::string_view;

namespace {

/// Calls `take` with each name that an object has in a netlist of the language. A bus has two: a
/// tool may take "D(7:0)" for a name as a whole.
template <class Take> void ForEachName(const Netlist& design, Language language, Take take) {
    const auto inFile = [language](string_view name) {
        return language == Language::Verilog ? NameInVerilog(name) : name;
    };
    for (const Signal* signal : design.GetSignalIterator()) {
        const string_view name = signal->GetNameView();
        take(inFile(name));
        if (signal->GetSignalType() == SignalTypeBus) {
            const string_view base = ReadRun(name).base;
            if (base.size() != name.size()) {
                take(base);
            }
        }
    }
    for (const Instance* instance : design.GetInstanceIterator()) {
        take(inFile(instance->GetNameView()));
    }
}

/// Hashes that come more than once. A slot keeps half a hash and its place tells of most of the
/// rest, so that hardly any two different hashes are taken for one.
class RepeatedHashes {
public:
    explicit RepeatedHashes(std::size_t count) {
        std::size_t size = LeastSlots;
        while (size < 2 * count) {
            size *= 2;
        }
        slots_.resize(size);
    }

    /// A hash is put into its slot when some others have been added, and the slot is at hand.
    void Add(std::uint64_t hash) {
        Port::Prefetch(&slots_[PlaceOf(hash)]);
        std::swap(hash, coming_[next_]);
        next_ = (next_ + 1) % coming_.size();
        Insert(hash);
    }

    std::unordered_set<std::uint64_t> Take() {
        for (std::uint64_t& hash : coming_) {
            Insert(hash);
            hash = 0;
        }
        return std::move(repeated_);
    }

private:
    static constexpr std::size_t LeastSlots = 64;
    static constexpr std::size_t Lead = 16;

    std::size_t PlaceOf(std::uint64_t hash) const noexcept {
        return static_cast<std::size_t>(hash) & (slots_.size() - 1);
    }

    /// An empty slot is 0, and so is a place in `coming_` that has not been taken yet.
    void Insert(std::uint64_t hash) {
        const auto mark = static_cast<std::uint32_t>(hash >> 32U);
        if (hash == 0) {
            return;
        }
        for (std::size_t place = PlaceOf(hash);; place = PlaceOf(place + 1)) {
            if (slots_[place] == 0) {
                slots_[place] = std::max(mark, 1U);
                return;
            }
            if (slots_[place] == std::max(mark, 1U)) {
                repeated_.insert(hash);
                return;
            }
        }
    }

    std::vector<std::uint32_t> slots_;
    std::array<std::uint64_t, Lead> coming_{};
    std::size_t next_ = 0;
    std::unordered_set<std::uint64_t> repeated_;
};

std::uint64_t HashOf(string_view name, Language language) noexcept {
    return language == Language::Verilog
               ? WideHashByEights(name, [](std::uint64_t text) { return text; })
               : WideHashByEights(name,
                                  [](std::uint64_t text) { return EightBytes::ToUpper(text); });
}

} // namespace

SharedNames::SharedNames(const Netlist& design, Language language) : language_(language) {
    std::size_t count = 0;
    ForEachName(design, language, [&count](string_view) { ++count; });
    RepeatedHashes hashes(count);
    ForEachName(design, language, [&](string_view name) { hashes.Add(HashOf(name, language)); });
    const std::unordered_set<std::uint64_t> repeated = hashes.Take();
    if (repeated.empty()) {
        return;
    }
    std::unordered_set<std::string> met;
    ForEachName(design, language, [&](string_view name) {
        if (repeated.count(HashOf(name, language)) != 0) {
            std::string folded = Folded(name);
            if (!met.insert(folded).second) {
                names_.insert(std::move(folded));
            }
        }
    });
}

bool SharedNames::Contains(string_view name) const {
    return !names_.empty() && names_.count(Folded(name)) != 0;
}

/// Letter case distinguishes names in Verilog alone.
std::string SharedNames::Folded(string_view name) const {
    std::string folded(name);
    if (language_ == Language::Vhdl) {
        std::transform(folded.begin(), folded.end(), folded.begin(), Port::ToLower);
    }
    return folded;
}

} // namespace Orn_Hdl::Proving
