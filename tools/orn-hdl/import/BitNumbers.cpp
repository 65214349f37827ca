#include "import/BitNumbers.h"

#include <algorithm>

namespace Tool::Import {

void BitNumbers::StartModule() {
    constexpr Entry Half = 0x80000000;
    if (next_ > Half) {
        // The counter must not overflow.
        table_.clear();
        others_.clear();
        next_ = 1;
    }
    first_ = next_;
}

Bit BitNumbers::GetIndex(std::int64_t number, std::size_t limit) {
    const auto place = static_cast<std::uint64_t>(number);
    if (place >= table_.size()) {
        if (place > limit) {
            return Claim(others_[number]);
        }
        Grow(std::max<std::size_t>(place + 1, table_.size() * 2));
    }
    return Claim(table_[place]);
}

void BitNumbers::Grow(std::size_t size) {
    table_.resize(size);
    while (!others_.empty() && static_cast<std::uint64_t>(others_.begin()->first) < size) {
        table_[static_cast<std::size_t>(others_.begin()->first)] = others_.begin()->second;
        others_.erase(others_.begin());
    }
}

Bit BitNumbers::Claim(Entry& entry) {
    if (entry < first_) {
        entry = next_++;
    }
    return entry - first_;
}

} // namespace Tool::Import
