#include "import/BitNumbers.h"

#include <algorithm>

namespace Tool::Import {

Bit BitNumbers::GetIndex(std::int64_t number) {
    const auto place = static_cast<std::uint64_t>(number);
    if (place > limit_) {
        return Claim(others_.try_emplace(number, NoIndex).first->second);
    }
    if (place >= table_.size()) {
        table_.resize(std::max<std::size_t>(place + 1, table_.size() * 2), NoIndex);
    }
    return Claim(table_[place]);
}

Bit BitNumbers::Claim(Bit& index) {
    if (index == NoIndex) {
        index = count_++;
    }
    return index;
}

} // namespace Tool::Import
