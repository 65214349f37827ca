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

Bit BitNumbers::GetIndex(std::int64_t number) {
    const auto place = static_cast<std::uint64_t>(number);
    if (place > limit_) {
        return Claim(others_[number]);
    }
    if (place >= table_.size()) {
        table_.resize(std::max<std::size_t>(place + 1, table_.size() * 2));
    }
    return Claim(table_[place]);
}

Bit BitNumbers::Claim(Entry& entry) {
    if (entry < first_) {
        entry = next_++;
    }
    return entry - first_;
}

} // namespace Tool::Import
