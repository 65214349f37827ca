// What no netlist needs, and what a text made to do harm could ask for.
#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>

namespace Orn_Hdl::Readers {

/// The largest index that a model can have.
constexpr std::int64_t LargestIndex = std::numeric_limits<int>::max();
/// The most bits of a value, a concatenation or an aggregate.
constexpr std::uint64_t MostBits = 1'048'576;
/// The most digits of a decimal number: converting them takes the square of their number.
constexpr std::size_t MostDecimalDigits = 300;
/// How deep expressions may be nested.
constexpr std::size_t DeepestExpression = 500;

} // namespace Orn_Hdl::Readers
