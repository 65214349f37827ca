#include "import/Spelling.h"

#include <limits>

namespace Tool::Import {

BitRange Normalize(BitRange range, std::uint32_t width) noexcept {
    constexpr std::int64_t Greatest = std::numeric_limits<std::int32_t>::max();
    if (range.offset < 0 || range.offset > Greatest - width + 1) {
        range.offset = 0;
    }
    return range;
}

std::int64_t GetIndex(BitRange range, std::uint32_t width, std::uint32_t position) noexcept {
    return range.offset + (range.upto ? width - 1 - position : position);
}

std::string MakeBitName(std::string_view base, std::int64_t index) {
    return std::string(base).append("(").append(std::to_string(index)).append(")");
}

std::string MakeBusName(std::string_view base, std::int64_t left, std::int64_t right) {
    std::string name(base);
    name.append("(").append(std::to_string(left)).append(":");
    return name.append(std::to_string(right)).append(")");
}

std::string MakeConstant(const std::string& digits, bool scalar) {
    return scalar ? digits : std::to_string(digits.size()) + ":B:" + digits;
}

const char* GetDirectionName(Direction direction) noexcept {
    switch (direction) {
    case Direction::Input:
        return "Input";
    case Direction::Output:
        return "Output";
    default:
        return "BiDirectional";
    }
}

} // namespace Tool::Import
