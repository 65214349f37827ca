// Consecutive indices for the bit numbers of a module.
#pragma once

#include "import/ImportedDesign.h"

#include <cstddef>
#include <cstdint>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// Gives the bit numbers of a module consecutive indices, in the order of their first use. Numbers
/// up to `limit` have a table. Programs number bits without large gaps; a file with larger numbers
/// must not make the table huge.
class BitNumbers {
public:
    explicit BitNumbers(std::size_t limit) : limit_(limit) {}

    Bit GetIndex(std::int64_t number);
    std::uint32_t GetCount() const noexcept { return count_; }

private:
    static constexpr Bit NoIndex = 0xFFFFFFFF;

    Bit Claim(Bit& index);

    std::size_t limit_;
    std::uint32_t count_ = 0;
    std::vector<Bit> table_;
    std::unordered_map<std::int64_t, Bit> others_;
};

} // namespace Tool::Import
