// Names as a comparison of designs takes them.
#pragma once

#include <cstdint>
#include <string_view>

namespace Tool::Diff {

/// A name without the backslash and the blanks of an escaped one.
std::string_view WithoutEscape(std::string_view name) noexcept;
/// The part of a name before its range or index.
std::string_view GetBase(std::string_view name) noexcept;
/// A hash of a name that ignores letter case.
std::uint64_t HashName(std::string_view name) noexcept;

} // namespace Tool::Diff
