// Consecutive indices for the bit numbers of a module.
#pragma once

#include "import/ImportedDesign.h"

#include <cstddef>
#include <cstdint>
#include <map>
#include <vector>

namespace Tool::Import {

/// Assigns consecutive indices to the bit numbers of each module, in the order of their first use.
/// Programs number bits without large gaps, so a table contains the numbers up to a limit; larger
/// numbers must not make the table huge. All modules share the table, because a file may have many
/// modules, each with a few bits of large numbers.
class BitNumbers {
public:
    /// Begins a module, whose first index is 0.
    void StartModule();
    /// \param limit the greatest number for which the table may grow.
    Bit GetIndex(std::int64_t number, std::size_t limit);
    /// The number of indices that the present module has.
    std::uint32_t GetCount() const noexcept { return next_ - first_; }

private:
    /// For each bit its index counted over all modules, plus 1. Entries of earlier modules are
    /// lower than those of the present one and need not be removed.
    using Entry = std::uint32_t;

    Bit Claim(Entry& entry);
    void Grow(std::size_t size);

    Entry first_ = 1;
    Entry next_ = 1;
    std::vector<Entry> table_;
    /// Sorted, because numbers could be chosen to collide in a hash table.
    std::map<std::int64_t, Entry> others_;
};

} // namespace Tool::Import
