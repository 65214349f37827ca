// Finds the rows of a table by a key.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace Tool::Diff {

/// No row.
inline constexpr std::uint32_t None = static_cast<std::uint32_t>(-1);

/// Spreads the bits of a number.
constexpr std::uint64_t Mix(std::uint64_t value) noexcept {
    value ^= value >> 30U;
    value *= 0xbf58476d1ce4e5b9U;
    value ^= value >> 27U;
    value *= 0x94d049bb133111ebU;
    return value ^ (value >> 31U);
}

/// Combines two numbers, in this order.
constexpr std::uint64_t Mix(std::uint64_t a, std::uint64_t b) noexcept {
    return Mix(a * 0x9e3779b97f4a7c15U + b + 0x2545f4914f6cdd1dU);
}

inline std::uint64_t HashPointer(const void* pointer) noexcept {
    return Mix(reinterpret_cast<std::uintptr_t>(pointer));
}

/// A hash table of row numbers. It holds no keys: the caller has the hashes and compares.
class IndexTable {
public:
    /// \param count how many rows the table will have.
    explicit IndexTable(std::size_t count = 0) {
        std::size_t size = 16;
        while (size < count * 2) {
            size *= 2;
        }
        slots_.assign(size, None);
    }

    /// The row with that hash that is equal to what is looked for; None if there is none.
    /// \param isEqual called with a row.
    template <class IsEqual> std::uint32_t Find(std::uint64_t hash, const IsEqual& isEqual) const {
        for (std::size_t at = hash & (slots_.size() - 1); slots_[at] != None;
             at = (at + 1) & (slots_.size() - 1)) {
            if (isEqual(slots_[at])) {
                return slots_[at];
            }
        }
        return None;
    }

    /// Adds a row. Of two equal rows, the one that was added first is found.
    void Add(std::uint64_t hash, std::uint32_t row) {
        std::size_t at = hash & (slots_.size() - 1);
        while (slots_[at] != None) {
            at = (at + 1) & (slots_.size() - 1);
        }
        slots_[at] = row;
    }

private:
    std::vector<std::uint32_t> slots_;
};

} // namespace Tool::Diff
